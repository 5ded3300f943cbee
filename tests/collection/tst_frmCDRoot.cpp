// Label: screen
#include "collection/frmCDRoot.h"
#include "platform/ado/connection.h"
#include "support/editing.h"

#include <QApplication>
#include <QClipboard>
#include <QFileInfo>
#include <QPushButton>
#include <QScopedValueRollback>
#include <QTimer>
#include <ctime>

namespace
{

const auto titleRow =
    u"select Titel, CD_Type, Genre, Hitjaar, Artiest_ID from CDTitels where ID = %1"_s;

} // namespace

/// The editor of compilations on a real catalogue file, with its real grid.
class tst_frmCDRoot : public QObject
{
    Q_OBJECT

private:
    // Compilation 3 "It's 100%1": disc 1 with two tracks, disc 2 with one, disc 3 with one.
    void fillThree()
    {
        mE->catalogue.exec(R"(
            insert into Artiesten values (1,'Anna'),(2,'Bob'),(3,'Cleo');
            insert into Tracks values (1,1,'One','Pop',1985),(2,2,'Two',null,null),(3,1,'Three',null,null),
                (4,3,'Four',null,null);
            insert into CDTitels values (3,'It''s 100%1',null,'V','Rock',1999),(4,'Other',null,'V',null,null);
            insert into CompactDiscs values (1,3,1,1,1,null),(2,3,1,2,2,null),(3,3,2,1,3,null),(4,3,3,1,4,null),
                (5,4,1,1,4,null);)");
    }

    CdEditor *openThree()
    {
        fillThree();
        return mE->open<frmCDRoot>("U", 3);
    }

    QStringList three() { return mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3); }

    // A statement to fail until allow().
    void refuse(const char *when)
    {
        mE->catalogue.exec(u"create trigger refuse before "_s + QLatin1String(when) +
                           u" begin select raise(abort, 'not this one'); end"_s);
    }

    void allow() { mE->catalogue.exec("drop trigger refuse"); }

    std::unique_ptr<Editing> mE;

private slots:
    void init() { mE = std::make_unique<Editing>(languageEnglish); }
    void cleanup() { mE.reset(); }

    void aRecordThatCannotBeShown()
    {
        fillThree();
        mE->desktop.expectBox(u"error [System error] Invalid system mode!"_s);
        QVERIFY(mE->open<frmCDRoot>("X", 3)->isUnloaded());
        mE->desktop.expectBox(u"error [System error] 3021 "_s);
        QVERIFY(mE->open<frmCDRoot>("U", 77)->isVisible()); // an unknown id: it stays
    }

    void anExistingRecord()
    {
        openThree();
        QCOMPARE(mE->field("txtTitel")->text(), u"It's 100%1"_s);
        QCOMPARE(mE->genre()->currentText(), u"Rock"_s);
        QCOMPARE(mE->field("txtYear")->text(), u"1999"_s);
        QCOMPARE(mE->cell(2, 2), u"Bob"_s);
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_3, Qt::AltModifier);
        QCOMPARE(mE->cell(1, 3), u"Four"_s);
        emit mE->disk()->LeaveForward();
        QCOMPARE(QApplication::focusWidget(), mE->field("txtTitel"));
        emit mE->disk()->LeaveBackward();
        QCOMPARE(QApplication::focusWidget(), mE->field("txtYear"));
    }

    void leavingTheYear()
    {
        mE->open<frmCDRoot>("I");
        QLineEdit *field = mE->field("txtYear");
        const auto leave = [&](const QString &year, Qt::Key key) {
            field->setFocus();
            field->setText(year);
            keyboard::press(key);
            return QApplication::focusWidget() != field;
        };
        for (const Qt::Key key : {Qt::Key_Tab, Qt::Key_Backtab}) {
            QVERIFY(leave(u"1985"_s, key));
            QVERIFY(!leave({}, key)); // by design
            mE->desktop.expectBox(u"Invalid year!"_s);
            QVERIFY(!leave(u"1900"_s, key) && field->text().isEmpty());
        }
        QVERIFY2(leave(u"19"_s, Qt::Key_PageDown), "there is a way out by the keyboard");
        QCOMPARE(field->text(), u"19"_s);
    }

    void keysOfTheFields()
    {
        openThree();
        for (const char *field : {"txtTitel", "Genre", "txtYear"}) {
            const auto pressThere = [&](Qt::Key key, Qt::KeyboardModifiers with = {}) {
                mE->control<QWidget>(field)->setFocus();
                keyboard::press(key, with);
            };
            pressThere(Qt::Key_PageDown);
            QVERIFY(mE->disk()->hasFocus() && mE->disk()->CurrentRow() == 2);
            pressThere(Qt::Key_PageUp);
            QCOMPARE(mE->disk()->CurrentRow(), 1);
            pressThere(Qt::Key_End);
            pressThere(Qt::Key_Insert, Qt::ControlModifier);
            QCOMPARE(mE->tabs()->count(), 3);
            pressThere(Qt::Key_Insert, Qt::ShiftModifier);
            QCOMPARE(mE->tabs()->currentIndex(), 3);
            keyboard::press(Qt::Key_End, Qt::ShiftModifier);
            QCOMPARE(mE->tabs()->count(), 3);
            mE->tabs()->setCurrentIndex(0);
        }
    }

    // Signs whose codes are those of keys without a sign: page up and down, End, Insert, Delete.
    void signsAreText()
    {
        openThree();
        mE->field("txtTitel")->setFocus();
        for (const char sign : {'!', '"', '#', '&', '(', '-', '.'})
            QTest::keyClick(mE->field("txtTitel"), sign, Qt::ShiftModifier);
        QCOMPARE(mE->field("txtTitel")->text(), u"!\"#&(-.It's 100%1"_s);
        QCOMPARE(mE->tabs()->count(), 3);
        QCOMPARE(QApplication::focusWidget(), mE->field("txtTitel"));
    }

    void buttonsOfTheToolbar()
    {
        openThree();
        mE->field("txtTitel")->setFocus();
        mE->button(10)->trigger();
        QVERIFY(mE->disk()->hasFocus());
        const std::pair<int, QPoint> places[] = {{10, {2, 2}}, {11, {2, 1}}, {7, {2, 2}},
                                                 {6, {2, 1}},  {8, {3, 1}},  {9, {2, 1}}};
        for (const auto &[n, place] : places) {
            mE->button(n)->trigger();
            QCOMPARE(QPoint(mE->disk()->CurrentColumn(), mE->disk()->CurrentRow()), place);
        }
        mE->button(4)->trigger();
        QCOMPARE(mE->cell(1, 2) + mE->cell(2, 2), u"Anna"_s);
        mE->button(5)->trigger();
        QCOMPARE(mE->cell(1, 2), u"Anna"_s);
        mE->field("txtTitel")->setFocus();
        mE->button(8)->trigger();
        QVERIFY2(mE->genre()->hasFocus(), "the next field of whatever has the focus");
        for (const int n : {4, 5, 11})
            QVERIFY(!mE->button(n)->isEnabled());
    }

    void firstSave()
    {
        CdEditor *editor = mE->open<frmCDRoot>("I");
        const QString title = u"O'Neill's 50%2 off \U0001F3B5"_s;
        keyboard::fill({title, u"folk 'n \"r\""_s, u"1e10"_s}); // the genre stays as typed
        mE->addTracks(texts("Anna|One|Pop|1985", "Bob|Two"));
        for (int time = 1; time <= 2; ++time) {
            editor->SaveKeepingPosition();
            QCOMPARE(editor->Mode, u"U"_s);
            QCOMPARE(editor->CdId, 1);
            QCOMPARE(mE->catalogue.rows(titleRow.arg(1)),
                     QStringList(title + u"|V|folk 'n \"r\"|10000000000|NULL"_s));
            QCOMPARE(mE->tracks(1), texts("1/1 Anna - One", "1/2 Bob - Two"));
            QCOMPARE(mE->browser->refreshed, 1);
            QVERIFY(!mE->disk()->IsChanged());
            QVERIFY(mE->disk()->CurrentRow() == 2 && mE->disk()->hasFocus());
        }
    }

    void whatASaveTouches_data()
    {
        const DataRows<QString, QString, bool, int> row("field", "text", "updates", "refreshes");
        row("nothing", "", "", false, 0);
        row("title, case only", "txtTitel", "IT'S 100%1", true, 1);
        row("year", "txtYear", "2001", true, 0);
        row("genre", "Genre", "Jazz", true, 0);
        row("track", "grid", "Other song", false, 1);
    }

    void whatASaveTouches()
    {
        QFETCH(QString, field);
        QFETCH(QString, text);
        CdEditor *editor = openThree();
        mE->catalogue.exec("create table Log(x); create trigger logged after update on CDTitels "
                           "begin insert into Log values (1); end");
        if (field == u"grid")
            mE->setCell(2, 3, text);
        else if (field == u"Genre")
            mE->genre()->setEditText(text);
        else if (!field.isEmpty())
            editor->findChild<QLineEdit *>(field)->setText(text);
        editor->SaveAtUserRequest();
        editor->SaveAtUserRequest(); // nothing more
        QTEST(mE->catalogue.count("select count(*) from Log") == 1, "updates");
        QTEST(mE->browser->refreshed, "refreshes");
    }

    void refusedSaves_data()
    {
        const DataRows<QString, QString, QString, QString> row("title", "year", "track", "box");
        row("no title", "", "19", "", "Please fill in the title of this compilation!");
        row("no year", "T", "1900", "", "Invalid year!");
        row("track without a title", "T", "", "Zoe", "please fill in the title!");
    }

    void refusedSaves()
    {
        QFETCH(QString, title);
        QFETCH(QString, year);
        QFETCH(QString, track);
        QFETCH(QString, box);
        CdEditor *editor = openThree();
        const QStringList before = three();
        mE->addTracks(track.split(u'|', Qt::SkipEmptyParts));
        mE->field("txtTitel")->setText(title);
        mE->field("txtYear")->setText(year);
        mE->desktop.expectBox(box);
        editor->SaveKeepingPosition();
        QCOMPARE(three(), before);
        QVERIFY(editor->updatesEnabled() && editor->cursor().shape() == Qt::ArrowCursor);
    }

    // By the same rule as the cells of the grid.
    void typedTexts_data()
    {
        const DataRows<QString, QString> row("pasted", "kept");
        row("blanks around", "  a  b ", "a  b");
        row("tabs and line ends", "a\tb\r\nc\n", "a b c");
        row("500 letters", QString(500, u'x'), QString(255, u'x'));
    }

    void typedTexts()
    {
        QFETCH(QString, pasted);
        QFETCH(QString, kept);
        CdEditor *editor = openThree();
        for (const char *name : {"txtTitel", "Genre"}) {
            mE->control<QWidget>(name)->setFocus();
            QApplication::clipboard()->setText(pasted);
            if (pasted.size() > 255)
                mE->desktop.expectBox(GetMessage("xTextCut"));
            keyboard::press(Qt::Key_A, Qt::ControlModifier);
            keyboard::press(Qt::Key_V, Qt::ControlModifier);
            QCoreApplication::processEvents();
            mE->desktop.verifyAllCame();
        }
        editor->SaveAtUserRequest(); // the focus is in the genre still
        QCOMPARE(mE->field("txtTitel")->text(), kept);
        QCOMPARE(mE->genre()->currentText(), kept);
        QCOMPARE(mE->catalogue.rows("select Titel, Genre from CDTitels where ID=3"),
                 QStringList(kept + u'|' + kept));
    }

    void textsOfAnotherProgram()
    {
        fillThree();
        const QString stored = u' ' + QString(300, u'x') + u'\t';
        mE->catalogue.exec(
            u"update CDTitels set Titel = '%1', Genre = '%1' where ID = 3"_s.arg(stored));
        CdEditor *editor = mE->open<frmCDRoot>("U", 3);
        for (const char *name : {"txtTitel", "Genre", "txtYear"})
            mE->control<QWidget>(name)->setFocus();
        editor->close(); // without a question
        QVERIFY(editor->isUnloaded());
        QCOMPARE(mE->catalogue.rows("select Titel, Genre from CDTitels where ID=3"),
                 QStringList(stored + u'|' + stored));
    }

    // 4,000 discs took ten seconds, and a number from nowhere never ended.
    void manyDiscs_data()
    {
        const DataRows<qint64, int> row("highest", "tabs");
        row("4000", 4000, 4000);
        row("beyond 32 bits", (qint64(1) << 32) + 2, 9999); // hung
        row("0", 0, 1);
    }

    void manyDiscs()
    {
        QFETCH(qint64, highest);
        fillThree();
        mE->catalogue.exec(u"update CompactDiscs set DiskNo = %1"_s.arg(highest));
        const std::clock_t begin = std::clock();
        mE->open<frmCDRoot>("U", 3);
        QTEST(mE->tabs()->count(), "tabs");
        const double seconds = double(std::clock() - begin) / CLOCKS_PER_SEC;
        QVERIFY2(seconds < (highest > 4000 ? 10 : 2), qPrintable(QString::number(seconds)));
    }

    void leavingADiscRefused()
    {
        openThree();
        mE->field("txtTitel")->clear();
        mE->disk()->setFocus();
        mE->disk()->setCurrentRow(2);
        mE->disk()->setCurrentColumn(4);
        mE->desktop.expectBox(GetMessage("MsgCompNoTitle"));
        mE->desktop.expectBox(u"information [Songcase] "_s + GetMessage("MsgDiscNav"));
        mE->tabs()->setCurrentIndex(2);
        QCOMPARE(mE->tabs()->currentIndex(), 0);
        QCOMPARE(mE->cell(1, 3), u"One"_s);
        QVERIFY(mE->disk()->CurrentRow() == 2 && mE->disk()->CurrentColumn() == 4);
        mE->desktop.expectBox(GetMessage("MsgCompNoTitle"));
        mE->desktop.expectBox(u"information [Songcase] "_s + GetMessage("MsgAddDisc"));
        mE->button(1)->trigger();
        QCOMPARE(mE->tabs()->count(), 3);
        mE->field("txtTitel")->setText(u"T"_s);
        mE->tabs()->setCurrentIndex(2);
        QCOMPARE(mE->cell(1, 3), u"Four"_s);
    }

    void deletingADisc_data()
    {
        const DataRows<int, int> row("tab", "tabAfter");
        row("first", 0, 0);
        row("middle", 1, 1);
        row("last", 2, 1);
    }

    void deletingADisc()
    {
        QFETCH(int, tab);
        CdEditor *editor = openThree();
        mE->tabs()->setCurrentIndex(tab);
        mE->disk()->setFocus();
        const QPoint place = editor->pos();
        keyboard::press(Qt::Key_End, Qt::ShiftModifier);
        QVERIFY(mE->editor == editor && editor->isVisible() && editor->pos() == place);
        QTEST(mE->tabs()->currentIndex(), "tabAfter");
        QVERIFY2(mE->disk()->hasFocus() && mE->button(4)->isEnabled(), "the grid keeps the focus");
        QVERIFY(mE->browser->refreshed >= 1 && editor->updatesEnabled());
    }

    void closing_data()
    {
        const DataRows<bool> row("saved");
        row("yes", true);
        row("no", false);
    }

    void closing()
    {
        QFETCH(bool, saved);
        CdEditor *editor = openThree();
        mE->disk()->setFocus();
        mE->disk()->setCurrentColumn(3);
        keyboard::type("X"); // and the cell is open still
        mE->desktop.expectBox(u"Do yo want to save changes?"_s, saved ? vbYes : vbNo);
        editor->close();
        QVERIFY(editor->isUnloaded());
        QCOMPARE(mE->catalogue.count("select count(*) from Tracks where Titel = 'X'"), int(saved));
    }

    // The engine itself reports it, at a size that the file may not pass.
    void aFullDisk()
    {
        CdEditor *editor = openThree();
        const QStringList before = three();
        auto *cells = mE->disk()->model();
        for (int row = 2; row < 102; ++row) {
            cells->setData(cells->index(row, 1), u"Anna"_s);
            cells->setData(cells->index(row, 2), QString(100 + row, u'x'));
        }
        gConnection->housekeeping("PRAGMA max_page_count=1"); // as many as there are
        mE->desktop.expectBox(u"The disk is full; nothing was written."_s);
        editor->SaveKeepingPosition();
        QCOMPARE(three(), before);
        gConnection->housekeeping("PRAGMA max_page_count=100000");
        editor->SaveKeepingPosition();
        QCOMPARE(mE->tracks(3).size(), 104);
    }

    void aDiscThatCannotBeDeleted()
    {
        openThree();
        refuse("delete on CompactDiscs");
        mE->tabs()->setCurrentIndex(1);
        mE->desktop.expectBox(u"not this one"_s);
        mE->button(2)->trigger();
        QCOMPARE(mE->tabs()->count(), 3);
        QCOMPARE(mE->cell(1, 3), u"Three"_s);
        allow();
        mE->button(2)->trigger();
        QCOMPARE(mE->tabs()->count(), 2);
    }

    // The id is given anew, and by then to another record.
    void aFailureOfTheFirstSave()
    {
        CdEditor *editor = mE->open<frmCDRoot>("I");
        mE->field("txtTitel")->setText(u"T"_s);
        mE->addTracks(texts("Anna|One"));
        refuse("insert on CompactDiscs");
        mE->desktop.expectBox(u"error"_s);
        editor->SaveAtUserRequest();
        QCOMPARE(editor->Mode, u"I"_s);
        allow();
        fillThree();
        editor->SaveAtUserRequest();
        QCOMPARE(editor->CdId, 5);
        QCOMPARE(mE->tracks(5), texts("1/1 Anna - One"));
        QCOMPARE(mE->tracks(3).size(), 4);
    }

    void aRecordDeletedMeanwhile()
    {
        CdEditor *editor = openThree();
        mE->catalogue.exec(
            "delete from CompactDiscs where CDTitels_ID=3; delete from CDTitels where "
            "ID=3; delete from Tracks where ID<4; delete from Artiesten where ID<3");
        mE->addTracks(texts("Dora|Five"));
        mE->desktop.expectBox(u"Nothing was saved"_s);
        editor->SaveKeepingPosition();
        QCOMPARE(three(), QStringList());
        mE->desktop.expectBox(u"save it anew"_s, vbYes);
        editor->SaveKeepingPosition();
        QCOMPARE(mE->catalogue.rows(titleRow.arg(5)), texts("It's 100%1|V|Rock|1999|NULL"));
        QCOMPARE(mE->tracks(5), texts("1/1 Anna - One", "1/2 Bob - Two", "1/3 Dora - Five"));
        QCOMPARE(mE->browser->refreshed, 1);
    }

    // The one saved without tracks has no row to hold on to: what is saved next is not its.
    void twoNewOnesOfOneTitle()
    {
        CdEditor *first = mE->open<frmCDRoot>("I");
        mE->field("txtTitel")->setText(u"Twins"_s);
        first->SaveAtUserRequest();
        CdEditor *second = mE->open<frmCDRoot>("I");
        mE->field("txtTitel")->setText(u"Twins"_s);
        mE->addTracks(texts("Bob|Two"));
        second->SaveAtUserRequest();
        mE->show(first);
        mE->addTracks(texts("Anna|One"));
        first->SaveAtUserRequest();
        QVERIFY(first->CdId != second->CdId);
        QCOMPARE(mE->tracks(first->CdId), texts("1/1 Anna - One"));
        QCOMPARE(mE->tracks(second->CdId), texts("1/1 Bob - Two"));
        QVERIFY(second->Unload());
    }

    // While events are handled in the middle of a save, no other command begins.
    void nobodyClosesABusyForm()
    {
        CdEditor *editor = openThree();
        mE->field("txtTitel")->setText(u"New title"_s);
        bool came = false;
        QTimer::singleShot(0, editor, [&] {
            came = true;
            mE->control<QPushButton>("cmdCancel")->click();
            mE->button(1)->trigger();
            mE->tabs()->setCurrentIndex(2);
            editor->SaveAtUserRequest();
        });
        editor->SaveKeepingPosition();
        QVERIFY(came && mE->editor && !editor->isUnloaded());
        QCOMPARE(mE->tabs()->count(), 3);
        QCOMPARE(mE->cell(1, 3), u"One"_s);
    }

    // Another screen refused to go, so typing went on: the No is none for what came later.
    void aNoCountsForThatCloseAlone()
    {
        struct Refusing : Form {
            Refusing() : Form(u"frmRefusing"_s) {}
            bool QueryUnload() override { return false; }
        };
        const QScopedValueRollback<QString> path(gDatabasePath, mE->catalogue.file());
        CdEditor *editor = openThree();
        const Refusing refusing;
        mE->field("txtTitel")->setText(u"Given up"_s);
        mE->desktop.expectBox(GetMessage("QuestSaveChanges"), vbNo);
        QVERIFY(!Form::UnloadAll({}));
        mE->field("txtTitel")->setText(u"Typed later"_s);
        editor->findChild<QTimer *>(u"RecoveryTimer"_s)->setInterval(0);
        QTRY_VERIFY(QFileInfo::exists(mE->catalogue.path("Unsaved")));
        QVERIFY(Form::UnloadAll({}, true));
        QVERIFY(QFileInfo::exists(mE->catalogue.path("Unsaved")));
    }
};

QTEST_MAIN(tst_frmCDRoot)
#include "tst_frmCDRoot.moc"
