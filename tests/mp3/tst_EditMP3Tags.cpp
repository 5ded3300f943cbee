// Label: screen
#include "discdata/changedfiles.h"
#include "mp3/EditMP3Tags.h"
#include "mp3/frmMatchWithSongcase.h"
#include "platform/work/longwork.h"
#include "support/tagscreentest.h"
#include "tags/filejournal.h"

#include <QComboBox>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTreeView>
#include <QWheelEvent>

/// The tag of one file: typed, matched, saved, and what stands in the way.
class tst_EditMP3Tags : public TagScreenTest
{
    Q_OBJECT

    QPointer<EditMP3Tags> mEditor;

    void open(const QString &path)
    {
        mEditor = new EditMP3Tags;
        mEditor->TagFilePath = path;
        mEditor->Load();
        mEditor->LoadTagInfo();
        mEditor->ShowTagItems();
        mEditor->EnableTagItems();
        mEditor->Show();
    }
    QLineEdit *field(const char *name) const
    {
        auto *list = mEditor->findChild<QComboBox *>(QLatin1String(name));
        return list ? list->lineEdit() : mEditor->findChild<QLineEdit *>(QLatin1String(name));
    }
    QString text(const char *name) const { return field(name)->text(); }
    void press(const char *name) const
    {
        mEditor->findChild<QPushButton *>(QLatin1String(name))->click();
    }
    QString shown() const
    {
        QStringList all;
        for (const char *name : {"txtArtist", "txtTitle", "txtTrackTitle", "txtTrack",
                                 "txtPartOfSet", "txtYear", "txtGenre", "txtlabel"})
            all.append(text(name));
        return all.join(u'|');
    }
    void expectOfKey(const char *key, BoxAnswer answer = vbOK)
    {
        mDesktop->expectBox(GetMessage(key).section(u'\r', 0, 0), answer);
    }

private slots:
    void init() { TagScreenTest::init(); }
    void cleanup()
    {
        if (mEditor && !mEditor->isUnloaded())
            press("cmdCancel");
        TagScreenTest::cleanup();
    }

    void pathInItsLabel()
    {
        const QString folder = mCatalogue->path(u"x"_s);
        const auto nameOf = [&](qsizetype size) -> QString {
            return folder + QString(size - folder.size() - 4, u'y') + u".mp3"_s;
        };
        for (const qsizetype size : {75, 76}) {
            open(writeFile(nameOf(size), silentMP3(1000)));
            const QString label = mEditor->findChild<QLabel *>(u"txtFileName"_s)->text();
            QCOMPARE(label, size == 75 ? nameOf(75)
                                       : nameOf(76).left(35) + u"..."_s + nameOf(76).right(35));
            mEditor->Unload();
        }
    }

    void typedAndSaved()
    {
        open(path(1));
        expectOfKey("NoChangesToSave");
        press("cmdSaveTag");
        QVERIFY(!gTagsChanged);
        field("txtArtist")->setText(u"Zoë & <b>"_s);
        field("txtGenre")->setText(u"my own"_s);
        mEditor->findChild<QPlainTextEdit *>(u"txtcomments"_s)->setPlainText(u"a\nb"_s);
        expectOfKey("AllMP3TagsSaved");
        press("cmdSaveTag");
        QCOMPARE(tagIn(1), u"Zoë & <b>||||||my own||a\nb"_s);
        QVERIFY(gTagsChanged);
        QTest::keyClick(mEditor, Qt::Key_Escape); // nothing to ask
        QVERIFY(mEditor->isUnloaded());
    }

    void aFieldCannotBeMadeEmpty()
    {
        writeFile(path(1), id3Tag({{"TPE1", u"Nora"_s}}) + silentMP3(10000));
        open(path(1));
        field("txtArtist")->selectAll();
        QTest::keyClick(field("txtArtist"), Qt::Key_Delete);
        QCOMPARE(text("txtArtist"), u" "_s);
        QTest::keyClicks(field("txtArtist"), u"Zoe"_s); // takes the place of the blank
        QCOMPARE(text("txtArtist"), u"Zoe"_s);
        field("txtTitle")->setText(u"x"_s);
        field("txtTitle")->clear();
        QCOMPARE(text("txtTitle"), QString());
    }

    void aWheelThatPasses()
    {
        open(path(1));
        auto *genre = mEditor->findChild<QComboBox *>(u"txtGenre"_s);
        QWheelEvent wheel({5, 5}, genre->mapToGlobal(QPointF(5, 5)), {}, {0, -120}, Qt::NoButton,
                          Qt::NoModifier, Qt::NoScrollPhase, false);
        QCoreApplication::sendEvent(genre, &wheel);
        QCOMPARE(genre->currentText(), QString());
    }

    void endings_data()
    {
        // yes or no: the answer to the question
        const DataRows<QString, QString, bool> row("ending", "answer", "saved");
        row("cmdOK", "", true);
        row("cmdCancel", "", false);
        row("Esc, yes", "yes", true);
        row("Esc, no", "no", false);
    }
    void endings()
    {
        QFETCH(QString, ending);
        QFETCH(QString, answer);
        open(path(1));
        field("txtArtist")->setText(u"Zoë"_s);
        if (!answer.isEmpty())
            expectOfKey("MP3UnsavedChanges", answer == "yes"_L1 ? vbYes : vbNo);
        if (ending == "Esc, yes"_L1)
            expectOfKey("AllMP3TagsSaved");
        if (answer.isEmpty())
            press(ending.toLatin1());
        else
            QTest::keyClick(field("txtArtist"), Qt::Key_Escape);
        QVERIFY(mEditor->isUnloaded());
        QTEST(tagIn(1).startsWith(u"Zoë"_s), "saved");
    }

    // By design the editor closes all the same.
    void filesThatCannotBeSaved()
    {
        open(path(1));
        field("txtArtist")->setText(u"Zoë"_s);
        QVERIFY(QFile::remove(path(1)));
        mDesktop->expectBox(path(1) + GetMessage("CouldNotSaveMP3TagPart2"));
        press("cmdOK");
        QVERIFY(mEditor->isUnloaded());
        open(path(2));
        field("txtArtist")->setText(u"Zoë"_s);
        QVERIFY(QFile::remove(path(2)) && QDir().mkdir(path(2)));
        expectOfKey("TagCannotBeSavedFileAccess");
        press("cmdSaveTag");
        expectOfKey("NoChangesToSave");
        press("cmdSaveTag");
        mDesktop->expectBox(path(2));
        EditMP3Tags::edit(path(2)); // a folder has no tag to show
    }

    void matched_data()
    {
        const DataRows<QString, QString> row("way", "shown");
        const char *const found = "Nora|Found|Song 2|2|1/1|1985||Sea";
        row("one disc", found);
        row("one of several", "Nora|Found|Song 3|3|1/1|1985||Sea");
        row("candidates cancelled", "|||||||");
        row("no track chosen", "|||||||");
        row("nothing", "|||||||");
        row("service off", "|||||||");
        row("catalogue", "Nora|Harbour|Two|2|1/2|?|?|");
        row("catalogue cancelled", "|||||||");
    }
    void matched()
    {
        QFETCH(QString, way);
        const bool own = way.startsWith("catalogue"_L1);
        const bool several = way == "one of several"_L1 || way == "no track chosen"_L1;
        if (several || way.startsWith("cand"_L1))
            serve({u"Other"_s, u"Found"_s});
        else
            serve(way == "one disc"_L1 ? texts("Found") : QStringList());
        if (way == "service off"_L1)
            mServer->close();
        open(path(2));
        const auto keys = [](const QString &control, const QList<Qt::Key> &all) {
            return [=](Form &form) {
                for (const Qt::Key key : all)
                    QTest::keyClick(form.findChild<QWidget *>(control), key);
            };
        };
        if (way.startsWith("cand"_L1) || several)
            mDesktop->expectModal(u"Candidates"_s,
                                  keys(u"CandidateList"_s,
                                       {Qt::Key_Down, several ? Qt::Key_Return : Qt::Key_Escape}));
        if (several)
            mDesktop->expectModal(
                u"frmTracks"_s,
                keys(u"lstTracks"_s,
                     {Qt::Key_End, way == "one of several"_L1 ? Qt::Key_Return : Qt::Key_Escape}));
        if (own)
            mDesktop->expectModal(u"frmMatchWithSongcase"_s, [&](Form &form) {
                keys(u"txtArtist"_s, {Qt::Key_Return})(form);
                keys(u"TreeViewCD"_s,
                     {Qt::Key_Return, Qt::Key_Down, Qt::Key_Down,
                      way == "catalogue"_L1 ? Qt::Key_Return : Qt::Key_Escape})(form);
            });
        if (way == "one disc"_L1 || way == "one of several"_L1)
            expectOfKey("TagItemsHaveBeenSubstituted");
        if (way == "nothing"_L1)
            expectOfKey("NoMatchFoundForThisFile");
        if (way == "service off"_L1)
            mDesktop->expectBox(GetMessage("xServiceNotReached").chopped(1));
        if (way == "catalogue"_L1)
            expectOfKey("MP3ProcTagItemsSubstituted");
        press(own ? "cmdMatchFileWithSongCase" : "cmdMatchFileWithCDDB");
        QTEST(shown(), "shown");
        QVERIFY(!mEditor->isBusy() && !mEditor->isUnloaded());
    }

    // Once saved, the file leads back to its record by its id.
    void byItsId_data()
    {
        const DataRows<QString, QString> row("answer", "box");
        row("yes", "TagInfoNotDifferent");
        row("yes, gone", "NoMatchFoundForThisFile");
        row("no", "TagInfoNotDifferent");
    }
    void byItsId()
    {
        QFETCH(QString, answer);
        QFETCH(QString, box);
        serve({u"Found"_s});
        const QByteArray known = discsOfService({u"Found"_s}, 3);
        if (answer == "yes"_L1)
            mServer->answer("release/", known.mid(known.indexOf('[') + 1).chopped(2));
        open(path(2));
        expectOfKey("TagItemsHaveBeenSubstituted");
        press("cmdMatchFileWithCDDB");
        expectOfKey("AllMP3TagsSaved");
        press("cmdSaveTag");
        mDesktop->expectBox(GetMessage("IDFound"), answer == "no"_L1 ? vbNo : vbYes);
        mDesktop->expectBox(GetMessage(box.toLatin1().constData()));
        press("cmdMatchFileWithCDDB");
        QVERIFY(mServer->words().last().contains(answer == "no"_L1 ? "discid/" : "release/"));
        changedFiles().undo(changedFiles().batches().front().number, mDesktop->now(), {},
                            [](int, int) { return true; });
        QCOMPARE(tagIn(2), u"||||||||"_s);
    }

    void nothingIsSavedBesideALongWork_data()
    {
        const DataRows<QString> row("way");
        row("cmdSaveTag");
        row("cmdOK");
        row("Esc");
    }
    void nothingIsSavedBesideALongWork()
    {
        QFETCH(QString, way);
        open(path(1));
        const QString before = tagIn(1);
        field("txtArtist")->setText(u"Zoë"_s);
        Form other(u"other"_s);
        const LongWork work(other);
        expectOfKey("xBusy");
        if (way == "Esc"_L1)
            QTest::keyClick(field("txtArtist"), Qt::Key_Escape);
        else
            press(way.toLatin1());
        QCOMPARE(tagIn(1), before);
        QVERIFY(!mEditor->isUnloaded());
    }
};

QTEST_MAIN(tst_EditMP3Tags)
#include "tst_EditMP3Tags.moc"
