#pragma once

#include <cstddef>

namespace text
{

/// Whether the characters [s, s+n) are a number: blanks around, a sign, digits, a point, an
/// exponent
/// ("1985", " -1.5 ", ".5", "1e10"). Works on any character type whose values are code points.
template <typename Char> bool isNumeric(const Char *s, std::size_t n)
{
    const Char *p = s, *end = s + n;
    const auto blank = [](Char c) { return c == Char(' ') || c == Char('\t'); };
    const auto digits = [&] {
        const Char *from = p;
        while (p < end && *p >= Char('0') && *p <= Char('9'))
            ++p;
        return p - from;
    };
    const auto sign = [&] {
        if (p < end && (*p == Char('+') || *p == Char('-')))
            ++p;
    };
    while (p < end && blank(*p))
        ++p;
    sign();
    auto mantissa = digits();
    if (p < end && *p == Char('.')) {
        ++p;
        mantissa += digits();
    }
    if (mantissa == 0)
        return false;
    if (p < end && (*p == Char('e') || *p == Char('E'))) {
        ++p;
        sign();
        if (digits() == 0)
            return false;
    }
    while (p < end && blank(*p))
        ++p;
    return p == end;
}

} // namespace text
