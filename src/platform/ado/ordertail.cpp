#include "platform/ado/ordertail.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <string>

namespace ADODB
{

namespace
{

// Takes the word that the text ends with, if it is this one in small letters or capitals.
bool dropWord(std::string_view &text, std::string_view word)
{
    while (text.ends_with(' '))
        text.remove_suffix(1);
    if (text.size() < word.size())
        return false;
    const auto end = text.substr(text.size() - word.size());
    const auto same = [](char a, char b) {
        return std::tolower(static_cast<unsigned char>(a)) == b;
    };
    if (!std::equal(end.begin(), end.end(), word.begin(), same))
        return false;
    text.remove_suffix(word.size());
    return text.ends_with(' ');
}

// The words outside of its texts, in small letters; a doubled quote in a text ends one and begins
// another.
std::string words(std::string_view sql)
{
    std::string small;
    bool inText = false;
    for (const char c : sql) {
        inText ^= c == '\'';
        if (!inText)
            small.push_back(char(std::tolower(static_cast<unsigned char>(c))));
    }
    return small;
}

bool isCompound(std::string_view sql)
{
    const std::string small = words(sql);
    return small.find("union") != std::string::npos || small.find("except") != std::string::npos ||
           small.find("intersect") != std::string::npos;
}

// The numbers of a list "1,2, 3"; none if it holds anything else.
std::vector<int> ordinals(std::string_view list)
{
    std::vector<int> numbers;
    const char *at = list.data(), *end = at + list.size();
    const auto skipBlanks = [&] { at = std::find_if(at, end, [](char c) { return c != ' '; }); };
    for (;;) {
        skipBlanks();
        int number = 0;
        const auto [stop, failure] = std::from_chars(at, end, number);
        if (failure != std::errc() || number < 1)
            return {};
        numbers.push_back(number - 1);
        at = stop;
        skipBlanks();
        if (at == end)
            return numbers;
        if (*at++ != ',')
            return {};
    }
}

} // namespace

OrderTail orderTail(std::string_view sql)
{
    auto head = sql.substr(0, sql.find_last_not_of("0123456789, ") + 1);
    const auto columns = ordinals(sql.substr(head.size()));
    if (!sql.starts_with("select ") || columns.empty() || !dropWord(head, "by") ||
        !dropWord(head, "order") || isCompound(head))
        return {};
    return {head.size(), columns};
}

} // namespace ADODB
