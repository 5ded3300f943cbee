// Label: journey
#include "controls/list/DBListViewCTL.h"
#include "platform/ado/connection.h"
#include "support/journey.h"

#include <QAction>
#include <QCheckBox>
#include <QPushButton>
#include <QStatusBar>
#include <QTabWidget>

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

/// A person reads text files into an empty catalogue and sees them in the browser; all through the
/// menu.
class tst_Import : public Journey
{
    Q_OBJECT

private:
    // The wizard, from the menu to the review or to the boxes of a refusal.
    void read(const QByteArray &content, bool albums, bool flat)
    {
        mDesktop->expectFile(writeFile(mDesktop->folder + u"/tracks.txt"_s, content));
        mProgram->choose("Import");
        QVERIFY(!mProgram->entry("Import")->isEnabled());
        QVERIFY(!mProgram->control<QPushButton>("frmImportWizard", "cmdImport")->isEnabled());
        mProgram->control<QPushButton>("frmImportWizard", "cmdBrowse")->click();
        if (albums)
            mProgram->control<QCheckBox>("frmImportWizard", "Enkel")->click();
        if (flat)
            mProgram->control<QCheckBox>("frmImportWizard", "Plat")->click();
        mDesktop->expectModal(u"frmImportBusy"_s);
        mProgram->control<QPushButton>("frmImportWizard", "cmdImport")->click();
    }

    void load(const char *countText, int count)
    {
        QVERIFY(!mProgram->entry("Import")->isEnabled());
        mDesktop->expectModal(u"frmImportDBBusy"_s);
        mDesktop->expectBox(GetMessage(countText) +
                            (count >= 0 ? QString::number(count) : QString()));
        mProgram->control<QPushButton>("frmImport", "StartDBImport")->click();
    }

    void import(const QByteArray &content, bool albums, bool flat, int tracks)
    {
        read(content, albums, flat);
        QCOMPARE(
            mProgram->control<DBListViewCTL>("frmImport", "ImportListView")->ListItems().Count(),
            tracks);
        load("MsgNumImpTracks", tracks);
        QVERIFY(!mProgram->screen("frmImport"));
        QVERIFY(mProgram->entry("Import")->isEnabled());
    }

private slots:
    void aFileOfEachFormat_data()
    {
        const DataRows<int, QByteArray, bool, bool> row("language", "content", "albums", "flat");
        row("compilations, nested", languageDutch, compilationNested, false, false);
        row("compilations, flat", languageEnglish, compilationFlat, false, true);
        row("albums, nested", languageEnglish, albumNested, true, false);
        row("albums, flat", languageDutch, albumFlat, true, true);
    }

    void aFileOfEachFormat()
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
                     GetMessage("DiffTracks") + u'3');
        }
    }

    void aBrokenFileChangesNothing()
    {
        start(languageEnglish);
        mDesktop->expectBox(u"error [File error] Error at line 7: Invalid year found!"_s);
        mDesktop->expectBox(u"Error at line 7: Invalid file format!"_s);
        read("Pink Freud\nThe Wail\n1\n1\nIn\n\n79\n", true, false);
        mDesktop->verifyAllCame();
        QVERIFY(!mProgram->screen("frmImport"));
        QVERIFY(mProgram->entry("Import")->isEnabled());
        QVERIFY(column("SngList", 1).isEmpty());
    }
};

QTEST_MAIN(tst_Import)
#include "tst_Import.moc"
