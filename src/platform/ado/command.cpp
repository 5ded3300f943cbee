#include "platform/ado/command.h"

#include "platform/ado/preparedstatements.h"
#include "platform/ado/recordset.h"
#include "platform/text/normalform.h"

#include <sqlite3.h>

namespace ADODB
{

namespace
{

int bindText(sqlite3_stmt *s, int place, const QByteArray &utf8)
{
    return sqlite3_bind_text64(s, place, utf8.constData(), sqlite3_uint64(utf8.size()),
                               SQLITE_TRANSIENT, SQLITE_UTF8);
}

struct Bind {
    sqlite3_stmt *s;
    int place;

    int operator()(std::monostate) const { return sqlite3_bind_null(s, place); }
    int operator()(qint64 v) const { return sqlite3_bind_int64(s, place, v); }
    int operator()(double v) const { return sqlite3_bind_double(s, place, v); }
    int operator()(QStringView v) const { return bindText(s, place, text::nfc(v)); }
    int operator()(std::string_view v) const
    {
        if (!text::surelyNfc(v))
            return (*this)(QStringView(text::fromUtf8(v)));
        const char *bytes = v.data() ? v.data() : ""; // else the engine takes it for NULL
        return sqlite3_bind_text64(s, place, bytes, v.size(), SQLITE_STATIC, SQLITE_UTF8);
    }
};

} // namespace

Parameter::Parameter(const Value &value)
{
    if (const auto *whole = std::get_if<qint64>(&value.variant()))
        mValue = *whole;
    else if (const auto *fraction = std::get_if<double>(&value.variant()))
        mValue = *fraction;
    else if (const auto *words = std::get_if<QString>(&value.variant()))
        mValue = QStringView(*words);
}

int Parameter::bind(sqlite3_stmt *statement, int place) const
{
    return std::visit(Bind{statement, place}, mValue);
}

std::shared_ptr<PreparedStatement> Command::prepared()
{
    auto prepared = mPrepared.lock();
    if (!prepared) {
        prepared = mConnection.prepare(std::string(mStatement));
        mPrepared = prepared;
    }
    return prepared;
}

void Command::bind(sqlite3_stmt *statement, std::span<const Parameter> values)
{
    int place = 0;
    for (const Parameter &value : values)
        mConnection.check(value.bind(statement, ++place));
}

Recordset Command::Execute(std::initializer_list<Parameter> values)
{
    return Execute(std::span(values.begin(), values.size()));
}

Recordset Command::Execute(std::span<const Parameter> values)
{
    mConnection.requireOpen();
    const auto statement = prepared();
    const Running running(*statement);
    bind(running.statement(), values);
    Recordset answer;
    if (auto rows = mConnection.fetch(*statement))
        answer.adopt(std::move(rows));
    return answer;
}

Command::Match Command::find(std::initializer_list<Parameter> values)
{
    mConnection.requireOpen();
    const auto statement = prepared();
    const Running running(*statement);
    bind(running.statement(), {values.begin(), values.size()});
    mConnection.settleBefore(statement->readOnly);
    Match match;
    int code = statement->firstStep();
    for (; code == SQLITE_ROW && match.rows < 2; code = sqlite3_step(running.statement())) {
        if (++match.rows == 1)
            match.id = sqlite3_column_int64(running.statement(), 0);
    }
    mConnection.check(code);
    return match;
}

} // namespace ADODB
