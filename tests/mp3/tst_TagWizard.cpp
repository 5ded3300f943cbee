// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "discdata/changedfiles.h"
#include "mp3/frmTagWizardPg1.h"
#include "platform/work/longwork.h"
#include "support/tagscreentest.h"
#include "tags/filejournal.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QHelpEvent>
#include <QPushButton>
#include <QRadioButton>
#include <QToolTip>
#include <QTreeView>

/// The tags of many files: matched as one disc, looked at, saved as one change.
class tst_TagWizard : public TagScreenTest
{
    Q_OBJECT

    QPointer<frmTagWizardPg1> mWizard;

    ADODB::RecordsetPtr records(const QStringList &files, const QString &artist) const
    {
        auto rows = std::make_shared<ADODB::Recordset>();
        for (const char *name :
             {"Nr", "Filename", "Album", "Artist", "Title", "TrackPosition", "PartOfSet",
              "TrackYear", "Genre", "CopyrightHolder", "Label", "Comments", "ID"})
            rows->appendField(QLatin1String(name), ADODB::adVarWChar);
        rows->Open();
        for (const QString &file : files) {
            rows->AddNew();
            rows->Fields(u"Filename").setValue(file.section(u"/Nora - Harbour/"_s, -1));
            rows->Fields(u"Artist").setValue(artist);
            rows->Fields(u"ID").setValue(u"y"_s);
        }
        return rows;
    }
    void open(const QStringList &files, const QString &artist = u""_s)
    {
        mWizard = new frmTagWizardPg1;
        mWizard->Folder = QFileInfo(path(1)).path() + u'/';
        mWizard->FileRecords = records(files, artist);
        mWizard->Show();
        QVERIFY(QTest::qWaitForWindowActive(mWizard));
        QCoreApplication::processEvents();
    }
    DBListViewCTL *list() const { return mWizard->findChild<DBListViewCTL *>(u"TheFileList"_s); }
    QString row(int number) const
    {
        const ListItem item = list()->ListItems().Item(number);
        QStringList texts;
        for (int column : {3, 2, 4, 5, 6, 7, 8, 10})
            texts.append(item.SubItems(column));
        return texts.join(u'|');
    }
    void press(const char *button) const
    {
        mWizard->findChild<QPushButton *>(QLatin1String(button))->click();
    }
    void checkRow(int row, bool on) const
    {
        QAbstractItemModel *model = list()->model();
        model->setData(model->index(row - 1, 0), on ? Qt::Checked : Qt::Unchecked,
                       Qt::CheckStateRole);
    }
    void expectOfKey(const char *key, BoxAnswer answer = vbOK)
    {
        mDesktop->expectBox(GetMessage(key).section(u'\r', 0, 0), answer);
    }
    void matchWithService()
    {
        serve({u"Found"_s});
        expectOfKey("MP3ProcTagItemsSubstituted");
        press("OKButton");
    }

private slots:
    void init() { TagScreenTest::init(); }
    void cleanup()
    {
        TagScreenTest::cleanup();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    void checksAndHighlight()
    {
        open(mFiles);
        QVERIFY(list()->ListItems().Item(1).Checked() && list()->ListItems().Item(1).Selected());
        checkRow(3, true);
        for (const Qt::Key key : {Qt::Key_Down, Qt::Key_Up, Qt::Key_Space})
            QTest::keyClick(list(), key);
        QCOMPARE(list()->currentIndex().row(), 0); // where the keys go on
        QVERIFY(!list()->ListItems().Item(1).Selected() && list()->ListItems().Item(3).Selected());
        checkRow(3, false);
        expectOfKey("MP3TagsProcCheckFiles");
        press("OKButton");
        QVERIFY(mServer->requests.isEmpty());
    }

    // Cells that a match has changed are drawn so, and tell what was there before.
    void matchedSavedTakenBack()
    {
        open(mFiles, u"Before"_s);
        expectOfKey("AllTagsWillBeOverwritten", vbNo);
        press("OKButton");
        QVERIFY(mServer->requests.isEmpty());
        expectOfKey("AllTagsWillBeOverwritten", vbYes);
        matchWithService();
        QCOMPARE(row(2), u"Nora|Found|Song 2|2|1/1|1985||Sea"_s);
        QCOMPARE(tagIn(2), u"||||||||"_s);
        const QPoint cell = list()->visualRect(list()->model()->index(1, 3)).center();
        QHelpEvent help(QEvent::ToolTip, cell, list()->viewport()->mapToGlobal(cell));
        QCoreApplication::sendEvent(list()->viewport(), &help);
        QVERIFY2(QToolTip::text().contains(u"Before"_s), qPrintable(QToolTip::text()));
        expectOfKey("MP3ProcAllTagsSaved");
        press("cmdSaveTags");
        QVERIFY(mWizard->isUnloaded() && gTagsChanged);
        QCOMPARE(tagIn(3), u"Nora|Found|Song 3|3|1/1|1985||Sea|"_s);
        QCOMPARE(changedFiles().batches().front().files, 3);
        changedFiles().undo(changedFiles().batches().front().number, mDesktop->now(), {},
                            [](int, int) { return true; });
        QCOMPARE(tagIn(3), u"||||||||"_s);
        open(mFiles);
        matchWithService();
        expectOfKey("MP3ProcAllTagsSaved");
        press("cmdSaveTags");
        QCOMPARE(tagIn(1), u"Nora|Found|Song 1|1|1/1|1985||Sea|"_s);
    }

    void noMatch_data()
    {
        const DataRows<QString, QStringList> row("fault", "boxes"); // keys, or texts
        row("nothing found", {u"MP3TagsProcNoMatchFound"_s});
        row("another number", {u"MP3ProcNumberFilesNotCorrespond"_s, u"MP3TagsProcNoMatchFound"_s});
        row("off", {u"[System error]"_s, u"Operation aborted"_s, u"MP3TagsProcNoMatchFound"_s});
        row("candidates cancelled", {u"Operation aborted"_s, u"MP3TagsProcNoMatchFound"_s});
        row("cancelled by the user", {u"Operation aborted"_s});
    }
    void noMatch()
    {
        const QByteArray fault = QTest::currentDataTag();
        QFETCH(QStringList, boxes);
        serve(fault == "candidates cancelled" ? texts("A", "B") : QStringList());
        if (fault == "off")
            mServer->close();
        if (fault == "another number") {
            mServer = std::make_unique<StandInServer>();
            signUpAt(*mServer);
            serve({u"Found"_s}); // for all files of the folder
        }
        if (fault == "candidates cancelled")
            mDesktop->expectModal(u"Candidates"_s, [](Form &form) { form.close(); });
        if (fault == "cancelled by the user")
            connect(mServer.get(), &StandInServer::asked, this, [] { LongWork::cancelAll(); });
        open(fault == "another number" ? mFiles.mid(0, 2) : mFiles);
        for (const QString &box : boxes) {
            const QString text = GetMessage(box.toLatin1().constData());
            mDesktop->expectBox(text == "Unknown"_L1 ? box : text);
        }
        press("OKButton");
        QCOMPARE(row(1), u"|||||||"_s);
        QVERIFY(list()->ListItems().Item(1).Checked());
    }

    // The second chance lies in another folder; row 1 is track 1 all the same.
    void theSecondFileFinds()
    {
        const QString folder = QFileInfo(path(1)).path() + u"/CD"_s;
        QVERIFY(QDir().mkdir(folder));
        makeSounds(folder, {{u"1.mp3"_s, 10000}, {u"2.mp3"_s, 20000}});
        mServer->answer("discid/", discsOfService({}, 3));
        mServer->answer("discid/", discsOfService({u"Found"_s}, 2));
        mServer->answer("query=", "{\"releases\":[],\"recordings\":[]}");
        open({u"1.mp3"_s, u"CD/2.mp3"_s});
        checkRow(2, true);
        expectOfKey("MP3ProcTagItemsSubstituted");
        press("OKButton");
        QCOMPARE(mServer->words().join().count("discid/"), 2);
        QCOMPARE(row(1), u"Nora|Found|Song 1|1|1/1|1985||Sea"_s);
    }

    void fromTheCatalogue()
    {
        open(mFiles);
        mWizard->findChild<QRadioButton *>(u"optRelateToDatabase"_s)->click();
        mDesktop->expectModal(u"frmMatchWithSongcase"_s, [](Form &form) {
            form.findChild<QPushButton *>(u"cmdSearch"_s)->click();
            auto *tree = form.findChild<QTreeView *>(u"TreeViewCD"_s);
            QCOMPARE(tree->model()->rowCount(), 1); // of three tracks
            QTest::keyClick(tree, Qt::Key_Return);
        });
        expectOfKey("MP3ProcTagItemsSubstituted");
        press("OKButton");
        QCoreApplication::processEvents();
        QCOMPARE(row(2), u"Nora|Harbour|Two|2|1/2|?|?|"_s);
        QVERIFY(mServer->requests.isEmpty());
        mDesktop->expectModal(u"frmMatchWithSongcase"_s, [](Form &form) { form.close(); });
        expectOfKey("AllTagsWillBeOverwritten", vbYes);
        expectOfKey("MP3TagsProcNoMatchFound");
        press("OKButton");
        QCOMPARE(row(2), u"|||||||"_s); // by design: the list was made anew
    }

    // The others are saved; what is left can be saved once more.
    void filesThatCannotBeSaved_data()
    {
        const DataRows<QString, QStringList, bool> row("fault", "boxes", "closes");
        row("gone", {u"2.mp3 not found!"_s, u"MP3ProcNotAllTagsSaved"_s}, true);
        row("a folder now", {u"MP3ProcFileNotAccessed"_s}, false);
    }
    void filesThatCannotBeSaved()
    {
        QFETCH(QString, fault);
        QFETCH(QStringList, boxes);
        open(mFiles);
        matchWithService();
        QVERIFY(QFile::remove(path(2)));
        if (fault != "gone"_L1)
            QVERIFY(QDir().mkdir(path(2)));
        for (const QString &box : boxes) {
            const QString text = GetMessage(box.toLatin1().constData()).section(u'\r', 0, 0);
            mDesktop->expectBox(text == "Unknown"_L1 ? box : text);
        }
        press("cmdSaveTags");
        QCOMPARE(tagIn(3), u"Nora|Found|Song 3|3|1/1|1985||Sea|"_s);
        QTEST(mWizard->isUnloaded(), "closes");
    }

    // After a whole file; what is saved can be taken back.
    void userStopsTheSaving()
    {
        QStringList many;
        for (int number = 0; number < 300; ++number)
            many.append(QFileInfo(path(1)).path() + u"/m%1.mp3"_s.arg(number));
        for (const QString &name : many)
            writeFile(name, silentMP3(1000));
        open(many, u"Zoë"_s);
        QTimer::singleShot(0, mWizard, [] { LongWork::cancelAll(); });
        expectOfKey("xTagsCancelledPart1");
        press("cmdSaveTags");
        QVERIFY(!mWizard->isUnloaded() && !mWizard->isBusy());
        int saved = 0;
        CddbID3Tag tag;
        for (const QString &name : many) {
            tag.LoadFromFile(name, 1);
            saved += int(tag.LeadArtist() == u"Zoë"_s);
        }
        QVERIFY(saved > 0 && saved < 300);
        QCOMPARE(changedFiles().batches().front().files, saved);
    }
};

QTEST_MAIN(tst_TagWizard)
#include "tst_TagWizard.moc"
