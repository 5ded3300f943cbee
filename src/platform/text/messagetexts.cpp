#include "platform/text/messagetexts.h"

namespace text
{

namespace
{

QString keyItself(const char *key)
{
    return QString::fromLatin1(key);
}

constinit OfKey gTexts = keyItself;

} // namespace

QString ofKey(const char *key)
{
    return gTexts(key);
}

void setKeys(OfKey texts)
{
    gTexts = texts;
}

} // namespace text
