// Label: screen
#include "platform/ado/recordset.h"
#include "support/importfixture.h"
#include "textimport/frmImportBusy.h"

#include <QLabel>
#include <QProgressBar>
#include <QPushButton>
#include <QTimer>

/// The reading of a file behind its progress: what is refused, and that nobody closes it meanwhile.
class tst_frmImportBusy : public ImportTest
{
    Q_OBJECT

private:
    void read()
    {
        mDesktop->expectModal(u"frmImportBusy"_s);
        defaultInstance<frmImportBusy>().ShowModal();
    }
    static Form *review() { return Form::openForms().value(0); }

private slots:
    void refusals_data()
    {
        const DataRows<int, char, QByteArray, QStringList> row("language", "format", "content",
                                                               "boxes");
        row("a fault in the data", languageEnglish, 'C', "x\n*b**\n",
            texts("error [File error] Error at line 2: Found empty line, whereas artist is "
                  "obligatory!",
                  "error [Songcase] Error at line 2: Invalid file format!"));
        row("a fault in the data, Dutch", languageDutch, 'A', "x\n\n",
            texts("error [Bestandsfout] Fout op regel 2: Er werd een getal verwacht maar niet "
                  "gevonden!",
                  "error [Songcase] Fout op regel 2: Onjuist bestandsformaat"));
        row("no such file at all", languageEnglish, 'C', "x\na*b\n",
            texts("error [Songcase] Error at line 2: Invalid file format!"));
    }

    void refusals()
    {
        QFETCH(int, language);
        QFETCH(char, format);
        QFETCH(QByteArray, content);
        QFETCH(QStringList, boxes);
        gLanguage = language;
        for (const QString &box : boxes)
            mDesktop->expectBox(box);
        chooseContent(format, content);
        read();
        QVERIFY(mFrame->importEnabled && !mFrame->hourglass());
        QVERIFY(!review());
    }

    void nothingToReview()
    {
        chooseContent('A', {});
        for (const QString &name : texts("in.txt", "missing.txt")) {
            gImportFile = mCatalogue->path(name);
            read();
            QVERIFY(review() && !mFrame->importEnabled);
            QVERIFY(!review()->findChild<QPushButton *>(u"StartDBImport"_s)->isEnabled());
            review()->close();
            QVERIFY(mFrame->importEnabled);
        }
    }

    // Somebody keeps on closing it, at each pump.
    void itStaysWhileItReads()
    {
        chooseContent('C', "x\n" + QByteArray("a*b**\n").repeated(50000));
        int refused = 0, highest = 0;
        QString title, label;
        mDesktop->expectModal(u"frmImportBusy"_s, [&](Form &busy) {
            auto *again = new QTimer(&busy);
            connect(again, &QTimer::timeout, &busy, [&] {
                if (busy.findChild<QTimer *>(u"StartReading"_s)->isActive())
                    return;
                refused += busy.isVisible() && !busy.Unload();
                title = busy.windowTitle();
                label = busy.findChild<QLabel *>(u"lblRead"_s)->text();
                highest = busy.findChild<QProgressBar *>(u"ImportProgressBar"_s)->value();
                QVERIFY(mFrame->hourglass());
            });
            again->start(0);
        });
        defaultInstance<frmImportBusy>().ShowModal();
        QVERIFY(refused > 0);
        QCOMPARE(title, u"Busy reading file: "_s + gImportFile);
        QCOMPARE(label, QString::number(highest) + u"% ingelezen"_s);
        QVERIFY(review());
        QCOMPARE(gImportRecords->RecordCount(), 50000);
        QVERIFY(!mFrame->hourglass());
    }

    void closedBeforeItBegins()
    {
        frmImportBusy &busy = defaultInstance<frmImportBusy>();
        busy.Load();
        QVERIFY(!mFrame->importEnabled);
        QVERIFY(busy.Unload());
        QVERIFY(mFrame->importEnabled);
        QVERIFY(!busy.findChild<QTimer *>(u"StartReading"_s)->isActive());
    }
};

QTEST_MAIN(tst_frmImportBusy)
#include "tst_frmImportBusy.moc"
