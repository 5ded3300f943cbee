#include "platform/text/collation.h"

#include <algorithm>
#include <stdexcept>
#include <unicode/ucol.h>
#include <unicode/ustring.h>

namespace text
{

namespace
{

constexpr unsigned latinEnd = 0x250;

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

/// The character at a place if it is ASCII or one of the Latin letters with accents, which take two
/// bytes; otherwise the end of these.
unsigned latinAt(std::string_view s, std::size_t at)
{
    const auto byte = [&](std::size_t i) { return static_cast<unsigned char>(s[i]); };
    const unsigned lead = byte(at);
    if (lead < 0x80)
        return lead;
    const bool pair = at + 1 < s.size() && (byte(at + 1) & 0xC0) == 0x80;
    const unsigned c = (lead & 0x1F) << 6 | (pair ? byte(at + 1) & 0x3F : 0);
    return pair && lead >= 0xC3 && lead < 0xE0 && c < latinEnd ? c : latinEnd;
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

void Collation::rankAccented()
{
    mLatinRank.assign(mRank.begin(), mRank.end());
    mLatinRank.resize(latinEnd, 0);
    UCollator *primary = openRoot(UCOL_PRIMARY);
    for (char16_t c = 0xC0; c < latinEnd; ++c) {
        for (char16_t base = 'a'; base <= 'z' && mLatinRank[c] == 0; ++base) {
            if (compareUnits(primary, c, base) == UCOL_EQUAL)
                mLatinRank[c] = mRank[base];
        }
    }
    ucol_close(primary);
}

int Collation::compare(std::string_view a, std::string_view b) const
{
    const std::size_t both = std::min(a.size(), b.size());
    std::size_t i = 0;
    for (; i < both; ++i) {
        const auto x = static_cast<unsigned char>(a[i]), y = static_cast<unsigned char>(b[i]);
        if ((x | y) & 0x80 || mRank[x] == 0 || mRank[y] == 0)
            break;
        if (mRank[x] != mRank[y]) {
            // A mark behind one of the two could still join it into another letter.
            const bool joined =
                (i + 1 < a.size() && a[i + 1] & 0x80) || (i + 1 < b.size() && b[i + 1] & 0x80);
            if (joined)
                break;
            return mRank[x] < mRank[y] ? -1 : 1;
        }
    }
    if (i == a.size() && i == b.size())
        return 0;
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
        if (c >= latinEnd || mLatinRank[c] == 0)
            return false;
        used += c < 0x80 ? 1 : 2;
        prefix |= std::uint64_t(mLatinRank[c]) << shift;
    }
    // A mark behind the last letter could still change it.
    return used >= s.size() || latinAt(s, used) < latinEnd;
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
