#include "catalogue/quoting.h"

#include "platform/text/normalform.h"

#include <charconv>

using namespace Qt::StringLiterals;

QString doubled(QString text)
{
    return text.contains(u'\'') ? text.replace("'"_L1, "''"_L1) : text;
}

QString quoted(const QString &text)
{
    return u'\'' + doubled(text) + u'\'';
}

QString quotedOrNull(const QString &text)
{
    return text.isEmpty() ? u"NULL"_s : quoted(text);
}

QString numberOrNull(const QString &text)
{
    return text.isEmpty() ? u"NULL"_s : text;
}

ADODB::Parameter textOrNull(std::string_view text)
{
    return text.empty() ? ADODB::Parameter(nullptr) : text;
}

ADODB::Parameter wholeOrNull(std::string_view digits)
{
    if (digits.empty())
        return nullptr;
    qint64 whole = 0;
    const char *const end = digits.data() + digits.size();
    const auto read = std::from_chars(digits.data(), end, whole);
    if (read.ec == std::errc() && read.ptr == end)
        return whole;
    return ADODB::Value(text::fromUtf8(digits)).toLong(); // "2e03"
}

std::string undoubled(ADODB::Connection &connection, std::string_view text)
{
    std::string once;
    for (std::size_t at = 0; at < text.size(); ++at) {
        once.push_back(text[at]);
        if (text[at] == '\'' && text.substr(++at, 1) != "'")
            connection.refuse(makeError(errSyntax, text::fromUtf8(text)));
    }
    return once;
}
