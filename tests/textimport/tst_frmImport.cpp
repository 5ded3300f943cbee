// Label: screen
#include "controls/DBListViewCTL.h"
#include "platform/ado/recordset.h"
#include "shell/services/browser.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/importfixture.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"
#include "textimport/filereading.h"
#include "textimport/frmImport.h"

#include <QLabel>
#include <QPushButton>
#include <QTest>

/// The review, and the load that it starts.
class tst_frmImport : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void showsTheTracks_data();
    void showsTheTracks();
    void columnsFollowTheWidth();
    void closingEndsTheImport();
    void aLoadRefreshesTheBrowser();
    void aCancelledLoadCanBeRepeated();
    void aFailedLoadTellsTwice_data();
    void aFailedLoadTellsTwice();

private:
    void review(const QByteArray &content);
    void load();
    DBListViewCTL *list() const
    {
        return mReview->findChild<DBListViewCTL *>(QStringLiteral("ImportListView"));
    }

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
    std::unique_ptr<TestFrame> mFrame;
    QPointer<frmImport> mReview;
};

namespace
{

/// Stands for the browser.
class CountingBrowser : public Form, public Browser
{
public:
    CountingBrowser() : Form(QStringLiteral("frmCDList")) {}
    void RefreshLists() override { ++refreshed; }
    int refreshed = 0;
};

const QByteArray twoTracks = "x\na*t*Pop*1985\nb*u**\n";

} // namespace

void tst_frmImport::init()
{
    gLanguage = languageEnglish;
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
    mFrame = std::make_unique<TestFrame>();
}

void tst_frmImport::cleanup()
{
    if (mReview)
        mReview->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    mFrame.reset();
    mCatalogue.reset();
    mDesktop->verifyAllCame();
    mDesktop.reset();
}

void tst_frmImport::review(const QByteArray &content)
{
    chooseImport('C', writeFile(mCatalogue->path(QStringLiteral("in.txt")), content));
    FileReading().run();
    setImportEnabled(false);
    setFramePointer(vbHourglass);
    mReview = &defaultInstance<frmImport>();
    mReview->Show();
    QVERIFY(QTest::qWaitForWindowExposed(mReview));
}

void tst_frmImport::load()
{
    mDesktop->expectModal(QStringLiteral("frmImportDBBusy"));
    mReview->findChild<QPushButton *>(QStringLiteral("StartDBImport"))->click();
    mDesktop->verifyAllCame();
}

void tst_frmImport::showsTheTracks_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QStringList>("heads");
    QTest::newRow("English") << languageEnglish
                             << texts("Nr", "Artist", "Title", "Genre", "Hityear", "CD-title",
                                      "CD-nr", "Disknr", "Track");
    QTest::newRow("Dutch") << languageDutch
                           << texts("Nr", "Artiest", "Titel", "Genre", "Hitjaar", "CD-titel",
                                    "CD-nr", "Disknr", "Tracknr");
}

void tst_frmImport::showsTheTracks()
{
    QFETCH(int, language);
    QFETCH(QStringList, heads);
    gLanguage = language;
    review(twoTracks);
    QStringList shown, row;
    for (int i = 1; i <= list()->ColumnHeaders().Count(); ++i) {
        shown.append(list()->ColumnHeaders().Item(i).Text());
        row.append(list()->ListItems().Item(1).SubItems(i - 1));
    }
    QCOMPARE(shown, heads);
    QCOMPARE(list()->ListItems().Count(), 2);
    QCOMPARE(row.join(QLatin1Char('|')), QStringLiteral("1|A|T|Pop|1985|X|2|1|1"));
    QVERIFY(!mFrame->hourglass());
    QVERIFY(mReview->cursor().shape() != Qt::WaitCursor);
}

void tst_frmImport::columnsFollowTheWidth()
{
    review(twoTracks);
    const auto total = [this] {
        int width = 0;
        for (int i = 1; i <= list()->ColumnHeaders().Count(); ++i)
            width += list()->ColumnHeaders().Item(i).Width();
        return width;
    };
    for (const int width : {600, 900, 1400}) {
        mReview->resize(width, 400);
        QTRY_VERIFY(total() <= list()->viewport()->width());
        QTRY_VERIFY(total() > list()->width() * 9 / 10);
    }
}

void tst_frmImport::closingEndsTheImport()
{
    review(twoTracks);
    QVERIFY(!mFrame->importEnabled);
    mReview->close();
    QVERIFY(mFrame->importEnabled);
    QVERIFY(!gImportRecords);
}

void tst_frmImport::aLoadRefreshesTheBrowser()
{
    CountingBrowser browser;
    review(twoTracks);
    mDesktop->expectBox(QStringLiteral("Number of imported tracks: 2"));
    load();
    QCOMPARE(browser.refreshed, 1);
    QVERIFY(!mReview || mReview->isUnloaded());
    QVERIFY(!gImportRecords);
    QVERIFY(mFrame->importEnabled);
    QVERIFY(!mFrame->hourglass());
}

void tst_frmImport::aCancelledLoadCanBeRepeated()
{
    CountingBrowser browser;
    mCatalogue->exec(QStringLiteral("insert into CDTitels values (1,'X',NULL,'V',NULL,NULL)"));
    review(twoTracks);
    mDesktop->expectBox(QStringLiteral("yes-no-cancel"), vbCancel);
    mDesktop->expectBox(QStringLiteral("Cancelled importing. There were no discs imported!"));
    load();
    QCOMPARE(browser.refreshed, 0);
    QVERIFY(!mReview->isUnloaded());
    QVERIFY(!mFrame->importEnabled);
    QVERIFY(!mFrame->hourglass());
    mDesktop->expectBox(QStringLiteral("yes-no-cancel"), vbYes);
    mDesktop->expectBox(QStringLiteral("Number of imported tracks: 2"));
    load();
    QCOMPARE(browser.refreshed, 1);
}

void tst_frmImport::aFailedLoadTellsTwice_data()
{
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QString>("meanwhile");
    QTest::addColumn<QString>("number");
    QTest::newRow("refused values") << twoTracks << "insert into CompactDiscs(ID) values (2)"
                                    << "-2147217873 - ";
    QTest::newRow("refused statement") << QByteArray("x\na*t*R 'n R*\n") << ""
                                       << "-2147217900 - ";
}

void tst_frmImport::aFailedLoadTellsTwice()
{
    QFETCH(QByteArray, content);
    QFETCH(QString, meanwhile);
    QFETCH(QString, number);
    review(content);
    mCatalogue->exec(meanwhile);
    mDesktop->expectBox(number);
    mDesktop->expectBox(number);
    load();
    QCOMPARE(mDesktop->boxes.value(0), mDesktop->boxes.value(1));
    QCOMPARE(mCatalogue->count(QStringLiteral("select count(*) from Artiesten")), 0);
    QVERIFY(!mReview->isUnloaded());
    QVERIFY(mFrame->hourglass()); // by design
    gConnection->Execute(QStringLiteral("insert into Artiesten(ID,Naam) values (1,'kept')"));
    QCOMPARE(mCatalogue->count(QStringLiteral("select count(*) from Artiesten")), 1);
}

QTEST_MAIN(tst_frmImport)
#include "tst_frmImport.moc"
