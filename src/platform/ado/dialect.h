#pragma once

#include "platform/ado/statementshapes.h"

namespace ADODB
{

/// A statement of the screens made fit for SQLite: its words with a "?" in the place of each
/// literal, so that statements that differ in their values alone share one prepared statement.
///
/// What it mends: the alias of a DELETE gets its "as", left() is quoted, max(id+1) becomes
/// max(id)+1 (which an index serves), of a SHAPE command the statement in its braces is left,
/// without repeats. Of a column LIKE a text it says that it seldom holds, so that the engine begins
/// a join with the table that is searched. What it refuses, as the engine that the statements were
/// written for did: a second statement, a comment, anything behind the one row of VALUES, "||",
/// parameters, numbers glued to words, commands that were not in its language (PRAGMA, ATTACH,
/// COMMIT).
class Dialect
{
public:
    using Literal = ADODB::Literal;

    /// Takes a statement; sql() and literals() hold until the next call. Throws Error errSyntax.
    void translate(QStringView statement);

    const std::string &sql() const { return mKnown ? *mKnown : mSql; }
    const std::vector<Literal> &literals() const { return mLiterals.all(); }
    std::string_view text(const Literal &l) const { return mLiterals.text(l); }

private:
    void begin(QStringView statement);
    void translateShape(QStringView statement);
    void translatePiece(QStringView s);
    void word(QStringView s);
    void otherSign(QStringView s);
    void quoted(QStringView s);
    void keepText(QStringView content, char16_t quote);
    void number(QStringView s);
    void sign(QStringView s);
    void afterWord(QStringView s, QStringView w);
    bool maxOfSum(QStringView s);
    void deleteAlias(QStringView w);
    enum class Between { None, Lower, Upper };
    static Between betweenAfter(Between now, QStringView w);
    bool likeText(QStringView s, QStringView w);
    bool liftsHere() const { return mLifts && !mOrdinals.back(); }
    [[noreturn]] void refuse(const QString &why) const;

    std::string mSql;
    Literals mLiterals;
    StatementShapes mShapes;
    StatementShapes::Gaps mGaps;
    const std::string *mKnown = nullptr; // the SQL of a shape seen before

    // Where in the statement the scan stands.
    qsizetype mAt = 0;
    bool mLifts = true;               // the statement is one that may hold parameters
    bool mEnded = false;              // a ";" was seen
    Between mBetween = Between::None; // what of it an "and" would end
    std::size_t mNameAt = 0;          // in mSql: where the last name of a column begins
    std::vector<bool> mOrdinals; // for each open parenthesis: whether behind ORDER BY or GROUP BY
    enum class Values { None, Expected, Inside, Behind } mValues = Values::None;
    enum class Delete { None, From, Table, Done } mDelete = Delete::None;
};

} // namespace ADODB
