#pragma once

#include <QStringView>
#include <string>
#include <string_view>
#include <vector>

namespace ADODB
{

/// A statement of the screens made fit for SQLite: its words with a "?" in the place of each
/// literal, so that statements that differ in their values alone share one prepared statement.
///
/// What it mends: the alias of a DELETE gets its "as", left() is quoted, max(id+1) becomes
/// max(id)+1 (which an index serves), of a SHAPE command the statement in its braces is left,
/// without repeats. What it refuses, as the engine that the statements were written for did: a
/// second statement, a comment, anything behind the one row of VALUES, "||", parameters, numbers
/// glued to words, commands that were not in its language (PRAGMA, ATTACH, COMMIT).
class Dialect
{
public:
    struct Literal {
        enum Kind { Text, Integer, Real } kind;
        std::size_t offset = 0, size = 0; // of a text, in texts()
        qint64 integer = 0;
        double real = 0;
    };

    /// Takes a statement; sql() and literals() hold until the next call. Throws Error errSyntax.
    void translate(QStringView statement);

    const std::string &sql() const { return mSql; }
    const std::vector<Literal> &literals() const { return mLiterals; }
    std::string_view text(const Literal &l) const { return {mTexts.data() + l.offset, l.size}; }

private:
    void translatePiece(QStringView s);
    void word(QStringView s);
    void otherSign(QStringView s);
    void quoted(QStringView s);
    void number(QStringView s);
    void sign(QStringView s);
    void afterWord(QStringView s, QStringView w);
    bool maxOfSum(QStringView s);
    void deleteAlias(QStringView w);
    void literalText(QStringView s, char16_t quote);
    bool liftsHere() const { return mLifts && !mOrdinals.back(); }
    [[noreturn]] void refuse(const QString &why) const;

    std::string mSql, mTexts;
    std::vector<Literal> mLiterals;

    // Where in the statement the scan stands.
    qsizetype mAt = 0;
    bool mLifts = true;          // the statement is one that may hold parameters
    bool mEnded = false;         // a ";" was seen
    std::vector<bool> mOrdinals; // for each open parenthesis: whether behind ORDER BY or GROUP BY
    enum class Values { None, Expected, Inside, Behind } mValues = Values::None;
    enum class Delete { None, From, Table, Done } mDelete = Delete::None;
};

} // namespace ADODB
