// Label: unit
#include "catalogue/cleanorphans.h"
#include "catalogue/ids.h"
#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "shell/services/globals.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QTest>

/// The rules that all writers of the catalogue share: ids, quoting, the clean-up of orphans.
class tst_CleanOrphans : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleans_data();
    void cleans();
    void errorIsShownAndGoesNoFurther();
    void joinsARunningRoutine();
    void withoutAConnection();
    void firstAndNextIds_data();
    void firstAndNextIds();
    void quotes_data();
    void quotes();

private:
    QString left() const; // ids of artists, tracks, titles
    std::unique_ptr<TestCatalogue> mCatalogue;
    std::unique_ptr<ScriptedDesktop> mDesktop;
};

void tst_CleanOrphans::init()
{
    mCatalogue.reset();
    mCatalogue = std::make_unique<TestCatalogue>();
    mDesktop = std::make_unique<ScriptedDesktop>();
    // Album 1 by artist 1 with track 1; compilation 2 with track 2 by artist 2 and track 1.
    mCatalogue->exec(QStringLiteral(
        "insert into artiesten values (1,'one'),(2,'two');"
        "insert into tracks values (1,1,'a',NULL,NULL),(2,2,'b',NULL,NULL);"
        "insert into cdtitels values (1,'album',1,'E',NULL,NULL),(2,'comp',NULL,'V',NULL,NULL);"
        "insert into compactdiscs values (1,1,1,1,1,NULL),(2,2,1,1,2,NULL),(3,2,1,2,1,NULL);"
        "insert into mp3collections values (1,'/m','c');"
        "insert into mp3files values (1,1,'f',99)"));
}

QString tst_CleanOrphans::left() const
{
    QStringList all;
    for (const char *table : {"artiesten", "tracks", "cdtitels"})
        all.append(mCatalogue
                       ->rows(QLatin1String("select id from ") + QLatin1String(table) +
                              QLatin1String(" order by id"))
                       .join(QLatin1Char(',')));
    return all.join(QLatin1Char(' '));
}

void tst_CleanOrphans::cleans_data()
{
    QTest::addColumn<QString>("before");
    QTest::addColumn<QString>("left");
    const auto row = [](const char *name, const char *before, const char *left) {
        QTest::newRow(name) << QString::fromLatin1(before) << QString::fromLatin1(left);
    };
    row("nothing to clean", "", "1,2 1,2 1,2");
    row("album deleted, artist on a compilation",
        "delete from compactdiscs where cdtitels_id=1; delete from cdtitels where id=1",
        "1,2 1,2 2");
    row("compilation deleted",
        "delete from compactdiscs where cdtitels_id=2; delete from cdtitels where id=2", "1 1 1");
    row("all rows of a title deleted", "delete from compactdiscs where cdtitels_id=2", "1 1 1");
    row("all deleted", "delete from compactdiscs", "  "); // one pass takes the artists too
    row("never linked",
        "insert into artiesten values (3,'x'); insert into tracks values (3,3,'x',NULL,NULL)",
        "1,2 1,2 1,2");
    row("artist of an album alone", "update tracks set artiest_id=2", "1,2 1,2 1,2");
    row("no artist", "update cdtitels set artiest_id=NULL; update tracks set artiest_id=2",
        "2 1,2 1,2");
    row("link to nothing", "insert into compactdiscs values (4,NULL,1,1,NULL,NULL)", "1,2 1,2 1,2");
}

void tst_CleanOrphans::cleans()
{
    QFETCH(QString, before);
    mCatalogue->exec(before);
    CleanOrphans();
    QTEST(left(), "left");
    QCOMPARE(mCatalogue->count(QStringLiteral("select count(*) from mp3files")), 1);
    CleanOrphans();
    QTEST(left(), "left");
}

void tst_CleanOrphans::errorIsShownAndGoesNoFurther()
{
    mCatalogue->exec(
        QStringLiteral("delete from compactdiscs; create trigger t before delete on artiesten "
                       "begin select raise(abort,'kept'); end"));
    for (const int language : {1, 19}) {
        gLanguage = language;
        mDesktop->expectBox(QStringLiteral("error [Systeemfout] -2147217873 - "));
        CleanOrphans();
    }
    gLanguage = 1;
    mDesktop->verifyAllCame();
    QVERIFY(mDesktop->boxes[0].contains(QStringLiteral("kept")));
    // The transaction is open still, and taken back before something else is written.
    QCOMPARE(left(), QStringLiteral("1,2 1,2 1,2"));
    gConnection->Execute(QStringLiteral("insert into artiesten values (3,'x')"));
    QCOMPARE(left(), QStringLiteral("1,2,3 1,2 1,2"));
}

void tst_CleanOrphans::joinsARunningRoutine()
{
    {
        ADODB::Transaction running(*gConnection);
        gConnection->Execute(QStringLiteral("delete from compactdiscs"));
        CleanOrphans();
        running.RollbackTrans();
    }
    QCOMPARE(left(), QStringLiteral("1,2 1,2 1,2"));
}

void tst_CleanOrphans::withoutAConnection()
{
    gConnection.reset();
    mDesktop->expectBox(QStringLiteral("[Systeemfout] 3704"));
    CleanOrphans();
    mDesktop->verifyAllCame();
}

void tst_CleanOrphans::firstAndNextIds_data()
{
    QTest::addColumn<QString>("statement");
    QTest::addColumn<QByteArray>("field");
    const auto row = [](const char *statement, const char *field) {
        QTest::newRow(statement) << QString::fromLatin1(statement) << QByteArray(field);
    };
    row("Select max(id) + 1 as N from CDTitels", "N");
    row("select max(id+1) as ID from CDtitels", "ID");
    row("SELECT max(id)+1 as id FROM Artiesten", "id");
    row("select max(id+1) as ID from tracks", "ID");
    row("select max(id+1) as ID from CompactDiscs", "ID");
    row("SELECT max(ID)+1 as ID FROM MP3Collections", "ID");
    row("SELECT max(ID)+1 as ID FROM MP3files", "ID");
}

void tst_CleanOrphans::firstAndNextIds()
{
    QFETCH(QString, statement);
    QFETCH(QByteArray, field);
    const QString table = statement.section(QLatin1Char(' '), -1);
    const auto next = [&] { return nextId(statement, QLatin1String(field)); };
    gConnection->Execute(QStringLiteral("delete from ") + table);
    QCOMPARE(next(), 1);
    for (const int id : {5, 6})
        gConnection->Execute(QStringLiteral("insert into ") + table +
                             QStringLiteral("(id) values (") + QString::number(id) + u')');
    QCOMPARE(next(), 7);
    gConnection->Execute(QStringLiteral("delete from ") + table + QStringLiteral(" where id=6"));
    QCOMPARE(next(), 6);
}

void tst_CleanOrphans::quotes_data()
{
    QTest::addColumn<QString>("text");
    for (const char *text : {"", "x", "d'Arc", "''", "'; delete from artiesten --", "50%2 off %1",
                             "\"q\"", "back\\slash", "a\rb"})
        QTest::newRow(text) << QString::fromUtf8(text);
}

void tst_CleanOrphans::quotes()
{
    QFETCH(QString, text);
    const auto roundTrip = [](const QString &literal) {
        ADODB::Recordset rs;
        rs.Open(QStringLiteral("select ") + literal + QStringLiteral(" as v"), *gConnection);
        return rs.Fields(u"v").Value();
    };
    QCOMPARE(roundTrip(quoted(text)).toText(), text);
    QCOMPARE(roundTrip(QLatin1Char('\'') + doubled(text) + QLatin1Char('\'')).toText(), text);
    QCOMPARE(roundTrip(quotedOrNull(text)).isNull(), text.isEmpty());
    QCOMPARE(roundTrip(numberOrNull(text.isEmpty() ? text : QStringLiteral("1985"))).isNull(),
             text.isEmpty());
}

QTEST_GUILESS_MAIN(tst_CleanOrphans)
#include "tst_CleanOrphans.moc"
