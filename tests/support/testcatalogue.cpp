#include "support/testcatalogue.h"

#include "catalogue/cataloguefile.h"
#include "catalogue/connect.h"
#include "platform/ado/connection.h"
#include "platform/ado/sqlfunctions.h"
#include "services/globals.h"

#include <QFile>
#include <QTest>
#include <sqlite3.h>

void openConnection(const QString &file)
{
    gDatabasePath = file;
    gConnection = std::make_unique<ADODB::Connection>();
    configureConnection(*gConnection, file);
    gConnection->Open();
    gConnection->housekeeping("PRAGMA synchronous=OFF"); // no test cuts the power
}

namespace
{

// Made once by the program's own code, then written from memory: many tests want one.
const QByteArray &emptyCatalogue()
{
    static const QByteArray bytes = [] {
        const QTemporaryDir folder;
        const QString file = folder.filePath(u"empty"_s);
        cataloguefile::create(file);
        return readFile(file);
    }();
    return bytes;
}

} // namespace

TestCatalogue::TestCatalogue()
{
    writeFile(file(), emptyCatalogue());
    openConnection(file());
}

TestCatalogue::~TestCatalogue()
{
    gConnection = std::make_unique<ADODB::Connection>();
}

OtherProgram::OtherProgram(const QString &file)
{
    sqlite3_open(file.toUtf8().constData(), &db);
    ADODB::registerFunctions(db);
}

OtherProgram::~OtherProgram()
{
    sqlite3_close(db);
}

int OtherProgram::run(const QByteArray &sql) const
{
    return sqlite3_exec(db, sql.constData(), nullptr, nullptr, nullptr);
}

namespace
{

void makeQuick(const OtherProgram &other)
{
    sqlite3_busy_timeout(other.db, 2000);
    other.run("PRAGMA synchronous=OFF");
}

} // namespace

void TestCatalogue::exec(const AnyText &sql)
{
    // The program's connection runs no trigger of the file, only those of its own.
    if (sql.contains("trigger"_L1)) {
        auto own = QString(sql).replace("create trigger"_L1, "create temp trigger"_L1);
        gConnection->housekeeping(own.toUtf8().constData());
        return;
    }
    const OtherProgram c(file());
    makeQuick(c);
    if (c.run(sql.toUtf8()) != SQLITE_OK)
        QTest::qFail(sqlite3_errmsg(c.db), __FILE__, __LINE__);
}

QStringList TestCatalogue::rows(const AnyText &sql)
{
    const OtherProgram c(file());
    makeQuick(c);
    QStringList found;
    const auto take = [](void *to, int columns, char **values, char **) {
        QStringList row;
        for (int i = 0; i < columns; ++i)
            row.append(values[i] ? QString::fromUtf8(values[i]) : u"NULL"_s);
        static_cast<QStringList *>(to)->append(row.join(u'|'));
        return 0;
    };
    if (sqlite3_exec(c.db, sql.toUtf8().constData(), take, &found, nullptr) != SQLITE_OK)
        QTest::qFail(sqlite3_errmsg(c.db), __FILE__, __LINE__);
    return found;
}

int TestCatalogue::count(const AnyText &sql)
{
    return rows(sql).value(0).section(u'|', 0, 0).toInt();
}

QString writeFile(const QString &name, const QByteArray &content)
{
    QFile file(name);
    if (!file.open(QIODevice::WriteOnly) || file.write(content) != content.size())
        QTest::qFail(qPrintable(file.errorString()), __FILE__, __LINE__);
    return name;
}

QByteArray readFile(const QString &name)
{
    QFile file(name);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("none");
}

int numberOf(const std::function<void()> &fails)
{
    try {
        fails();
    } catch (const Error &error) {
        return error.Number;
    }
    return 0;
}
