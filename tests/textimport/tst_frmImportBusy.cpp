// Label: screen
#include "platform/ado/recordset.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/importfixture.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"
#include "textimport/frmImport.h"
#include "textimport/frmImportBusy.h"

#include <QLabel>
#include <QProgressBar>
#include <QPushButton>
#include <QTest>
#include <QTimer>

class tst_frmImportBusy : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void refusals_data();
    void refusals();
    void nothingToReview_data();
    void nothingToReview();
    void itStaysWhileItReads();
    void closedBeforeItBegins();

private:
    void read(char format, const QByteArray &content);
    frmImport *review() const;

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
    std::unique_ptr<TestFrame> mFrame;
};

void tst_frmImportBusy::init()
{
    gLanguage = languageEnglish;
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
    mFrame = std::make_unique<TestFrame>();
}

void tst_frmImportBusy::cleanup()
{
    if (frmImport *form = review())
        form->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    mFrame.reset();
    mCatalogue.reset();
    mDesktop->verifyAllCame();
    mDesktop.reset();
}

frmImport *tst_frmImportBusy::review() const
{
    for (Form *form : Form::openForms()) {
        if (auto *found = qobject_cast<frmImport *>(form))
            return found;
    }
    return nullptr;
}

void tst_frmImportBusy::read(char format, const QByteArray &content)
{
    chooseImport(format, writeFile(mCatalogue->path(QStringLiteral("in.txt")), content));
    mDesktop->expectModal(QStringLiteral("frmImportBusy"));
    defaultInstance<frmImportBusy>().ShowModal();
}

void tst_frmImportBusy::refusals_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<char>("format");
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QStringList>("boxes");
    const auto row = [](const char *name, int language, char format, const char *content,
                        const QStringList &boxes) {
        QTest::newRow(name) << language << format << QByteArray(content) << boxes;
    };
    row("a fault in the data", languageEnglish, 'C', "x\n*b**\n",
        texts("error [File error] Error at line 2: Found empty line, whereas artist is obligatory!",
              "error [Songcase] Error at line 2: Invalid file format!"));
    row("a fault in the data, Dutch", languageDutch, 'A', "x\n\n",
        texts(
            "error [Bestandsfout] Fout op regel 2: Er werd een getal verwacht maar niet gevonden!",
            "error [Songcase] Fout op regel 2: Onjuist bestandsformaat"));
    row("a star in an album title", languageEnglish, 'D', "p\n*x\n",
        texts("error [File error] Error at line 2: Hoofdtitel mag het teken * niet bevatten!",
              "error [Songcase] Error at line 2: Invalid file format!"));
    row("a missing star", languageEnglish, 'C', "x\na*b\n",
        texts("error [Songcase] Error at line 2: Invalid file format!"));
    row("no track", languageEnglish, 'C', "x\ny\n",
        texts("error [Songcase] Error at line 2: Invalid file format!"));
}

void tst_frmImportBusy::refusals()
{
    QFETCH(int, language);
    QFETCH(char, format);
    QFETCH(QByteArray, content);
    QFETCH(QStringList, boxes);
    gLanguage = language;
    for (const QString &box : boxes)
        mDesktop->expectBox(box);
    read(format, content);
    QCOMPARE(mDesktop->boxes, boxes);
    QVERIFY(mFrame->importEnabled);
    QVERIFY(!mFrame->hourglass());
    QVERIFY(!review());
}

void tst_frmImportBusy::nothingToReview_data()
{
    QTest::addColumn<QString>("name");
    QTest::newRow("empty") << "in.txt";
    QTest::newRow("missing") << "missing.txt";
}

void tst_frmImportBusy::nothingToReview()
{
    QFETCH(QString, name);
    writeFile(mCatalogue->path(QStringLiteral("in.txt")), {});
    chooseImport('A', mCatalogue->path(name));
    mDesktop->expectModal(QStringLiteral("frmImportBusy"));
    defaultInstance<frmImportBusy>().ShowModal();
    QVERIFY(review());
    QVERIFY(!review()->findChild<QPushButton *>(QStringLiteral("StartDBImport"))->isEnabled());
    QVERIFY(!mFrame->importEnabled);
    review()->close();
    QVERIFY(mFrame->importEnabled);
}

// Somebody keeps on closing it, at each pump.
void tst_frmImportBusy::itStaysWhileItReads()
{
    QByteArray content = "x\n";
    content += QByteArray("a*b**\n").repeated(50000);
    chooseImport('C', writeFile(mCatalogue->path(QStringLiteral("in.txt")), content));
    int refused = 0, highest = 0;
    QString title, label;
    mDesktop->expectModal(QStringLiteral("frmImportBusy"), [&](Form &busy) {
        auto *again = new QTimer(&busy);
        connect(again, &QTimer::timeout, &busy, [&] {
            if (busy.findChild<QTimer *>(QStringLiteral("StartReading"))->isActive())
                return;
            refused += busy.isVisible() && !busy.Unload();
            title = busy.windowTitle();
            label = busy.findChild<QLabel *>(QStringLiteral("lblRead"))->text();
            highest = busy.findChild<QProgressBar *>(QStringLiteral("ImportProgressBar"))->value();
            QVERIFY(mFrame->hourglass());
        });
        again->start(0);
    });
    defaultInstance<frmImportBusy>().ShowModal();
    QVERIFY(refused > 0);
    QCOMPARE(title, QStringLiteral("Busy reading file: ") + gImportFile);
    QCOMPARE(label, QString::number(highest) + QStringLiteral("% ingelezen"));
    QVERIFY(review());
    QCOMPARE(gImportRecords->RecordCount(), 50000);
    QVERIFY(!mFrame->hourglass());
}

void tst_frmImportBusy::closedBeforeItBegins()
{
    frmImportBusy &busy = defaultInstance<frmImportBusy>();
    busy.Load();
    QVERIFY(!mFrame->importEnabled);
    QVERIFY(busy.Unload());
    QVERIFY(mFrame->importEnabled);
    QVERIFY(!busy.findChild<QTimer *>(QStringLiteral("StartReading"))->isActive());
}

QTEST_MAIN(tst_frmImportBusy)
#include "tst_frmImportBusy.moc"
