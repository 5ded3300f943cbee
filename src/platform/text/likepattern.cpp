#include "platform/text/likepattern.h"

#include <array>
#include <cstdint>
#include <cstring>
#include <unicode/uchar.h>
#include <unicode/utf8.h>

namespace text
{

namespace
{

constexpr char anyOne = '\xFF'; // never a byte of UTF-8

constexpr auto asciiFold = [] {
    std::array<char, 256> fold{};
    for (int c = 0; c < 256; ++c)
        fold[c] = char(c >= 'A' && c <= 'Z' ? c + 32 : c);
    return fold;
}();

// Latin, Greek and Cyrillic, where nearly all names live: looked up instead of asked for.
constexpr char32_t tableEnd = 0x800;

const std::vector<std::uint16_t> &foldTable()
{
    static const auto table = [] {
        std::vector<std::uint16_t> t(tableEnd);
        for (char32_t c = 0; c < tableEnd; ++c)
            t[c] = std::uint16_t(u_foldCase(UChar32(c), U_FOLD_CASE_DEFAULT));
        return t;
    }();
    return table;
}

void append(std::string &out, UChar32 c)
{
    char buffer[U8_MAX_LENGTH];
    int32_t length = 0;
    U8_APPEND_UNSAFE(buffer, length, c);
    out.append(buffer, std::size_t(length));
}

void foldInto(std::string &out, std::string_view text)
{
    out.clear();
    const auto &table = foldTable();
    const auto *s = reinterpret_cast<const std::uint8_t *>(text.data());
    const int32_t n = int32_t(text.size());
    for (int32_t i = 0; i < n;) {
        if (s[i] < 0x80) {
            out.push_back(asciiFold[s[i++]]);
            continue;
        }
        UChar32 c;
        U8_NEXT_OR_FFFD(s, i, n, c);
        append(out, c < UChar32(tableEnd) ? UChar32(table[std::size_t(c)])
                                          : u_foldCase(c, U_FOLD_CASE_DEFAULT));
    }
}

bool isAscii(std::string_view s)
{
    std::size_t i = 0;
    for (; i + 8 <= s.size(); i += 8) {
        std::uint64_t eight;
        std::memcpy(&eight, s.data() + i, 8);
        if (eight & 0x8080808080808080u)
            return false;
    }
    for (; i < s.size(); ++i) {
        if (s[i] & 0x80)
            return false;
    }
    return true;
}

std::size_t nextCharacter(std::string_view s, std::size_t i)
{
    do
        ++i;
    while (i < s.size() && (s[i] & 0xC0) == 0x80);
    return i;
}

constexpr std::size_t npos = std::string_view::npos;

// The place behind the piece if it stands at `at`, else npos.
template <typename Fold>
std::size_t pieceEnd(std::string_view text, std::size_t at, std::string_view piece, Fold fold)
{
    for (const char p : piece) {
        if (at >= text.size())
            return npos;
        if (p == anyOne)
            at = nextCharacter(text, at);
        else if (fold(text[at]) == p)
            ++at;
        else
            return npos;
    }
    return at;
}

// The place behind the first piece from `at` on, else npos.
template <typename Fold>
std::size_t findPiece(std::string_view text, std::size_t at, std::string_view piece, Fold fold)
{
    const char first = piece.front();
    const char capital = char(first >= 'a' && first <= 'z' ? first - 32 : first);
    for (; at < text.size(); ++at) {
        const char c = text[at];
        if (first == anyOne ? (c & 0xC0) == 0x80 : c != first && c != capital)
            continue;
        if (const auto end = pieceEnd(text, at, piece, fold); end != npos)
            return end;
    }
    return npos;
}

// Whether the piece stands at the very end, not before `from`.
template <typename Fold>
bool endsWithPiece(std::string_view text, std::size_t from, std::string_view piece, Fold fold)
{
    std::size_t at = text.size();
    for (std::size_t i = piece.size(); i-- > 0;) {
        const bool continuation = (piece[i] & 0xC0) == 0x80 && piece[i] != anyOne;
        if (continuation)
            continue;
        do {
            if (at == from)
                return false;
            --at;
        } while (at > from && (text[at] & 0xC0) == 0x80);
    }
    return pieceEnd(text, at, piece, fold) == text.size();
}

// The characters outside of ASCII that are folded into it: the long s and the Kelvin sign.
bool holdsHiddenAscii(std::string_view text)
{
    return !isAscii(text) && (text.find("\xC5\xBF") != npos || text.find("\xE2\x84\xAA") != npos);
}

} // namespace

LikePattern::LikePattern(std::string_view pattern)
{
    std::string folded;
    foldInto(folded, pattern);
    mOpenStart = folded.starts_with('%');
    mOpenEnd = folded.ends_with('%');
    std::string piece;
    for (const char c : folded) {
        if (c != '%') {
            piece.push_back(c == '_' ? anyOne : c);
        } else if (!piece.empty()) {
            mPieces.push_back(piece);
            piece.clear();
        }
    }
    if (!piece.empty())
        mPieces.push_back(piece);
    mAscii = isAscii(folded);
    mPlain = mAscii && folded.find('_') == std::string::npos;
    mMayHide = folded.find_first_of("sk") != std::string::npos;
}

template <typename Fold> bool LikePattern::matchesAll(std::string_view text, Fold fold) const
{
    if (mPieces.empty())
        return mOpenStart || text.empty();
    std::size_t at = 0, i = 0, last = mPieces.size();
    if (!mOpenStart) {
        at = pieceEnd(text, 0, mPieces[i++], fold);
        if (at == npos || (i == last && !mOpenEnd))
            return at == text.size();
    }
    if (!mOpenEnd)
        --last;
    for (; i < last; ++i) {
        at = findPiece(text, at, mPieces[i], fold);
        if (at == npos)
            return false;
    }
    return mOpenEnd || endsWithPiece(text, at, mPieces.back(), fold);
}

// Letters of ASCII can be looked for in the bytes of any text as they stand. Only for others, and
// for
// "_", which has to know where characters begin, is the text folded first.
bool LikePattern::matches(std::string_view text) const
{
    const auto ascii = [](char c) { return asciiFold[static_cast<unsigned char>(c)]; };
    if (mPlain) {
        if (matchesAll(text, ascii))
            return true;
        if (!mMayHide || !holdsHiddenAscii(text))
            return false;
    } else if (isAscii(text)) {
        return mAscii && matchesAll(text, ascii);
    }
    thread_local std::string folded;
    foldInto(folded, text);
    return matchesAll(std::string_view(folded), [](char c) { return c; });
}

} // namespace text
