// Label: journey
#include "catalogue/cataloguefile.h"
#include "controls/DBListViewCTL.h"
#include "platform/ado/connection.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/program.h"
#include "support/testcatalogue.h"

#include <QAction>
#include <QCheckBox>
#include <QPushButton>
#include <QStatusBar>
#include <QTabWidget>
#include <QTest>

/// A person reads text files into an empty catalogue and sees them in the browser; all through the
/// menu.
class tst_Import : public QObject
{
    Q_OBJECT

private slots:
    void aFileOfEachFormat_data();
    void aFileOfEachFormat();
    void theQuestionAboutASecondCopy_data();
    void theQuestionAboutASecondCopy();
    void aBrokenFileChangesNothing();
    void deleteAfterImport();

private:
    void start(int language);
    void read(const QByteArray &content, bool albums, bool flat);
    void load(const char *countText, int count);
    void import(const QByteArray &content, bool albums, bool flat, int tracks);
    QStringList column(const char *list, int n) const;

    int mLanguage = languageEnglish;
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Program> mProgram;

private slots:
    void cleanup()
    {
        if (mProgram)
            QVERIFY(mProgram->end());
        mProgram.reset();
        if (mDesktop)
            mDesktop->verifyAllCame();
        mDesktop.reset();
    }
};

namespace
{

const QByteArray compilationNested =
    "The Best Of 1985\n2\n2\nDire Streets\nWalk Of Life\nRock\n1985\n"
    "A-Hé\nTake On Me\n*\n*\n1\nDosikfu\nInto The Groove\nPop\n1985\n";
const QByteArray compilationFlat = "The Best Of 1985\nDire Streets*Walk Of Life*Rock*1985\n"
                                   "A-Hé*Take On Me**\n\nDosikfu*Into The Groove*Pop*1985\n";
const QByteArray albumNested =
    "Pink Freud\nThe Wail\n2\n2\nIn The Flash?\nRock\n1979\nThe Thin Eyes\nRock\n1979\n"
    "1\nHey Yo\nRock\n1979\n";
const QByteArray albumFlat =
    "Pink Freud\nThe Wail\nIn The Flash?*Rock*1979\nThe Thin Eyes*Rock*1979\n*\n"
    "Hey Yo*Rock*1979\n";

} // namespace

void tst_Import::start(int language)
{
    mLanguage = language;
    mDesktop = std::make_unique<ScriptedDesktop>();
    cataloguefile::create(mDesktop->folder + QStringLiteral("/Compact4.orv"));
    storeLanguage(language);
    mProgram = std::make_unique<Program>(*mDesktop);
    QVERIFY(mProgram->start());
    if (Form *help = mProgram->screen("frmHelp"))
        help->Unload();
}

// The wizard, from the menu to the review or to the boxes of a refusal.
void tst_Import::read(const QByteArray &content, bool albums, bool flat)
{
    mDesktop->expectFile(writeFile(mDesktop->folder + QStringLiteral("/tracks.txt"), content));
    mProgram->choose("Import");
    QVERIFY(!mProgram->entry("Import")->isEnabled());
    QVERIFY(!mProgram->control<QPushButton>("frmImportWizard", "cmdImport")->isEnabled());
    mProgram->control<QPushButton>("frmImportWizard", "cmdBrowse")->click();
    if (albums)
        mProgram->control<QCheckBox>("frmImportWizard", "Enkel")->click();
    if (flat)
        mProgram->control<QCheckBox>("frmImportWizard", "Plat")->click();
    mDesktop->expectModal(QStringLiteral("frmImportBusy"));
    mProgram->control<QPushButton>("frmImportWizard", "cmdImport")->click();
}

void tst_Import::load(const char *countText, int count)
{
    QVERIFY(!mProgram->entry("Import")->isEnabled());
    mDesktop->expectModal(QStringLiteral("frmImportDBBusy"));
    mDesktop->expectBox(GetMessage(countText) + (count >= 0 ? QString::number(count) : QString()));
    mProgram->control<QPushButton>("frmImport", "StartDBImport")->click();
}

void tst_Import::import(const QByteArray &content, bool albums, bool flat, int tracks)
{
    read(content, albums, flat);
    QCOMPARE(mProgram->control<DBListViewCTL>("frmImport", "ImportListView")->ListItems().Count(),
             tracks);
    load("MsgNumImpTracks", tracks);
    QVERIFY(!mProgram->screen("frmImport"));
    QVERIFY(mProgram->entry("Import")->isEnabled());
}

QStringList tst_Import::column(const char *name, int n) const
{
    auto *list = mProgram->control<DBListViewCTL>("frmCDList", name);
    QStringList found;
    for (int i = 1; i <= list->ListItems().Count(); ++i)
        found.append(list->ListItems().Item(i).SubItems(n));
    return found;
}

void tst_Import::aFileOfEachFormat_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<bool>("albums");
    QTest::addColumn<bool>("flat");
    for (const int language : {languageEnglish, languageDutch}) {
        const QByteArray in = language == languageDutch ? ", Dutch" : ", English";
        QTest::newRow(QByteArray("compilations, nested").append(in))
            << language << compilationNested << false << false;
        QTest::newRow(QByteArray("compilations, flat").append(in))
            << language << compilationFlat << false << true;
        QTest::newRow(QByteArray("albums, nested").append(in))
            << language << albumNested << true << false;
        QTest::newRow(QByteArray("albums, flat").append(in))
            << language << albumFlat << true << true;
    }
}

void tst_Import::aFileOfEachFormat()
{
    QFETCH(int, language);
    QFETCH(QByteArray, content);
    QFETCH(bool, albums);
    QFETCH(bool, flat);
    start(language);
    import(content, albums, flat, 3);
    if (albums) {
        QCOMPARE(column("SngList", 1), texts("Pink Freud"));
        QCOMPARE(column("SngList", 2), texts("The Wail"));
    } else {
        QCOMPARE(column("ColList", 1), texts("The Best Of 1985"));
        mProgram->control<QTabWidget>("frmCDList", "CDTab")->setCurrentIndex(2);
        QCOMPARE(mProgram->control<QStatusBar>("frmCDList", "TheStatusBar")->currentMessage(),
                 GetMessage("DiffTracks") + QLatin1Char('3'));
    }
}

void tst_Import::theQuestionAboutASecondCopy_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<int>("answer");
    QTest::addColumn<int>("titles");
    for (const int language : {languageEnglish, languageDutch}) {
        const QByteArray in = language == languageDutch ? ", Dutch" : ", English";
        QTest::newRow(QByteArray("Yes").append(in)) << language << int(vbYes) << 2;
        QTest::newRow(QByteArray("No").append(in)) << language << int(vbNo) << 1;
        QTest::newRow(QByteArray("Cancel").append(in)) << language << int(vbCancel) << 1;
    }
}

void tst_Import::theQuestionAboutASecondCopy()
{
    QFETCH(int, language);
    QFETCH(int, answer);
    start(language);
    import(albumNested, true, false, 3);
    read(albumFlat, true, true);
    mDesktop->expectBox(GetMessage("QuestImpAlbPart1") + QStringLiteral("Pink Freud") +
                            GetMessage("QuestImpAlbPart2") + QStringLiteral("The Wail") +
                            GetMessage("QuestImpAlbPart3"),
                        BoxAnswer(answer));
    if (answer == vbCancel)
        load("MsgImpCancel", -1);
    else
        load("MsgNumImpTracks", answer == vbYes ? 3 : 0);
    QCOMPARE(bool(mProgram->screen("frmImport")), answer == vbCancel);
    QTEST(int(column("SngList", 2).size()), "titles");
    if (Form *review = mProgram->screen("frmImport"))
        QVERIFY(review->Unload());
    QVERIFY(mProgram->entry("Import")->isEnabled());
}

void tst_Import::aBrokenFileChangesNothing()
{
    start(languageEnglish);
    mDesktop->expectBox(QStringLiteral("error [File error] Error at line 7: Invalid year found!"));
    mDesktop->expectBox(QStringLiteral("Error at line 7: Invalid file format!"));
    read("Pink Freud\nThe Wail\n1\n1\nIn\n\n79\n", true, false);
    mDesktop->verifyAllCame();
    QVERIFY(!mProgram->screen("frmImport"));
    QVERIFY(mProgram->entry("Import")->isEnabled());
    QVERIFY(column("SngList", 1).isEmpty());
}

void tst_Import::deleteAfterImport()
{
    start(languageDutch);
    import(albumNested, true, false, 3);
    import(compilationFlat, false, true, 3);
    mProgram->control<QTabWidget>("frmCDList", "CDTab")->setCurrentIndex(1);
    mDesktop->expectBox(
        QStringLiteral("yes-no [Verwijderen] Wilt U inderdaad deze CD definitief verwijderen?"),
        vbYes);
    mProgram->control<QPushButton>("frmCDList", "cmdDelete")->click();
    QVERIFY(column("SngList", 1).isEmpty());
    mProgram->choose("mnuUpdate");
    QVERIFY(mProgram->end());
    openConnection(mDesktop->folder + QStringLiteral("/Compact4.orv"));
    QCOMPARE(gConnection->housekeeping(
                 "select group_concat(Naam, '|') from (select Naam from Artiesten order by ID)"),
             QStringLiteral("Dire Streets|A-hé|Dosikfu"));
    gConnection.reset();
}

QTEST_MAIN(tst_Import)
#include "tst_Import.moc"
