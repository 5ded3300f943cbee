#include "helpers/jettext.h"

#include <cerrno>
#include <cstdint>
#include <iconv.h>
#include <utility>

namespace jet
{

namespace
{

const auto noConverter = reinterpret_cast<iconv_t>(-1); // NOLINT(performance-no-int-to-ptr)
constexpr char32_t replacement = 0xFFFD;

void append(std::string &utf8, char32_t c)
{
    const auto put = [&](char32_t lead, int shift) {
        utf8.push_back(char(lead | (c >> shift)));
        for (shift -= 6; shift >= 0; shift -= 6)
            utf8.push_back(char(0x80 | (c >> shift & 0x3F)));
    };
    if (c < 0x80)
        put(0, 0);
    else if (c < 0x800)
        put(0xC0, 6);
    else if (c < 0x10000)
        put(0xE0, 12);
    else
        put(0xF0, 18);
}

// Puts units of UTF-16 together, one after the other.
class Units
{
public:
    void take(char32_t unit)
    {
        const bool first = unit >= 0xD800 && unit < 0xDC00,
                   second = unit >= 0xDC00 && unit < 0xE000;
        if (mFirst && second) {
            append(utf8, 0x10000 + ((std::exchange(mFirst, 0) - 0xD800) << 10) + (unit - 0xDC00));
            return;
        }
        flush();
        if (first)
            mFirst = unit;
        else
            append(utf8, second ? replacement : unit);
    }
    void flush()
    {
        if (std::exchange(mFirst, 0))
            append(utf8, replacement);
    }
    std::string utf8;

private:
    char32_t mFirst = 0; // of two, the second is still to come
};

std::string fromUnicode(std::string_view bytes)
{
    const bool compressed = bytes.substr(0, 2) == "\xFF\xFE";
    if (compressed)
        bytes.remove_prefix(2);
    const auto byte = [&](std::size_t i) { return char32_t(std::uint8_t(bytes[i])); };
    Units units;
    units.utf8.reserve(bytes.size());
    bool narrow = compressed;
    for (std::size_t i = 0; i < bytes.size(); ++i) {
        if (compressed && byte(i) == 0)
            narrow = !narrow;
        else if (narrow)
            units.take(byte(i));
        else if (i + 1 < bytes.size()) {
            units.take(byte(i) | byte(i + 1) << 8);
            ++i;
        }
    }
    units.flush();
    return std::move(units.utf8);
}

} // namespace

TextDecoder TextDecoder::ofCodePage(int codePage)
{
    TextDecoder decoder;
    iconv_t converter = iconv_open("UTF-8", ("CP" + std::to_string(codePage)).c_str());
    if (converter == noConverter)
        converter = iconv_open("UTF-8", "CP1252");
    decoder.mConverter = converter;
    return decoder;
}

TextDecoder::TextDecoder(TextDecoder &&other) noexcept
    : mConverter(std::exchange(other.mConverter, nullptr))
{
}

TextDecoder::~TextDecoder()
{
    if (mConverter && mConverter != noConverter)
        iconv_close(mConverter);
}

std::string TextDecoder::utf8(std::string_view bytes) const
{
    return mConverter ? fromCodePage(bytes) : fromUnicode(bytes);
}

std::string TextDecoder::fromCodePage(std::string_view bytes) const
{
    std::string text;
    char *from = const_cast<char *>(bytes.data());
    std::size_t left = bytes.size();
    while (left > 0) {
        char buffer[512];
        char *to = buffer;
        std::size_t room = sizeof buffer;
        const bool bad =
            iconv(mConverter, &from, &left, &to, &room) == std::size_t(-1) && errno != E2BIG;
        text.append(buffer, to);
        if (bad) {
            append(text, replacement);
            ++from;
            --left;
        }
    }
    iconv(mConverter, nullptr, nullptr, nullptr, nullptr);
    return text;
}

} // namespace jet
