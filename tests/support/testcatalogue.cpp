#include "support/testcatalogue.h"

#include "catalogue/cataloguefile.h"
#include "catalogue/connect.h"
#include "platform/ado/connection.h"
#include "platform/ado/sqlfunctions.h"
#include "shell/services/globals.h"

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
        QFile file(folder.filePath(QStringLiteral("empty")));
        cataloguefile::create(file.fileName());
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
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
    gConnection.reset();
}

namespace
{

class SecondConnection
{
public:
    explicit SecondConnection(const QString &file)
    {
        sqlite3_open(file.toUtf8().constData(), &db);
        ADODB::registerFunctions(db);
        sqlite3_busy_timeout(db, 2000);
        sqlite3_exec(db, "PRAGMA synchronous=OFF", nullptr, nullptr, nullptr);
    }
    ~SecondConnection() { sqlite3_close(db); }
    sqlite3 *db = nullptr;
};

} // namespace

void TestCatalogue::exec(const QString &sql)
{
    SecondConnection c(file());
    if (sqlite3_exec(c.db, sql.toUtf8().constData(), nullptr, nullptr, nullptr) != SQLITE_OK)
        QTest::qFail(sqlite3_errmsg(c.db), __FILE__, __LINE__);
}

QStringList TestCatalogue::rows(const QString &sql)
{
    SecondConnection c(file());
    QStringList found;
    const auto take = [](void *to, int columns, char **values, char **) {
        QStringList row;
        for (int i = 0; i < columns; ++i)
            row.append(values[i] ? QString::fromUtf8(values[i]) : QStringLiteral("NULL"));
        static_cast<QStringList *>(to)->append(row.join(QLatin1Char('|')));
        return 0;
    };
    if (sqlite3_exec(c.db, sql.toUtf8().constData(), take, &found, nullptr) != SQLITE_OK)
        QTest::qFail(sqlite3_errmsg(c.db), __FILE__, __LINE__);
    return found;
}

int TestCatalogue::count(const QString &sql)
{
    return rows(sql).value(0).section(QLatin1Char('|'), 0, 0).toInt();
}

QString writeFile(const QString &name, const QByteArray &content)
{
    QFile file(name);
    if (!file.open(QIODevice::WriteOnly) || file.write(content) != content.size())
        QTest::qFail(qPrintable(file.errorString()), __FILE__, __LINE__);
    return name;
}
