#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

struct UCollator;

namespace text
{

/// The one order of texts in the program and its catalogue: the root order of ICU, secondary
/// strength. Case does not count, accents do; "Édith" stands beside "Edith". All texts are UTF-8.
/// Needs ICU only, so that other programs can load it too.
class Collation
{
public:
    static const Collation &root();

    /// Below, equal to or above 0, as a sorts before, with or after b. Latin texts take a short way
    /// that gives the same answer.
    int compare(std::string_view a, std::string_view b) const;

    /// A number that sorts as the start of the text does, for sorting long lists: different numbers
    /// decide, equal ones leave it to the rest of the texts, from the byte `used` on; the last byte
    /// of the number is 0 if there is none. Once all of two texts are equal so, compare() decides.
    /// False if the text has no such number: it holds more than Latin letters and ASCII.
    bool sortPrefix(std::string_view s, std::uint64_t &prefix, std::size_t &used) const;

    /// Appends the bytes that sort, byte by byte, as the text does, 0 at the end and nowhere else.
    /// For any text, but slower to make than sortPrefix().
    void appendSortKey(std::string_view s, std::string &keys) const;

    /// The version of the order's tables, 24 bits. Indexes made under another one are not usable.
    std::uint32_t version() const { return mVersion; }

    Collation(const Collation &) = delete;
    Collation &operator=(const Collation &) = delete;

private:
    Collation();
    ~Collation();
    void rankCharacters();
    void rankAccented();
    static unsigned latinAt(std::string_view s, std::size_t &at);
    int compareAll(std::string_view a, std::string_view b) const;

    static constexpr unsigned latinEnd = 0x250;

    UCollator *mCollator = nullptr;
    std::uint32_t mVersion = 0;

    // Of ASCII and Latin letters: primary order, 0 for what takes the long way; and the order of
    // the accents that a letter may have.
    std::array<std::uint8_t, latinEnd> mRank{}, mAccent{};
};

} // namespace text
