// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "platform/ado/recordset.h"
#include "support/countingbrowser.h"
#include "support/importfixture.h"
#include "textimport/filereading.h"
#include "textimport/frmImport.h"

#include <QPushButton>

namespace
{

const QByteArray twoTracks = "x\na*t*Pop*1985\nb*u**\n";

} // namespace

/// The review, and the load that it starts.
class tst_frmImport : public ImportTest
{
    Q_OBJECT

private:
    void review(const QByteArray &content)
    {
        chooseContent('C', content);
        FileReading().run();
        setImportEnabled(false);
        setFramePointer(vbHourglass);
        mReview = &defaultInstance<frmImport>();
        mReview->Show();
        QVERIFY(QTest::qWaitForWindowExposed(mReview));
    }

    void load()
    {
        mDesktop->expectModal(u"frmImportDBBusy"_s);
        mReview->findChild<QPushButton *>(u"StartDBImport"_s)->click();
        mDesktop->verifyAllCame();
    }

    DBListViewCTL *list() const { return mReview->findChild<DBListViewCTL *>(u"ImportListView"_s); }

    QPointer<frmImport> mReview;

private slots:
    void showsTheTracks()
    {
        gLanguage = languageDutch;
        review(twoTracks);
        QStringList heads, row;
        for (int i = 1; i <= list()->ColumnHeaders().Count(); ++i) {
            heads.append(list()->ColumnHeaders().Item(i).Text());
            row.append(list()->ListItems().Item(1).SubItems(i - 1));
        }
        QCOMPARE(heads, texts("Nr", "Artiest", "Titel", "Genre", "Hitjaar", "CD-titel", "CD-nr",
                              "Disknr", "Tracknr"));
        QCOMPARE(list()->ListItems().Count(), 2);
        QCOMPARE(row.join(u'|'), u"1|A|T|Pop|1985|X|2|1|1"_s);
        QVERIFY(!mFrame->hourglass() && !mFrame->importEnabled);
        mReview->close();
        QVERIFY(mFrame->importEnabled && !gImportRecords);
    }

    void aCancelledLoadCanBeRepeated()
    {
        CountingBrowser browser;
        mCatalogue->exec("insert into CDTitels values (1,'X',NULL,'V',NULL,NULL)");
        review(twoTracks);
        mDesktop->expectBox(u"yes-no-cancel"_s, vbCancel);
        mDesktop->expectBox(u"Cancelled importing. There were no discs imported!"_s);
        load();
        QCOMPARE(browser.refreshed, 0);
        QVERIFY(!mReview->isUnloaded());
        QVERIFY(!mFrame->importEnabled);
        QVERIFY(!mFrame->hourglass());
        mDesktop->expectBox(u"yes-no-cancel"_s, vbYes);
        mDesktop->expectBox(u"Number of imported tracks: 2"_s);
        load();
        QCOMPARE(browser.refreshed, 1);
        QVERIFY(!mReview || mReview->isUnloaded());
        QVERIFY(mFrame->importEnabled && !mFrame->hourglass() && !gImportRecords);
    }

    void aFailedLoadTellsTwice()
    {
        review("x\na*t*R 'n R*\n");
        mDesktop->expectBox(u"-2147217900 - "_s);
        mDesktop->expectBox(u"-2147217900 - "_s);
        load();
        QCOMPARE(mDesktop->boxes.value(0), mDesktop->boxes.value(1));
        QVERIFY(!mReview->isUnloaded());
        QVERIFY(mFrame->hourglass()); // by design
        gConnection->Execute(u"insert into Artiesten(ID,Naam) values (1,'kept')"_s);
        QCOMPARE(mCatalogue->rows("select Naam from Artiesten"), texts("kept"));
    }
};

QTEST_MAIN(tst_frmImport)
#include "tst_frmImport.moc"
