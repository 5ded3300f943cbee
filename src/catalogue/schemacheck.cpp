#include "catalogue/schemacheck.h"

#include "platform/ado/columns.h"
#include "platform/ado/recordset.h"
#include "services/messages.h"

#include <QMap>
#include <QRegularExpression>
#include <QSet>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace schemacheck
{

namespace
{

constexpr auto statisticsTable = "sqlite_stat1"_L1;

// A table, an index or whatever else a schema may hold. Names and kind in small letters.
struct Part {
    QString kind, name, table;
    QString shown; // its name as it stands
    QString statement;
};

using Schema = QMap<QString, Part>; // by kind and name: a trigger may be called as its table

QString keyOf(const Part &part)
{
    return part.kind + u' ' + part.name;
}

Schema schemaOf(ADODB::Connection &connection)
{
    // More than any catalogue has: one that somebody prepared shall not fill the memory.
    constexpr int atMost = 100;
    ADODB::Recordset rows = connection.firstRows(
        u"select type as Kind, name as Name, tbl_name as TableName, sql as Statement from sqlite_schema"_s,
        atMost);
    Schema schema;
    for (; !rows.isEOF(); rows.MoveNext()) {
        const auto text = [&](int column) { return rows.Fields(column).Value().toText(); };
        const Part part{text(0).toLower(), text(1).toLower(), text(2).toLower(), text(1), text(3)};
        schema.insert(keyOf(part), part);
    }
    return schema;
}

// Words and signs of a statement; how it is laid out and quoted makes no difference.
QStringList wordsOf(const QString &statement)
{
    static const QRegularExpression word(u"\\w+|[^\\w\\s\"'`\\[\\]]"_s);
    QStringList words;
    for (auto it = word.globalMatch(statement.toLower()); it.hasNext();)
        words.append(it.next().captured());
    return words;
}

QSet<QString> allWords(const Schema &schema)
{
    QSet<QString> words;
    for (const Part &part : schema) {
        const QStringList own = wordsOf(part.statement);
        words.unite(QSet<QString>(own.begin(), own.end()));
    }
    return words;
}

[[noreturn]] void refuse(const char *key, const QString &name)
{
    throw Error(errCannotUse, u"Songcase"_s, GetMessage(key) + name);
}

// Whatever makes a table or an index do more than ours (a condition, a default, a generated column,
// a rule for conflicts) needs a word that none of ours has.
void refuseForeign(const Schema &file, const Schema &ours)
{
    const QSet<QString> known = allWords(ours);
    for (const Part &part : file) {
        const Part own = ours.value(keyOf(part));
        const QStringList words = wordsOf(part.statement);
        const bool plain = std::all_of(words.begin(), words.end(),
                                       [&](const QString &word) { return known.contains(word); });
        if (own.kind != part.kind || own.table != part.table || !plain)
            refuse("xForeignPart", part.kind + u' ' + part.shown);
    }
}

void requireTables(ADODB::Connection &file, const Schema &found, ADODB::Connection &model,
                   const Schema &ours)
{
    for (const Part &part : ours) {
        const bool there = found.contains(keyOf(part));
        if (part.kind != "table"_L1 || (part.name == statisticsTable && !there))
            continue;
        if (!there)
            refuse("xTablesMissing", part.shown);
        const QByteArray name = part.name.toUtf8();
        if (ADODB::columnsOf(file, name) != ADODB::columnsOf(model, name))
            refuse("xTableDiffers", part.shown);
    }
}

// Older versions of the program made fewer or other ones.
QByteArray indexRemedy(const Schema &found, const Schema &ours)
{
    QByteArray remedy;
    for (const Part &part : ours) {
        if (part.kind != "index"_L1 ||
            wordsOf(found.value(keyOf(part)).statement) == wordsOf(part.statement))
            continue;
        remedy +=
            "drop index if exists " + part.name.toUtf8() + ';' + part.statement.toUtf8() + ';';
    }
    return remedy;
}

QString statisticsOf(ADODB::Connection &connection)
{
    return connection.housekeeping(
        "select group_concat(tbl || ' ' || ifnull(idx, '') || ' ' || stat, ';') from "
        "(select tbl, idx, stat from sqlite_stat1 order by lower(tbl), lower(idx), stat limit 100)");
}

QByteArray statisticsRemedy(ADODB::Connection &file, const Schema &found, ADODB::Connection &model)
{
    const QString wanted = statisticsOf(model);
    if (found.contains("table "_L1 + statisticsTable) && statisticsOf(file) == wanted)
        return {};
    // The small table's analysis makes the table of statistics if there is none.
    QByteArray remedy = "analyze MP3Collections; delete from sqlite_stat1;";
    for (const QString &row : wanted.split(u';')) {
        const QByteArray table = row.section(u' ', 0, 0).toUtf8();
        const QByteArray index = row.section(u' ', 1, 1).toUtf8();
        const QByteArray sizes = row.section(u' ', 2).toUtf8();
        remedy += "insert into sqlite_stat1(tbl, idx, stat) values ('" + table + "','" + index +
                  "','" + sizes + "');";
    }
    return remedy + "analyze sqlite_schema;"; // has them read anew
}

} // namespace

QByteArray compare(ADODB::Connection &file, const QByteArray &creation)
{
    ADODB::Connection model;
    model.ConnectionString = u"Data Source=:memory:"_s;
    model.Mode = ADODB::adModeReadWrite;
    model.Open();
    model.housekeeping(creation.constData());
    const Schema ours = schemaOf(model), found = schemaOf(file);
    refuseForeign(found, ours);
    requireTables(file, found, model, ours);
    return indexRemedy(found, ours) + statisticsRemedy(file, found, model);
}

} // namespace schemacheck
