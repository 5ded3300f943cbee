#include "platform/text/collation.h"

#include <algorithm>
#include <stdexcept>
#include <string>
#include <unicode/ucol.h>

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

bool Collation::sortPrefix(std::string_view s, std::uint64_t &prefix) const
{
    prefix = 0;
    std::size_t i = 0;
    for (int shift = 56; shift >= 0; shift -= 8) {
        if (i >= s.size())
            return true;
        unsigned c = static_cast<unsigned char>(s[i++]);
        if (c >= 0x80) {
            const bool pair = c >= 0xC3 && c < 0xE0 && i < s.size() && (s[i] & 0xC0) == 0x80;
            if (!pair)
                return false;
            c = (c & 0x1F) << 6 | (static_cast<unsigned char>(s[i++]) & 0x3F);
        }
        if (c >= latinEnd || mLatinRank[c] == 0)
            return false;
        prefix |= std::uint64_t(mLatinRank[c]) << shift;
    }
    // A mark behind the last letter could still change it.
    return i >= s.size() || !(s[i] & 0x80);
}

} // namespace text
