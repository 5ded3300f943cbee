#pragma once

#include <QString>
#include <vector>

/// LIKE once more, slow and plain, to hold the fast one against: a table of which starts of the
/// pattern fit which starts of the text, character by character. Case is folded with Qt's tables,
/// not ICU's.
inline bool referenceLike(const QString &pattern, const QString &text)
{
    const auto p = pattern.toUcs4(), t = text.toUcs4();
    std::vector<std::vector<bool>> fits(std::size_t(p.size()) + 1,
                                        std::vector<bool>(std::size_t(t.size()) + 1, false));
    fits[0][0] = true;
    for (std::size_t i = 1; i < fits.size(); ++i) {
        const char32_t c = p[qsizetype(i) - 1];
        fits[i][0] = c == U'%' && fits[i - 1][0];
        for (std::size_t j = 1; j < fits[0].size(); ++j) {
            const bool same = QChar::toCaseFolded(c) == QChar::toCaseFolded(t[qsizetype(j) - 1]);
            if (c == U'%')
                fits[i][j] = fits[i - 1][j] || fits[i][j - 1];
            else
                fits[i][j] = (c == U'_' || same) && fits[i - 1][j - 1];
        }
    }
    return fits.back().back();
}
