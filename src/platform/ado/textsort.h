#pragma once

#include "platform/text/collation.h"

#include <cstdint>
#include <string_view>
#include <vector>

namespace ADODB
{

/// The texts, in UTF-8, that rows are sorted by.
class RowTexts
{
public:
    virtual ~RowTexts() = default;
    virtual std::string_view text(std::uint32_t row) const = 0;
};

/// A row with what decides its place first: a value, or the next eight letters of its text as a
/// number, and what is left of the text behind them. The text is kept here because looking it up
/// in the rows is what costs most.
struct SortEntry {
    std::uint64_t key;
    const char *rest;
    std::uint32_t restSize : 31;
    std::uint32_t accented : 1; // letters with accents so far
    std::uint32_t row;
};

struct ByKey {
    bool operator()(const SortEntry &a, const SortEntry &b) const
    {
        return a.key != b.key ? a.key < b.key : a.row < b.row;
    }
};

/// Sorts rows by their texts in the program's order of texts, rows with equal ones by their
/// numbers. Those with Latin letters alone are sorted eight letters at a time, the others by sort
/// keys, which take longer to make; then the two are merged.
class TextSort
{
public:
    explicit TextSort(const RowTexts &texts) : mTexts(texts) {}

    /// Only `row` of the entries need be set.
    void sort(SortEntry *from, SortEntry *to) const;

private:
    using Entry = SortEntry;
    using Entries = std::vector<SortEntry>;
    static constexpr int deepest = 64; // beyond so many times eight letters texts are compared

    bool takeKey(Entry &entry) const;
    bool before(const Entry &a, const Entry &b) const;
    void sortRest(Entry *from, Entry *to, int depth) const;
    void sortLatin(Entry *from, Entry *to, int depth) const;
    void sortRun(Entry *from, Entry *to, int depth) const;
    void sortAsTexts(Entry *from, Entry *to) const;
    void sortBySortKeys(Entries &entries) const;
    void mergeIn(Entry *from, Entry *end, const Entries &others) const;

    const RowTexts &mTexts;
    const text::Collation &mCollation = text::Collation::root();
};

} // namespace ADODB
