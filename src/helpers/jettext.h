#pragma once

#include <string>
#include <string_view>

namespace jet
{

/// Texts of a database as UTF-8; what is none in its encoding becomes U+FFFD.
class TextDecoder
{
public:
    /// Of Jet 3, in a code page of Windows; one that the system does not know is taken for 1252.
    static TextDecoder ofCodePage(int codePage);

    /// Of Jet 4: UTF-16, or, behind the bytes FF FE, letters of one byte and of two, with a zero
    /// where the kind changes.
    static TextDecoder ofUnicode() { return {}; }

    TextDecoder(TextDecoder &&other) noexcept;
    TextDecoder &operator=(TextDecoder &&) = delete;
    ~TextDecoder();

    std::string utf8(std::string_view bytes) const;

private:
    TextDecoder() = default;
    std::string fromCodePage(std::string_view bytes) const;

    void *mConverter = nullptr; // of iconv; none for Unicode
};

} // namespace jet
