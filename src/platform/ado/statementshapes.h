#pragma once

#include "platform/ado/literals.h"

#include <QString>
#include <vector>

namespace ADODB
{

/// The last statements that were taken apart, each as its fixed text with gaps where the literals
/// stood. A statement that fits one of them exactly, a literal of the same kind in each gap, is
/// taken apart by comparing instead of reading it word by word: a long load sends the same few
/// statements over and over.
class StatementShapes
{
public:
    /// A lifted literal of a statement: [from, to) with its quotes; quote 0 for a number.
    struct Gap {
        qsizetype from, to;
        char16_t quote;
    };
    using Gaps = std::vector<Gap>;

    void remember(QStringView statement, const Gaps &gaps, const std::string &sql);

    /// The SQL of the shape that fits, its literals read; nullptr and no literals if none does.
    const std::string *match(QStringView statement, Literals &literals);

private:
    struct Shape {
        std::vector<QString> fixed; // one more than gaps
        std::vector<char16_t> quotes;
        std::string sql;
        bool fits(QStringView statement, Literals &literals) const;
    };
    static constexpr std::size_t kept = 32;

    std::vector<Shape> mShapes;
    std::size_t mNext = 0; // where the next one is put
    std::size_t mLast = 0; // the one that fitted last
};

} // namespace ADODB
