#pragma once

#include <cstddef>

/// The two tables behind GetMessage.
namespace messagetable
{

struct Message {
    const char *key;
    const char *english;
    const char *dutch;
};

extern const Message fixedTexts[]; // searched first
extern const std::size_t fixedTextCount;

extern const Message furtherTexts[];
extern const std::size_t furtherTextCount;

} // namespace messagetable
