// Label: screen
#include "support/importfixture.h"
#include "textimport/frmImportWizard.h"

#include <QCheckBox>
#include <QLineEdit>
#include <QPushButton>

/// The choice of a file and of its format.
class tst_frmImportWizard : public ImportTest
{
    Q_OBJECT

private:
    template <typename Control> Control *control(const char *name) const
    {
        return mWizard->findChild<Control *>(QLatin1String(name));
    }
    QCheckBox *box(const char *name) const { return control<QCheckBox>(name); }

    void browse(const QString &file)
    {
        mDesktop->expectFile(file);
        control<QPushButton>("cmdBrowse")->click();
    }

    QPointer<frmImportWizard> mWizard;

private slots:
    void init()
    {
        ImportTest::init();
        mWizard = &defaultInstance<frmImportWizard>();
        mWizard->Show();
        QVERIFY(QTest::qWaitForWindowActive(mWizard));
    }

    void theNameIsShortened_data()
    {
        const DataRows<QString, QString> row("file", "shown");
        row("20 characters", "/abcdefghijklmno.txt", "/abcdefghijklmno.txt");
        row("21 characters", "/abcdefghijklmnop.txt", "/ab.......cdefghijklmnop.txt");
        row("long", "/home/someone/Music/lists of tracks.txt", "/ho.......ists of tracks.txt");
    }

    void theNameIsShortened()
    {
        QFETCH(QString, file);
        browse({}); // cancelled
        QVERIFY(!control<QPushButton>("cmdImport")->isEnabled());
        browse(file);
        browse({});
        QTEST(control<QLineEdit>("txtFileName")->text(), "shown");
        QCOMPARE(gImportFile, file);
        QVERIFY(control<QPushButton>("cmdImport")->isEnabled());
        QVERIFY(control<QLineEdit>("txtFileName")->isReadOnly());
    }

    void theBoxesArePairs()
    {
        for (const auto &[first, second] : {std::pair("Verzamel", "Enkel"), {"Genest", "Plat"}}) {
            QCheckBox *set = box(first), *clear = box(second);
            QVERIFY(set->isChecked());
            for (QCheckBox *clicked : {set, set, clear, clear, set, clear}) {
                const bool was = clicked->isChecked();
                clicked->click();
                QCOMPARE(clicked->isChecked(), !was);
                QVERIFY(set->isChecked() != clear->isChecked());
            }
        }
    }

    void keys()
    {
        control<QLineEdit>("txtFileName")->setFocus();
        QTest::keyClick(mWizard, Qt::Key_Return); // disabled: nothing
        browse(u"/a.txt"_s);
        mDesktop->expectModal(u"frmImportBusy"_s, [](Form &busy) { busy.Unload(); });
        QTest::keyClick(mWizard, Qt::Key_Return);
        mDesktop->verifyAllCame();
        mWizard = &defaultInstance<frmImportWizard>();
        mWizard->Show();
        QVERIFY(!mFrame->importEnabled);
        QTest::keyClick(mWizard, Qt::Key_Escape);
        QVERIFY(mWizard->isUnloaded() && mFrame->importEnabled);
    }
};

QTEST_MAIN(tst_frmImportWizard)
#include "tst_frmImportWizard.moc"
