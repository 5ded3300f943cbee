// Label: unit
#include "catalogue/cleanorphans.h"
#include "catalogue/ids.h"
#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

/// The rules that all writers of the catalogue share: ids, quoting, the clean-up of orphans.
class tst_CleanOrphans : public QObject
{
    Q_OBJECT

private:
    // Ids of artists, tracks, titles.
    QString left() const
    {
        return mCatalogue
            ->rows("select group_concat(id) from (select id from artiesten order by id) union all "
                   "select group_concat(id) from (select id from tracks order by id) union all "
                   "select group_concat(id) from (select id from cdtitels order by id)")
            .replaceInStrings(u"NULL"_s, QString())
            .join(u' ');
    }

    std::unique_ptr<TestCatalogue> mCatalogue;
    std::unique_ptr<ScriptedDesktop> mDesktop;

private slots:
    void init()
    {
        mCatalogue.reset();
        mCatalogue = std::make_unique<TestCatalogue>();
        mDesktop = std::make_unique<ScriptedDesktop>();
        // Album 1 by artist 1 with track 1; compilation 2 with track 2 by artist 2 and track 1.
        mCatalogue->exec(
            "insert into artiesten values (1,'one'),(2,'two');"
            "insert into tracks values (1,1,'a',NULL,NULL),(2,2,'b',NULL,NULL);"
            "insert into cdtitels values (1,'album',1,'E',NULL,NULL),(2,'comp',NULL,'V',NULL,NULL);"
            "insert into compactdiscs values (1,1,1,1,1,NULL),(2,2,1,1,2,NULL),(3,2,1,2,1,NULL);"
            "insert into mp3collections values (1,'/m','c');"
            "insert into mp3files values (1,1,'f',99)");
    }

    void cleans_data()
    {
        const DataRows<QString, QString> row("before", "left");
        row("nothing to clean", "", "1,2 1,2 1,2");
        row("album deleted, artist on a compilation",
            "delete from compactdiscs where cdtitels_id=1; delete from cdtitels where id=1",
            "1,2 1,2 2");
        row("all rows of a title deleted", "delete from compactdiscs where cdtitels_id=2", "1 1 1");
        row("all deleted", "delete from compactdiscs", "  "); // one pass takes the artists too
        row("never linked",
            "insert into artiesten values (3,'x'); insert into tracks values (3,3,'x',NULL,NULL)",
            "1,2 1,2 1,2");
        row("artist of an album alone", "update tracks set artiest_id=2", "1,2 1,2 1,2");
        row("no artist", "update cdtitels set artiest_id=NULL; update tracks set artiest_id=2",
            "2 1,2 1,2");
        row("link to nothing", "insert into compactdiscs values (4,NULL,1,1,NULL,NULL)",
            "1,2 1,2 1,2");
    }

    void cleans()
    {
        QFETCH(QString, before);
        mCatalogue->exec(before);
        CleanOrphans();
        QTEST(left(), "left");
        QCOMPARE(mCatalogue->count("select count(*) from mp3files"), 1);
        CleanOrphans();
        QTEST(left(), "left");
    }

    void errorIsShownAndGoesNoFurther()
    {
        mCatalogue->exec("delete from compactdiscs; create trigger t before delete on artiesten "
                         "begin select raise(abort,'kept'); end");
        mDesktop->expectBox(u"error [Systeemfout] -2147217873 - "_s);
        CleanOrphans();
        mDesktop->verifyAllCame();
        QVERIFY(mDesktop->boxes[0].contains(u"kept"));
        // The transaction is open still, and taken back before something else is written.
        QCOMPARE(left(), u"1,2 1,2 1,2"_s);
        gConnection->Execute(u"insert into artiesten values (3,'x')"_s);
        QCOMPARE(left(), u"1,2,3 1,2 1,2"_s);
    }

    void firstAndNextIds()
    {
        const auto next = [] { return nextId(Table::Tracks); };
        QCOMPARE(next(), 3);
        mCatalogue->exec("delete from tracks where id=2");
        QCOMPARE(next(), 2);
        mCatalogue->exec("delete from tracks");
        QCOMPARE(next(), 1);
    }

    void quotes()
    {
        const auto roundTrip = [](const QString &literal) {
            ADODB::Recordset rs;
            rs.Open(u"select "_s + literal + u" as v"_s, *gConnection);
            return rs.Fields(u"v").Value();
        };
        for (const QString &text : texts("x", "''", "'; delete from artiesten --", "50%2 off %1",
                                         "\"q\"", "back\\slash")) {
            QCOMPARE(roundTrip(quoted(text)).toText(), text);
            QCOMPARE(roundTrip(u'\'' + doubled(text) + u'\'').toText(), text);
            QCOMPARE(roundTrip(quotedOrNull(text)).toText(), text);
        }
        QVERIFY(roundTrip(quotedOrNull({})).isNull() && roundTrip(numberOrNull({})).isNull());
        QCOMPARE(roundTrip(numberOrNull(u"1985"_s)).toLong(), 1985);
    }
};

QTEST_GUILESS_MAIN(tst_CleanOrphans)
#include "tst_CleanOrphans.moc"
