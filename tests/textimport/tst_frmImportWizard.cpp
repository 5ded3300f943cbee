// Label: screen
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/importfixture.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"
#include "textimport/frmImportWizard.h"

#include <QCheckBox>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>

class tst_frmImportWizard : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void theNameIsShortened_data();
    void theNameIsShortened();
    void aCancelledDialogChangesNothing();
    void theBoxesArePairs_data();
    void theBoxesArePairs();
    void theFormatIsTaken_data();
    void theFormatIsTaken();
    void theImportEntryIsGuarded();
    void keys();

private:
    template <typename Control> Control *control(const char *name) const
    {
        return mWizard->findChild<Control *>(QLatin1String(name));
    }
    QCheckBox *box(const char *name) const { return control<QCheckBox>(name); }
    void browse(const QString &file);

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
    std::unique_ptr<TestFrame> mFrame;
    QPointer<frmImportWizard> mWizard;
};

void tst_frmImportWizard::init()
{
    gLanguage = languageEnglish;
    gImportFile.clear();
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
    mFrame = std::make_unique<TestFrame>();
    mWizard = &defaultInstance<frmImportWizard>();
    mWizard->Show();
    QVERIFY(QTest::qWaitForWindowActive(mWizard));
}

void tst_frmImportWizard::cleanup()
{
    if (mWizard)
        mWizard->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    mFrame.reset();
    mCatalogue.reset();
    mDesktop->verifyAllCame();
    mDesktop.reset();
}

void tst_frmImportWizard::browse(const QString &file)
{
    mDesktop->expectFile(file);
    control<QPushButton>("cmdBrowse")->click();
}

void tst_frmImportWizard::theNameIsShortened_data()
{
    QTest::addColumn<QString>("file");
    QTest::addColumn<QString>("shown");
    QTest::newRow("20 characters") << "/abcdefghijklmno.txt"
                                   << "/abcdefghijklmno.txt";
    QTest::newRow("21 characters") << "/abcdefghijklmnop.txt"
                                   << "/ab.......cdefghijklmnop.txt";
    QTest::newRow("long") << "/home/someone/Music/lists of tracks.txt"
                          << "/ho.......ists of tracks.txt";
}

void tst_frmImportWizard::theNameIsShortened()
{
    QFETCH(QString, file);
    QVERIFY(!control<QPushButton>("cmdImport")->isEnabled());
    browse(file);
    QTEST(control<QLineEdit>("txtFileName")->text(), "shown");
    QCOMPARE(gImportFile, file);
    QVERIFY(control<QPushButton>("cmdImport")->isEnabled());
    QVERIFY(control<QLineEdit>("txtFileName")->isReadOnly());
}

void tst_frmImportWizard::aCancelledDialogChangesNothing()
{
    browse({});
    QVERIFY(!control<QPushButton>("cmdImport")->isEnabled());
    browse(QStringLiteral("/a.txt"));
    browse({});
    QCOMPARE(gImportFile, QStringLiteral("/a.txt"));
    QCOMPARE(control<QLineEdit>("txtFileName")->text(), QStringLiteral("/a.txt"));
}

void tst_frmImportWizard::theBoxesArePairs_data()
{
    QTest::addColumn<QByteArray>("first");
    QTest::addColumn<QByteArray>("second");
    QTest::newRow("data") << QByteArray("Verzamel") << QByteArray("Enkel");
    QTest::newRow("format") << QByteArray("Genest") << QByteArray("Plat");
}

void tst_frmImportWizard::theBoxesArePairs()
{
    QFETCH(QByteArray, first);
    QFETCH(QByteArray, second);
    QCheckBox *set = box(first), *clear = box(second);
    QVERIFY(set->isChecked() && !clear->isChecked());
    for (QCheckBox *clicked : {set, set, clear, clear, set, clear}) {
        const bool was = clicked->isChecked();
        clicked->click();
        QCOMPARE(clicked->isChecked(), !was);
        QVERIFY(set->isChecked() != clear->isChecked());
    }
}

void tst_frmImportWizard::theFormatIsTaken_data()
{
    QTest::addColumn<bool>("albums");
    QTest::addColumn<bool>("flat");
    QTest::addColumn<char>("format");
    QTest::newRow("A") << false << false << 'A';
    QTest::newRow("B") << true << false << 'B';
    QTest::newRow("C") << false << true << 'C';
    QTest::newRow("D") << true << true << 'D';
}

void tst_frmImportWizard::theFormatIsTaken()
{
    QFETCH(bool, albums);
    QFETCH(bool, flat);
    QFETCH(char, format);
    chooseImport(format == 'A' ? 'D' : 'A', {}); // of the last time
    browse(QStringLiteral("/no such file.txt"));
    box("Enkel")->setChecked(albums);
    box("Plat")->setChecked(flat);
    mDesktop->expectModal(QStringLiteral("frmImportBusy"), [](Form &busy) { busy.Unload(); });
    control<QPushButton>("cmdImport")->click();
    QCOMPARE(gImportCompilationNested, format == 'A');
    QCOMPARE(gImportAlbumNested, format == 'B');
    QCOMPARE(gImportCompilationFlat, format == 'C');
    QCOMPARE(gImportAlbumFlat, format == 'D');
}

void tst_frmImportWizard::theImportEntryIsGuarded()
{
    QVERIFY(!mFrame->importEnabled);
    control<QPushButton>("cmdCancel")->click();
    QVERIFY(mFrame->importEnabled);
    QVERIFY(mWizard->isUnloaded());
    QVERIFY(&defaultInstance<frmImportWizard>() != mWizard);
    defaultInstance<frmImportWizard>().Load();
    QVERIFY(!mFrame->importEnabled);
    defaultInstance<frmImportWizard>().close();
    QVERIFY(mFrame->importEnabled);
}

void tst_frmImportWizard::keys()
{
    control<QLineEdit>("txtFileName")->setFocus();
    QTest::keyClick(mWizard, Qt::Key_Return); // disabled: nothing
    browse(QStringLiteral("/a.txt"));
    mDesktop->expectModal(QStringLiteral("frmImportBusy"), [](Form &busy) { busy.Unload(); });
    QTest::keyClick(mWizard, Qt::Key_Return);
    mDesktop->verifyAllCame();
    mWizard = &defaultInstance<frmImportWizard>();
    mWizard->Show();
    QTest::keyClick(mWizard, Qt::Key_Escape);
    QVERIFY(mWizard->isUnloaded());
}

QTEST_MAIN(tst_frmImportWizard)
#include "tst_frmImportWizard.moc"
