#include "platform/ado/textsort.h"

#include <QtEndian>
#include <algorithm>
#include <bit>
#include <cstring>
#include <string>

namespace ADODB
{

void TextSort::sort(SortEntry *from, SortEntry *to) const
{
    for (Entry *entry = from; entry < to; ++entry) {
        const auto text = mTexts.text(entry->row);
        *entry = {0, text.data(), std::uint32_t(text.size()), 0, entry->row};
    }
    sortRest(from, to, 0);
}

// False if the rest of the text has to be sorted by its sort key.
bool TextSort::takeKey(Entry &entry) const
{
    std::size_t used = 0;
    const bool latin = mCollation.sortPrefix({entry.rest, entry.restSize}, entry.key, used);
    const auto letters = 8 - std::size_t(std::countr_zero(entry.key)) / 8;
    entry.accented |= used > letters;
    entry.rest += used;
    entry.restSize -= std::uint32_t(used);
    return latin;
}

bool TextSort::before(const Entry &a, const Entry &b) const
{
    const auto x = mTexts.text(a.row), y = mTexts.text(b.row);
    const int order = x == y ? 0 : mCollation.compare(x, y);
    return order != 0 ? order < 0 : a.row < b.row;
}

// Sorts entries whose texts have been alike up to their rests.
void TextSort::sortRest(Entry *from, Entry *to, int depth) const
{
    Entries others;
    Entry *end = from;
    for (Entry *entry = from; entry < to; ++entry) {
        if (takeKey(*entry))
            *end++ = *entry;
        else
            others.push_back(*entry);
    }
    sortLatin(from, end, depth);
    if (!others.empty()) {
        sortBySortKeys(others);
        mergeIn(from, end, others);
    }
}

void TextSort::sortLatin(Entry *from, Entry *to, int depth) const
{
    if (!std::is_sorted(from, to, ByKey()))
        std::sort(from, to, ByKey());
    while (from < to) {
        Entry *end = from + 1;
        while (end < to && end->key == from->key)
            ++end;
        if (end - from > 1)
            sortRun(from, end, depth);
        from = end;
    }
}

// Sorts entries with the same key.
void TextSort::sortRun(Entry *from, Entry *to, int depth) const
{
    const bool ended = (from->key & 0xFF) == 0;
    if (!ended && depth < deepest)
        sortRest(from, to, depth + 1);
    else if (!ended || std::any_of(from, to, [](const Entry &e) { return e.accented; }))
        sortAsTexts(from, to);
}

void TextSort::sortAsTexts(Entry *from, Entry *to) const
{
    const auto less = [this](const Entry &a, const Entry &b) { return before(a, b); };
    if (!std::is_sorted(from, to, less)) // mostly they are all the same
        std::sort(from, to, less);
}

void TextSort::sortBySortKeys(Entries &entries) const
{
    std::string keys;
    for (Entry &entry : entries) {
        entry.key = keys.size();
        mCollation.appendSortKey(mTexts.text(entry.row), keys);
    }
    for (Entry &entry : entries) {
        entry.rest = keys.data() + entry.key;
        char start[sizeof entry.key] = {};
        std::memcpy(start, entry.rest, strnlen(entry.rest, sizeof start));
        entry.key = qFromBigEndian<quint64>(start);
    }
    std::sort(entries.begin(), entries.end(), [](const Entry &a, const Entry &b) {
        if (a.key != b.key)
            return a.key < b.key;
        const int order = std::strcmp(a.rest, b.rest);
        return order != 0 ? order < 0 : a.row < b.row;
    });
}

// Merges the others, which fit behind the end, into [from, end), from the last one on. Looks
// for the place of each in growing steps: there are mostly few of them.
void TextSort::mergeIn(Entry *from, Entry *end, const Entries &others) const
{
    const auto less = [this](const Entry &a, const Entry &b) { return before(a, b); };
    Entry *to = end + others.size();
    for (auto other = others.rbegin(); other != others.rend(); ++other) {
        std::ptrdiff_t step = 1;
        while (step <= end - from && less(*other, end[-step]))
            step *= 2;
        Entry *place = std::upper_bound(std::max(from, end - step), end - step / 2, *other, less);
        to = std::move_backward(place, end, to);
        *--to = *other;
        end = place;
    }
}

} // namespace ADODB
