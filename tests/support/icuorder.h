#pragma once

#include <string_view>
#include <unicode/ucol.h>

/// The order of texts as ICU itself has it, to hold the program's short ways against.
class IcuOrder
{
public:
    IcuOrder()
    {
        UErrorCode status = U_ZERO_ERROR;
        mCollator = ucol_open("", &status);
        ucol_setStrength(mCollator, UCOL_SECONDARY);
    }
    ~IcuOrder() { ucol_close(mCollator); }
    IcuOrder(const IcuOrder &) = delete;
    IcuOrder &operator=(const IcuOrder &) = delete;

    /// -1, 0 or 1.
    int compare(std::string_view a, std::string_view b) const
    {
        UErrorCode status = U_ZERO_ERROR;
        return ucol_strcollUTF8(mCollator, a.data(), int32_t(a.size()), b.data(), int32_t(b.size()),
                                &status);
    }

private:
    UCollator *mCollator;
};
