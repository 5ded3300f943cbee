#include "platform/text/collation.h"

#include <algorithm>
#include <stdexcept>
#include <string>
#include <unicode/ucol.h>
#include <unicode/ustring.h>
#include <vector>

namespace text
{

namespace
{

UCollator *openRoot(UCollationStrength strength)
{
    UErrorCode status = U_ZERO_ERROR;
    UCollator *collator = ucol_open("", &status);
    if (U_FAILURE(status))
        throw std::runtime_error(std::string("The sort order is not available: ") +
                                 u_errorName(status));
    ucol_setStrength(collator, strength);
    return collator;
}

UCollationResult compareUnits(const UCollator *collator, char16_t a, char16_t b)
{
    return ucol_strcoll(collator, &a, 1, &b, 1);
}

// A mark may stand here, which would join the character before it into another one.
bool mayJoin(std::string_view s, std::size_t at)
{
    return at < s.size() && static_cast<unsigned char>(s[at]) > 0xC9;
}

} // namespace

const Collation &Collation::root()
{
    static const Collation collation;
    return collation;
}

Collation::Collation() : mCollator(openRoot(UCOL_SECONDARY))
{
    UVersionInfo version;
    ucol_getVersion(mCollator, version);
    mVersion = std::uint32_t(version[0]) << 16 | std::uint32_t(version[1]) << 8 | version[2];
    rankCharacters();
    rankAccented();
}

Collation::~Collation()
{
    ucol_close(mCollator);
}

// Every printable ASCII character has one weight of its own in the root order, letters one for both
// cases. Control characters are ignored by it: they keep rank 0.
void Collation::rankCharacters()
{
    std::vector<char16_t> order;
    for (char16_t c = 1; c < 128; ++c) {
        const bool ignored = ucol_strcoll(mCollator, &c, 1, u"", 0) == UCOL_EQUAL;
        if (!ignored)
            order.push_back(c);
    }
    std::stable_sort(order.begin(), order.end(), [this](char16_t a, char16_t b) {
        return compareUnits(mCollator, a, b) == UCOL_LESS;
    });
    std::uint8_t rank = 0;
    for (std::size_t i = 0; i < order.size(); ++i) {
        if (i == 0 || compareUnits(mCollator, order[i - 1], order[i]) != UCOL_EQUAL)
            ++rank;
        mRank[order[i]] = rank;
    }
}

// Letters with accents have the primary order of their base, and one among themselves.
void Collation::rankAccented()
{
    UCollator *primary = openRoot(UCOL_PRIMARY);
    for (char16_t base = 'a'; base <= 'z'; ++base) {
        std::vector<char16_t> letters{base};
        for (char16_t c = 0xC0; c < latinEnd; ++c) {
            if (compareUnits(primary, c, base) == UCOL_EQUAL)
                letters.push_back(c);
        }
        std::stable_sort(letters.begin(), letters.end(), [this](char16_t a, char16_t b) {
            return compareUnits(mCollator, a, b) == UCOL_LESS;
        });
        for (std::size_t i = 0; i < letters.size(); ++i) {
            const bool next = i > 0 && compareUnits(mCollator, letters[i - 1], letters[i]) != 0;
            mRank[letters[i]] = mRank[base];
            mAccent[letters[i]] = i > 0 ? std::uint8_t(mAccent[letters[i - 1]] + next) : 0;
        }
    }
    ucol_close(primary);
}

// The character at a place, which moves on behind it; 0 if its order is not known here.
inline unsigned Collation::latinAt(std::string_view s, std::size_t &at)
{
    const unsigned c = static_cast<unsigned char>(s[at++]);
    if (c < 0x80)
        return c;
    if (c < 0xC3 || c > 0xC9 || at >= s.size() || (s[at] & 0xC0) != 0x80)
        return 0;
    const unsigned letter = (c & 0x1F) << 6 | (static_cast<unsigned char>(s[at++]) & 0x3F);
    return letter < latinEnd ? letter : 0;
}

int Collation::compare(std::string_view a, std::string_view b) const
{
    if (a == b)
        return 0;
    const std::size_t both = std::min(a.size(), b.size());
    std::size_t i = 0;
    while (i < both && a[i] == b[i] && !(a[i] & 0x80))
        ++i;
    std::size_t j = i;
    int byAccent = 0; // counts if nothing else tells the two apart
    while (i < a.size() && j < b.size()) {
        const unsigned x = latinAt(a, i), y = latinAt(b, j);
        const int rankX = mRank[x], rankY = mRank[y];
        if (rankX == 0 || rankY == 0)
            return compareAll(a, b);
        if (rankX != rankY)
            return mayJoin(a, i) || mayJoin(b, j) ? compareAll(a, b) : rankX - rankY;
        if (byAccent == 0)
            byAccent = mAccent[x] - mAccent[y];
    }
    if (i == a.size() && j == b.size())
        return byAccent;
    const bool longerA = i < a.size();
    if (mRank[longerA ? latinAt(a, i) : latinAt(b, j)] == 0)
        return compareAll(a, b);
    return longerA ? 1 : -1;
}

int Collation::compareAll(std::string_view a, std::string_view b) const
{
    UErrorCode status = U_ZERO_ERROR;
    return ucol_strcollUTF8(mCollator, a.data(), int32_t(a.size()), b.data(), int32_t(b.size()),
                            &status);
}

bool Collation::sortPrefix(std::string_view s, std::uint64_t &prefix, std::size_t &used) const
{
    prefix = 0;
    used = 0;
    for (int shift = 56; shift >= 0 && used < s.size(); shift -= 8) {
        const unsigned c = latinAt(s, used);
        if (mRank[c] == 0)
            return false;
        prefix |= std::uint64_t(mRank[c]) << shift;
    }
    // A mark behind the last letter could still change it.
    return !mayJoin(s, used);
}

void Collation::appendSortKey(std::string_view s, std::string &keys) const
{
    std::u16string units(s.size(), u'\0');
    UErrorCode status = U_ZERO_ERROR;
    int32_t length = 0;
    u_strFromUTF8WithSub(units.data(), int32_t(units.size()), &length, s.data(), int32_t(s.size()),
                         0xFFFD, nullptr, &status);
    const std::size_t start = keys.size();
    const auto room = [&] { return int32_t(keys.size() - start); };
    const auto write = [&] {
        return ucol_getSortKey(mCollator, units.data(), length,
                               reinterpret_cast<std::uint8_t *>(keys.data() + start), room());
    };
    keys.resize(start + s.size() * 2 + 8);
    int32_t size = write();
    if (size > room()) {
        keys.resize(start + std::size_t(size));
        size = write();
    }
    keys.resize(start + std::size_t(size));
}

} // namespace text
