#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace text
{

/// A pattern of LIKE, compiled once and matched often: "%" stands for any run of characters, "_"
/// for one. Case does not count in all of Unicode, accents do. Pattern and texts are UTF-8 in NFC.
/// Needs ICU only, so that other programs can load it too.
class LikePattern
{
public:
    explicit LikePattern(std::string_view pattern);

    bool matches(std::string_view text) const;

private:
    template <typename Fold> bool matchesAll(std::string_view text, Fold fold) const;

    std::vector<std::string> mPieces; // between the "%" signs, folded; "_" is the byte anyOne
    bool mOpenStart = false, mOpenEnd = false;
    bool mAscii = true;    // no character of the pattern is outside of ASCII
    bool mPlain = true;    // and none is "_"
    bool mMayHide = false; // an s or k, which others fold into
};

} // namespace text
