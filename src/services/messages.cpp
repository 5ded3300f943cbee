#include "services/messages.h"

#include "platform/text/messagetexts.h"
#include "services/globals.h"
#include "services/messagetable.h"

#include <string_view>
#include <unordered_map>

using namespace Qt::StringLiterals;

namespace
{

using Table = std::unordered_map<std::string_view, const messagetable::Message *>;

const Table &table()
{
    static const Table byKey = [] {
        Table t;
        for (std::size_t i = 0; i < messagetable::fixedTextCount; ++i)
            t.emplace(messagetable::fixedTexts[i].key, &messagetable::fixedTexts[i]);
        for (std::size_t i = 0; i < messagetable::furtherTextCount; ++i)
            t.emplace(messagetable::furtherTexts[i].key, &messagetable::furtherTexts[i]);
        return t;
    }();
    return byKey;
}

// The rooms below this one have their words in the table, too.
[[maybe_unused]] const bool lowerRoomsHaveTexts = [] {
    text::setKeys([](const char *key) { return GetMessage(key); });
    return true;
}();

} // namespace

QString GetMessage(QLatin1String key)
{
    return GetMessage(key, gLanguage);
}

QString GetMessage(QLatin1String key, int language)
{
    if (language != languageEnglish && language != languageDutch)
        return {};
    const bool dutch = language == languageDutch;
    const auto it = table().find(std::string_view(key.data(), std::size_t(key.size())));
    if (it == table().end())
        return dutch ? u"Onbekend"_s : u"Unknown"_s;
    return QString::fromUtf8(dutch ? it->second->dutch : it->second->english);
}
