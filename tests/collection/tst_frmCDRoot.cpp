// Label: screen
#include "collection/frmCDRoot.h"
#include "platform/ado/connection.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/editing.h"

#include <QApplication>
#include <QClipboard>
#include <QLabel>
#include <QPushButton>
#include <QTest>

/// The editor of compilations on a real catalogue file, with its real grid.
class tst_frmCDRoot : public QObject
{
    Q_OBJECT

private slots:
    void init() { mE = std::make_unique<Editing>(languageEnglish); }
    void cleanup() { mE.reset(); }
    void aNewRecord_data();
    void aNewRecord();
    void aRecordThatCannotBeShown_data();
    void aRecordThatCannotBeShown();
    void anExistingRecord();
    void years_data();
    void years();
    void leavingTheYear_data();
    void leavingTheYear();
    void keysOfTheFields_data();
    void keysOfTheFields();
    void signsAreText();
    void fieldsSelectTheirText();
    void pastedTextsHaveOneLine();
    void theGenreStaysAsTyped();
    void buttonsOfTheToolbar();
    void leavingTheGrid();
    void firstSave();
    void saveWithoutTracks();
    void whatASaveTouches_data();
    void whatASaveTouches();
    void refusedSaves_data();
    void refusedSaves();
    void leavingADiscSavesIt();
    void leavingADiscRefused();
    void addingADisc();
    void addingADiscRefused();
    void deletingADisc_data();
    void deletingADisc();
    void deletingTheOnlyDisc();
    void deletingADiscThatWasNeverSaved();
    void closing_data();
    void closing();
    void closingRefused();
    void aFailureTakesAllBack();
    void aFullDisk();
    void aDiscThatCannotBeDeleted();
    void aFailureOfTheFirstSave();
    void aRecordDeletedMeanwhile();
    void anIdGivenToAnotherMeanwhile();
    void nobodyClosesABusyForm();

private:
    // Compilation 3 "It's 100%1": disc 1 with two tracks, disc 2 with one, disc 3 with one.
    void fillThree();
    CdEditor *openThree();

    std::unique_ptr<Editing> mE;
};

namespace
{

const auto titleRow = QStringLiteral("select Titel, CD_Type, Genre, Hitjaar, Artiest_ID from "
                                     "CDTitels where ID = %1");

} // namespace

void tst_frmCDRoot::fillThree()
{
    mE->catalogue.exec(QStringLiteral(R"(
        insert into Artiesten values (1,'Anna'),(2,'Bob'),(3,'Cleo');
        insert into Tracks values (1,1,'One','Pop',1985),(2,2,'Two',null,null),(3,1,'Three',null,null),
            (4,3,'Four',null,null);
        insert into CDTitels values (3,'It''s 100%1',null,'V','Rock',1999),(4,'Other',null,'V',null,null);
        insert into CompactDiscs values (1,3,1,1,1,null),(2,3,1,2,2,null),(3,3,2,1,3,null),(4,3,3,1,4,null),
            (5,4,1,1,4,null);)"));
}

CdEditor *tst_frmCDRoot::openThree()
{
    fillThree();
    return mE->open<frmCDRoot>(QStringLiteral("U"), 3);
}

void tst_frmCDRoot::aNewRecord_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<QString>("year");
    QTest::addColumn<QString>("firstGenre");
    QTest::addColumn<QString>("tip");
    QTest::newRow("English") << languageEnglish << QStringLiteral("Compilation")
                             << QStringLiteral("Hityear:") << QStringLiteral("Books & Spoken")
                             << QStringLiteral("Previous track");
    QTest::newRow("Dutch") << languageDutch << QStringLiteral("Verzamel-CD")
                           << QStringLiteral("Hitjaar:") << QStringLiteral("Blues")
                           << QStringLiteral("Naar vorige track");
}

void tst_frmCDRoot::aNewRecord()
{
    QFETCH(int, language);
    gLanguage = language;
    CdEditor *editor = mE->open<frmCDRoot>(QStringLiteral("I"));
    QTEST(editor->windowTitle(), "caption");
    QTEST(mE->control<QLabel>("lblYear")->text(), "year");
    QTEST(mE->genre()->itemText(0), "firstGenre");
    QCOMPARE(mE->genre()->count(), 27);
    QCOMPARE(mE->genre()->currentText(), QString());
    QTEST(mE->button(11)->toolTip(), "tip");
    QCOMPARE(mE->tabs()->count(), 1);
    QCOMPARE(mE->tabs()->tabText(0), QStringLiteral("Disc &1"));
    QCOMPARE(mE->disk()->Language(), language);
    QCOMPARE(mE->disk()->DiscNo(), 1);
    QCOMPARE(QApplication::focusWidget(), mE->field("txtTitel"));
    for (int n = 1; n <= 11; ++n)
        QCOMPARE(mE->button(n)->isEnabled(), n != 4 && n != 5 && n != 11);
    QTest::keyClick(editor, Qt::Key_Escape);
    QVERIFY2(editor->isUnloaded(), "an untouched record closes without a question");
}

void tst_frmCDRoot::aRecordThatCannotBeShown_data()
{
    QTest::addColumn<QString>("mode");
    QTest::addColumn<int>("id");
    QTest::addColumn<QString>("box");
    QTest::addColumn<bool>("stays");
    QTest::newRow("no mode") << QStringLiteral("X") << 3
                             << QStringLiteral("error [System error] Invalid system mode!")
                             << false;
    QTest::newRow("no id") << QStringLiteral("U") << 0
                           << QStringLiteral("error [System error] Initialisation failed!")
                           << false;
    QTest::newRow("unknown id") << QStringLiteral("U") << 77
                                << QStringLiteral("error [System error] 3021 ") << true;
}

void tst_frmCDRoot::aRecordThatCannotBeShown()
{
    QFETCH(QString, mode);
    QFETCH(int, id);
    QFETCH(QString, box);
    QFETCH(bool, stays);
    fillThree();
    mE->desktop.expectBox(box);
    CdEditor *editor = mE->open<frmCDRoot>(mode, id);
    QCOMPARE(!editor->isUnloaded(), stays);
    QCOMPARE(editor->isVisible(), stays);
}

void tst_frmCDRoot::anExistingRecord()
{
    openThree();
    QCOMPARE(mE->field("txtTitel")->text(), QStringLiteral("It's 100%1"));
    QCOMPARE(mE->genre()->currentText(), QStringLiteral("Rock"));
    QCOMPARE(mE->field("txtYear")->text(), QStringLiteral("1999"));
    QCOMPARE(mE->tabs()->count(), 3);
    QCOMPARE(mE->tabs()->tabText(2), QStringLiteral("Disc &3"));
    QCOMPARE(mE->tabs()->currentIndex(), 0);
    QCOMPARE(mE->cell(2, 2), QStringLiteral("Bob"));
    QCOMPARE(mE->disk()->CdId(), 3);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_3, Qt::AltModifier);
    QCOMPARE(mE->tabs()->currentIndex(), 2);
    QCOMPARE(mE->cell(1, 3), QStringLiteral("Four"));
}

void tst_frmCDRoot::years_data()
{
    QTest::addColumn<QString>("year");
    QTest::addColumn<QString>("stored"); // empty: refused
    const std::pair<const char *, const char *> years[] = {
        {"", "NULL"},  {"1900", ""}, {"1901", "1901"}, {"9999", "9999"},        {"190", ""},
        {"19011", ""}, {"abcd", ""}, {"0x7D", ""},     {"1e10", "10000000000"}, {"-200", ""},
        {"20 5", ""}};
    for (const auto &[year, stored] : years)
        QTest::newRow(*year ? year : "empty")
            << QString::fromLatin1(year) << QString::fromLatin1(stored);
}

void tst_frmCDRoot::years()
{
    QFETCH(QString, year);
    QFETCH(QString, stored);
    CdEditor *editor = openThree();
    mE->field("txtYear")->setText(year);
    if (stored.isEmpty())
        mE->desktop.expectBox(QStringLiteral("Invalid year!"));
    editor->SaveAtUserRequest();
    QCOMPARE(mE->catalogue
                 .rows(QStringLiteral("select cast(ifnull(Hitjaar, 'NULL') as text) from CDTitels "
                                      "where ID = 3"))
                 .value(0)
                 .section(QLatin1Char('.'), 0, 0),
             stored.isEmpty() ? QStringLiteral("1999") : stored);
}

void tst_frmCDRoot::leavingTheYear_data()
{
    QTest::addColumn<QString>("year");
    QTest::addColumn<bool>("box");
    QTest::addColumn<bool>("leaves");
    QTest::newRow("a year") << QStringLiteral("1985") << false << true;
    QTest::newRow("no year") << QStringLiteral("1900") << true << false;
    QTest::newRow("empty") << QString() << false << false;
}

void tst_frmCDRoot::leavingTheYear()
{
    QFETCH(QString, year);
    QFETCH(bool, box);
    QFETCH(bool, leaves);
    mE->open<frmCDRoot>(QStringLiteral("I"));
    QLineEdit *field = mE->field("txtYear");
    for (const Qt::Key key : {Qt::Key_Tab, Qt::Key_Backtab}) {
        field->setFocus();
        field->setText(year);
        if (box)
            mE->desktop.expectBox(QStringLiteral("Invalid year!"));
        keyboard::press(key);
        QCOMPARE(QApplication::focusWidget() != field, leaves);
        QCOMPARE(field->text(), leaves ? year : QString());
    }
    field->setFocus();
    field->setText(QStringLiteral("19"));
    keyboard::press(Qt::Key_PageDown);
    QVERIFY2(QApplication::focusWidget() != field, "there is a way out by the keyboard");
    QCOMPARE(field->text(), QStringLiteral("19"));
}

void tst_frmCDRoot::keysOfTheFields_data()
{
    QTest::addColumn<QString>("field");
    for (const char *field : {"txtTitel", "Genre", "txtYear"})
        QTest::newRow(field) << QString::fromLatin1(field);
}

void tst_frmCDRoot::keysOfTheFields()
{
    QFETCH(QString, field);
    openThree();
    auto *widget = mE->editor->findChild<QWidget *>(field);
    widget->setFocus();
    keyboard::press(Qt::Key_PageDown);
    QVERIFY(mE->disk()->hasFocus());
    QCOMPARE(mE->disk()->CurrentRow(), 2);
    widget->setFocus();
    keyboard::press(Qt::Key_PageUp);
    QCOMPARE(mE->disk()->CurrentRow(), 1);
    widget->setFocus();
    for (const auto modifiers : {Qt::NoModifier, Qt::KeyboardModifier(Qt::ControlModifier)}) {
        keyboard::press(Qt::Key_End, modifiers);
        keyboard::press(Qt::Key_Insert, modifiers);
    }
    keyboard::press(Qt::Key_Insert, Qt::ShiftModifier | Qt::ControlModifier);
    QCOMPARE(mE->tabs()->count(), 3);
    keyboard::press(Qt::Key_Insert, Qt::ShiftModifier);
    QCOMPARE(mE->tabs()->count(), 4);
    QCOMPARE(mE->tabs()->currentIndex(), 3);
    keyboard::press(Qt::Key_End, Qt::ShiftModifier);
    QCOMPARE(mE->tabs()->count(), 3);
    QCOMPARE(mE->tracks(3).size(), 4);
}

// Signs whose codes are those of keys without a sign: page up and down, End, Insert, Delete.
void tst_frmCDRoot::signsAreText()
{
    openThree();
    mE->field("txtTitel")->setFocus();
    for (const char sign : {'!', '"', '#', '$', '%', '&', '\'', '(', '-', '.'}) {
        QTest::keyClick(mE->field("txtTitel"), sign, Qt::ShiftModifier);
        QTest::keyClick(mE->field("txtTitel"), sign);
    }
    QCOMPARE(mE->field("txtTitel")->text(), QStringLiteral("!!\"\"##$$%%&&''((--..It's 100%1"));
    QCOMPARE(mE->tabs()->count(), 3);
    QCOMPARE(QApplication::focusWidget(), mE->field("txtTitel"));
}

void tst_frmCDRoot::fieldsSelectTheirText()
{
    openThree();
    for (const char *name : {"txtTitel", "txtYear"}) {
        QLineEdit *field = mE->field(name);
        mE->disk()->setFocus();
        field->deselect();
        QTest::mouseClick(field, Qt::LeftButton);
        QTRY_COMPARE(field->selectedText(), field->text());
    }
    mE->genre()->setFocus();
    QCOMPARE(mE->genre()->lineEdit()->selectedText(), QStringLiteral("Rock"));
}

void tst_frmCDRoot::pastedTextsHaveOneLine()
{
    mE->open<frmCDRoot>(QStringLiteral("I"));
    QLineEdit *title = mE->field("txtTitel");
    QApplication::clipboard()->setText(QStringLiteral("Best\r\nof \u2028 all"));
    keyboard::press(Qt::Key_V, Qt::ControlModifier);
    QCOMPARE(title->text(), QStringLiteral("Best of all"));
    title->clear();
    QApplication::clipboard()->setText(QString(254, QLatin1Char('x')) +
                                       QStringLiteral("\U0001F3B5"));
    keyboard::press(Qt::Key_V, Qt::ControlModifier);
    QCOMPARE(title->text(), QString(254, QLatin1Char('x')));
}

void tst_frmCDRoot::theGenreStaysAsTyped()
{
    CdEditor *editor = openThree();
    mE->genre()->setFocus();
    keyboard::type(QStringLiteral("folk"));
    keyboard::press(Qt::Key_Tab);
    QCOMPARE(mE->genre()->currentText(), QStringLiteral("folk"));
    mE->genre()->setFocus();
    keyboard::type(QStringLiteral("R'n''B \"50%2 off\""));
    keyboard::press(Qt::Key_Backtab);
    editor->SaveAtUserRequest();
    QCOMPARE(mE->catalogue.rows(QStringLiteral("select Genre from CDTitels where ID=3")),
             texts("R'n''B \"50%2 off\""));
    QCOMPARE(mE->genre()->count(), 27);
}

void tst_frmCDRoot::buttonsOfTheToolbar()
{
    openThree();
    mE->field("txtTitel")->setFocus();
    mE->button(10)->trigger();
    QVERIFY(mE->disk()->hasFocus());
    QCOMPARE(mE->disk()->CurrentRow(), 1);
    for (const int n : {4, 5, 11})
        QVERIFY(mE->button(n)->isEnabled());
    mE->button(10)->trigger();
    QCOMPARE(mE->disk()->CurrentRow(), 2);
    mE->button(11)->trigger();
    QCOMPARE(mE->disk()->CurrentRow(), 1);
    mE->button(7)->trigger();
    QCOMPARE(mE->disk()->CurrentRow(), 2);
    mE->button(6)->trigger();
    QCOMPARE(mE->disk()->CurrentRow(), 1);
    const int column = mE->disk()->CurrentColumn();
    mE->button(8)->trigger();
    QCOMPARE(mE->disk()->CurrentColumn(), column + 1);
    mE->button(9)->trigger();
    QCOMPARE(mE->disk()->CurrentColumn(), column);
    mE->button(4)->trigger();
    QCOMPARE(mE->cell(1, 2), QString());
    QCOMPARE(mE->cell(2, 2), QStringLiteral("Anna"));
    mE->button(5)->trigger();
    QCOMPARE(mE->cell(1, 2), QStringLiteral("Anna"));
    mE->field("txtTitel")->setFocus();
    mE->button(8)->trigger();
    QVERIFY2(mE->genre()->hasFocus(), "the next field of whatever has the focus");
    for (const int n : {4, 5, 11})
        QVERIFY(!mE->button(n)->isEnabled());
}

void tst_frmCDRoot::leavingTheGrid()
{
    openThree();
    mE->disk()->setFocus();
    emit mE->disk()->LeaveForward();
    QCOMPARE(QApplication::focusWidget(), mE->field("txtTitel"));
    emit mE->disk()->LeaveBackward();
    QCOMPARE(QApplication::focusWidget(), mE->field("txtYear"));
}

void tst_frmCDRoot::firstSave()
{
    CdEditor *editor = mE->open<frmCDRoot>(QStringLiteral("I"));
    const QString title = QStringLiteral("O'Neill's 50%2 off \U0001F3B5");
    keyboard::fill({title, QStringLiteral("Pop"), QStringLiteral("1999")});
    mE->addTracks({QStringLiteral("Anna|One|Pop|1985"), QStringLiteral("Bob|Two")});
    editor->SaveKeepingPosition();
    QCOMPARE(editor->Mode, QStringLiteral("U"));
    QCOMPARE(editor->CdId, 1);
    QCOMPARE(mE->catalogue.rows(titleRow.arg(1)),
             QStringList(title + QStringLiteral("|V|Pop|1999|NULL")));
    QCOMPARE(mE->tracks(1), texts("1/1 Anna - One", "1/2 Bob - Two"));
    QCOMPARE(mE->browser->refreshed, 1);
    QVERIFY(!mE->disk()->IsChanged());
    QVERIFY(mE->disk()->CurrentRow() == 2 && mE->disk()->hasFocus());
    editor->SaveKeepingPosition();
    QCOMPARE(mE->catalogue.count(QStringLiteral("select count(*) from CDTitels")), 1);
    QCOMPARE(mE->browser->refreshed, 1);
}

void tst_frmCDRoot::saveWithoutTracks()
{
    CdEditor *editor = mE->open<frmCDRoot>(QStringLiteral("I"));
    mE->field("txtTitel")->setText(QStringLiteral("Empty"));
    editor->SaveAtUserRequest();
    QCOMPARE(editor->Mode, QStringLiteral("U"));
    QCOMPARE(mE->catalogue.count(QStringLiteral("select count(*) from CDTitels")), 0);
    mE->addTracks({QStringLiteral("Anna|One")});
    editor->SaveAtUserRequest();
    QCOMPARE(mE->catalogue.rows(titleRow.arg(1)), texts("Empty|V|NULL|NULL|NULL"));
    QCOMPARE(mE->tracks(1), texts("1/1 Anna - One"));
}

void tst_frmCDRoot::whatASaveTouches_data()
{
    QTest::addColumn<QString>("field");
    QTest::addColumn<bool>("updates");
    QTest::addColumn<int>("refreshes");
    QTest::newRow("nothing") << QString() << false << 0;
    QTest::newRow("title") << QStringLiteral("txtTitel") << true << 1;
    QTest::newRow("title, case only") << QStringLiteral("case") << true << 1;
    QTest::newRow("year") << QStringLiteral("txtYear") << true << 0;
    QTest::newRow("genre") << QStringLiteral("Genre") << true << 0;
    QTest::newRow("track") << QStringLiteral("grid") << false << 1;
}

void tst_frmCDRoot::whatASaveTouches()
{
    QFETCH(QString, field);
    CdEditor *editor = openThree();
    mE->catalogue.exec(
        QStringLiteral("create table Log(x); create trigger logged after update on CDTitels "
                       "begin insert into Log values (1); end"));
    if (field == QLatin1String("case"))
        mE->field("txtTitel")->setText(QStringLiteral("IT'S 100%1"));
    else if (field == QLatin1String("grid"))
        mE->setCell(2, 3, QStringLiteral("Other song"));
    else if (field == QLatin1String("Genre"))
        mE->genre()->setEditText(QStringLiteral("Jazz"));
    else if (!field.isEmpty())
        mE->editor->findChild<QLineEdit *>(field)->setText(QStringLiteral("2001"));
    editor->SaveAtUserRequest();
    QTEST(mE->catalogue.count(QStringLiteral("select count(*) from Log")) == 1, "updates");
    QTEST(mE->browser->refreshed, "refreshes");
    mE->catalogue.exec(QStringLiteral("delete from Log"));
    editor->SaveAtUserRequest();
    QCOMPARE(mE->catalogue.count(QStringLiteral("select count(*) from Log")), 0);
}

void tst_frmCDRoot::refusedSaves_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("year");
    QTest::addColumn<QString>("track");
    QTest::addColumn<QString>("box");
    QTest::newRow("no title") << QString() << QStringLiteral("19") << QString()
                              << QStringLiteral("Please fill in the title of this compilation!");
    QTest::newRow("blank title") << QStringLiteral("  ") << QString() << QString()
                                 << QStringLiteral("Please fill in the title of this compilation!");
    QTest::newRow("no year") << QStringLiteral("T") << QStringLiteral("1900") << QString()
                             << QStringLiteral("Invalid year!");
    QTest::newRow("track without a title")
        << QStringLiteral("T") << QString() << QStringLiteral("Zoe")
        << QStringLiteral("please fill in the title!");
}

void tst_frmCDRoot::refusedSaves()
{
    QFETCH(QString, title);
    QFETCH(QString, year);
    QFETCH(QString, track);
    QFETCH(QString, box);
    CdEditor *editor = openThree();
    const QStringList before = mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3);
    mE->field("txtTitel")->setText(title);
    mE->field("txtYear")->setText(year);
    if (!track.isEmpty())
        mE->addTracks({track});
    mE->desktop.expectBox(box);
    editor->SaveKeepingPosition();
    QCOMPARE(mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3), before);
    QCOMPARE(mE->browser->refreshed, 0);
    QVERIFY(editor->updatesEnabled() && editor->cursor().shape() == Qt::ArrowCursor);
}

void tst_frmCDRoot::leavingADiscSavesIt()
{
    openThree();
    mE->addTracks({QStringLiteral("Dora|Five")});
    mE->field("txtTitel")->setText(QStringLiteral("New title"));
    mE->tabs()->setCurrentIndex(1);
    QCOMPARE(mE->tracks(3).value(2), QStringLiteral("1/3 Dora - Five"));
    QCOMPARE(mE->catalogue.rows(titleRow.arg(3)).value(0).section(QLatin1Char('|'), 0, 0),
             QStringLiteral("New title"));
    QCOMPARE(mE->cell(1, 3), QStringLiteral("Three"));
    QCOMPARE(mE->disk()->DiscNo(), 2);
    mE->tabs()->setCurrentIndex(0);
    QCOMPARE(mE->cell(3, 2), QStringLiteral("Dora"));
}

void tst_frmCDRoot::leavingADiscRefused()
{
    openThree();
    mE->field("txtTitel")->clear();
    mE->disk()->setFocus();
    mE->disk()->setCurrentRow(2);
    mE->disk()->setCurrentColumn(4);
    mE->desktop.expectBox(QStringLiteral("error"));
    mE->desktop.expectBox(QStringLiteral("information"));
    QTest::mouseClick(mE->tabs(), Qt::LeftButton, {}, mE->tabs()->tabRect(2).center());
    QVERIFY(mE->desktop.boxes.at(0).endsWith(GetMessage("MsgCompNoTitle")));
    QVERIFY(mE->desktop.boxes.at(1).endsWith(GetMessage("MsgDiscNav")));
    QCOMPARE(mE->tabs()->currentIndex(), 0);
    QCOMPARE(mE->cell(1, 3), QStringLiteral("One"));
    QCOMPARE(mE->disk()->CurrentRow(), 2);
    QCOMPARE(mE->disk()->CurrentColumn(), 4);
    mE->field("txtTitel")->setText(QStringLiteral("T"));
    QTest::mouseClick(mE->tabs(), Qt::LeftButton, {}, mE->tabs()->tabRect(2).center());
    QCOMPARE(mE->cell(1, 3), QStringLiteral("Four"));
}

void tst_frmCDRoot::addingADisc()
{
    openThree();
    mE->disk()->setFocus();
    keyboard::press(Qt::Key_Insert, Qt::ShiftModifier);
    QCOMPARE(mE->tabs()->count(), 4);
    QCOMPARE(mE->tabs()->tabText(3), QStringLiteral("Disc &4"));
    QCOMPARE(mE->disk()->DiscNo(), 4);
    QVERIFY(!mE->disk()->IsChanged() && mE->disk()->model()->rowCount() == 1);
    mE->addTracks({QStringLiteral("Anna|One")});
    mE->tabs()->setCurrentIndex(0);
    QCOMPARE(mE->tracks(3).last(), QStringLiteral("4/1 Anna - One"));
    QCOMPARE(mE->catalogue.count(QStringLiteral("select count(*) from Tracks where Titel='One'")),
             1);
}

void tst_frmCDRoot::addingADiscRefused()
{
    openThree();
    mE->field("txtTitel")->clear();
    mE->desktop.expectBox(GetMessage("MsgCompNoTitle"));
    mE->desktop.expectBox(QStringLiteral("] ") + GetMessage("MsgAddDisc"));
    mE->button(1)->trigger();
    QVERIFY(mE->desktop.boxes.last().startsWith(QLatin1String("information")));
    QCOMPARE(mE->tabs()->count(), 3);
}

void tst_frmCDRoot::deletingADisc_data()
{
    QTest::addColumn<int>("tab");
    QTest::addColumn<int>("tabAfter");
    QTest::addColumn<QString>("shown");
    QTest::newRow("first") << 0 << 0 << QStringLiteral("Three");
    QTest::newRow("middle") << 1 << 1 << QStringLiteral("Four");
    QTest::newRow("last") << 2 << 1 << QStringLiteral("Three");
}

void tst_frmCDRoot::deletingADisc()
{
    QFETCH(int, tab);
    CdEditor *editor = openThree();
    mE->tabs()->setCurrentIndex(tab);
    mE->disk()->setFocus();
    const QPoint place = editor->pos();
    keyboard::press(Qt::Key_End, Qt::ShiftModifier);
    QCOMPARE(mE->editor, editor);
    QVERIFY(editor->isVisible() && editor->pos() == place);
    QCOMPARE(mE->tabs()->count(), 2);
    QTEST(mE->tabs()->currentIndex(), "tabAfter");
    QTEST(mE->cell(1, 3), "shown");
    QCOMPARE(mE->catalogue.rows(
                 QStringLiteral("select distinct DiskNo from CompactDiscs where CDTitels_ID=3")),
             texts("1", "2"));
    QVERIFY2(mE->disk()->hasFocus() && mE->button(4)->isEnabled(), "the grid keeps the focus");
    QCOMPARE(mE->disk()->CurrentRow(), 1);
    QVERIFY(mE->browser->refreshed >= 1);
    QCOMPARE(mE->catalogue.count(QStringLiteral("select count(*) from Tracks where ID=4")),
             1); // shared
    QVERIFY(editor->updatesEnabled());
}

void tst_frmCDRoot::deletingTheOnlyDisc()
{
    fillThree();
    mE->open<frmCDRoot>(QStringLiteral("U"), 4);
    mE->disk()->setFocus();
    mE->disk()->setCurrentColumn(3);
    mE->desktop.expectBox(GetMessage("MsgDiscDel"));
    keyboard::press(Qt::Key_End, Qt::ShiftModifier);
    QCOMPARE(mE->disk()->CurrentColumn(), 3);
    QCOMPARE(mE->tracks(4), texts("1/1 Cleo - Four"));
}

void tst_frmCDRoot::deletingADiscThatWasNeverSaved()
{
    CdEditor *editor = mE->open<frmCDRoot>(QStringLiteral("I"));
    mE->field("txtTitel")->setText(QStringLiteral("Two empty discs"));
    keyboard::press(Qt::Key_Insert, Qt::ShiftModifier);
    QCOMPARE(mE->tabs()->count(), 2);
    mE->desktop.expectBox(QStringLiteral("3021"));
    keyboard::press(Qt::Key_End, Qt::ShiftModifier);
    QCOMPARE(mE->tabs()->count(), 1);
    QCOMPARE(mE->field("txtTitel")->text(), QStringLiteral("Two empty discs"));
    mE->addTracks({QStringLiteral("Anna|One")});
    editor->SaveAtUserRequest();
    QCOMPARE(mE->tracks(editor->CdId), texts("1/1 Anna - One"));
}

void tst_frmCDRoot::closing_data()
{
    QTest::addColumn<QString>("how");
    QTest::addColumn<bool>("saved");
    for (const char *change : {"title", "track", "cell"}) {
        QTest::newRow(QByteArray(change).append(", cancel"))
            << QStringLiteral("cancel ") + QLatin1String(change) << false;
        QTest::newRow(QByteArray(change).append(", yes"))
            << QStringLiteral("yes ") + QLatin1String(change) << true;
        QTest::newRow(QByteArray(change).append(", no"))
            << QStringLiteral("no ") + QLatin1String(change) << false;
    }
}

void tst_frmCDRoot::closing()
{
    QFETCH(QString, how);
    QFETCH(bool, saved);
    CdEditor *editor = openThree();
    if (how.endsWith(QLatin1String("title")))
        mE->field("txtTitel")->setText(QStringLiteral("X"));
    else if (how.endsWith(QLatin1String("track")))
        mE->setCell(1, 3, QStringLiteral("X"));
    if (how.endsWith(QLatin1String("cell"))) { // still being typed
        mE->disk()->setFocus();
        mE->disk()->setCurrentColumn(3);
        keyboard::type(QStringLiteral("X"));
    }
    if (how.startsWith(QLatin1String("cancel"))) {
        mE->control<QPushButton>("cmdCancel")->click();
    } else {
        mE->desktop.expectBox(QStringLiteral("Do yo want to save changes?"),
                              how.startsWith(QLatin1String("yes")) ? vbYes : vbNo);
        editor->close();
    }
    QVERIFY(editor->isUnloaded());
    QCOMPARE(mE->catalogue.count(
                 QStringLiteral("select count(*) from (select Titel from CDTitels union all "
                                "select Titel from Tracks) where Titel = 'X'")),
             int(saved));
}

void tst_frmCDRoot::closingRefused()
{
    CdEditor *editor = openThree();
    mE->field("txtTitel")->clear();
    mE->desktop.expectBox(QStringLiteral("yes-no"), vbYes);
    mE->desktop.expectBox(GetMessage("MsgCompNoTitle"));
    mE->desktop.expectBox(GetMessage("MsgWindowCannotBeClosed"));
    QVERIFY(!editor->close());
    QVERIFY(editor->isVisible() && editor->updatesEnabled());
}

void tst_frmCDRoot::aFailureTakesAllBack()
{
    CdEditor *editor = openThree();
    const QStringList before = mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3);
    mE->catalogue.exec(
        QStringLiteral("create trigger refuse before insert on Tracks when new.Titel='Bad' "
                       "begin select raise(abort, 'not this one'); end"));
    mE->field("txtTitel")->setText(QStringLiteral("New title"));
    mE->addTracks({QStringLiteral("New|Good"), QStringLiteral("New|Bad")});
    mE->desktop.expectBox(QStringLiteral("error [System error] "));
    editor->SaveKeepingPosition();
    QVERIFY(mE->desktop.boxes.last().contains(QLatin1String("not this one")));
    QCOMPARE(mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3), before);
    QVERIFY(mE->disk()->IsChanged());
    mE->catalogue.exec(QStringLiteral("drop trigger refuse"));
    editor->SaveKeepingPosition();
    QCOMPARE(mE->tracks(3).mid(2, 2), texts("1/3 New - Good", "1/4 New - Bad"));
    QVERIFY(editor->updatesEnabled());
}

// The engine itself reports it, at a size that the file may not pass.
void tst_frmCDRoot::aFullDisk()
{
    CdEditor *editor = openThree();
    const QStringList before = mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3);
    QStringList lines;
    for (int i = 0; i < 100; ++i)
        lines.append(QStringLiteral("Anna\t") + QString(200, QLatin1Char('x')) +
                     QString::number(i));
    QApplication::clipboard()->setText(lines.join(QLatin1Char('\n')));
    mE->disk()->setFocus();
    mE->disk()->setCurrentRow(3);
    mE->disk()->setCurrentColumn(2);
    keyboard::press(Qt::Key_V, Qt::ControlModifier);
    gConnection->housekeeping("PRAGMA max_page_count=1"); // as many as there are
    mE->desktop.expectBox(QStringLiteral("The disk is full; nothing was written."));
    editor->SaveKeepingPosition();
    QCOMPARE(mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3), before);
    gConnection->housekeeping("PRAGMA max_page_count=100000");
    editor->SaveKeepingPosition();
    QCOMPARE(mE->tracks(3).size(), 104);
}

void tst_frmCDRoot::aDiscThatCannotBeDeleted()
{
    CdEditor *editor = openThree();
    mE->catalogue.exec(QStringLiteral("create trigger refuse before delete on CompactDiscs "
                                      "begin select raise(abort, 'not this one'); end"));
    mE->tabs()->setCurrentIndex(1);
    mE->desktop.expectBox(QStringLiteral("not this one"));
    mE->button(2)->trigger();
    QCOMPARE(mE->tracks(3).size(), 4);
    QCOMPARE(mE->tabs()->count(), 3);
    QCOMPARE(mE->cell(1, 3), QStringLiteral("Three"));
    mE->catalogue.exec(QStringLiteral("drop trigger refuse"));
    mE->button(2)->trigger();
    QCOMPARE(mE->tabs()->count(), 2);
    QVERIFY(editor->updatesEnabled());
}

// The id is given anew, and by then to another record.
void tst_frmCDRoot::aFailureOfTheFirstSave()
{
    CdEditor *editor = mE->open<frmCDRoot>(QStringLiteral("I"));
    mE->field("txtTitel")->setText(QStringLiteral("T"));
    mE->addTracks({QStringLiteral("Anna|One")});
    mE->catalogue.exec(QStringLiteral("create trigger refuse before insert on CompactDiscs "
                                      "begin select raise(abort, 'no'); end"));
    mE->desktop.expectBox(QStringLiteral("error"));
    editor->SaveAtUserRequest();
    QCOMPARE(editor->Mode, QStringLiteral("I"));
    mE->catalogue.exec(QStringLiteral("drop trigger refuse"));
    fillThree();
    editor->SaveAtUserRequest();
    QCOMPARE(editor->CdId, 5);
    QCOMPARE(mE->tracks(5), texts("1/1 Anna - One"));
    QCOMPARE(mE->tracks(3).size(), 4);
}

void tst_frmCDRoot::aRecordDeletedMeanwhile()
{
    CdEditor *editor = openThree();
    mE->catalogue.exec(
        QStringLiteral("delete from CompactDiscs where CDTitels_ID=3; delete from CDTitels where "
                       "ID=3; delete from Tracks where ID<4; delete from Artiesten where ID<3"));
    mE->addTracks({QStringLiteral("Dora|Five")});
    editor->SaveKeepingPosition();
    QCOMPARE(mE->catalogue.rows(titleRow.arg(3)), texts("It's 100%1|V|Rock|1999|NULL"));
    QCOMPARE(mE->tracks(3), texts("1/1 Anna - One", "1/2 Bob - Two", "1/3 Dora - Five"));
    QCOMPARE(mE->browser->refreshed, 1);
}

void tst_frmCDRoot::anIdGivenToAnotherMeanwhile()
{
    CdEditor *editor = openThree();
    mE->catalogue.exec(
        QStringLiteral("update CDTitels set Titel='Another' where ID=3; update CompactDiscs set "
                       "Track_ID=4 where CDTitels_ID=3"));
    const QStringList before = mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3);
    mE->addTracks({QStringLiteral("Dora|Five")});
    for (const int language : {languageEnglish, languageDutch}) {
        gLanguage = language;
        mE->desktop.expectBox(language == languageDutch ? QStringLiteral("Er is niets opgeslagen")
                                                        : QStringLiteral("Nothing was saved"));
        editor->SaveKeepingPosition();
    }
    QCOMPARE(mE->catalogue.rows(titleRow.arg(3)) + mE->tracks(3), before);
    QVERIFY(mE->disk()->IsChanged());
    gLanguage = languageEnglish;
}

// While events are handled in the middle of a save, no other command begins.
void tst_frmCDRoot::nobodyClosesABusyForm()
{
    CdEditor *editor = openThree();
    mE->field("txtTitel")->setText(QStringLiteral("New title"));
    bool came = false;
    QTimer::singleShot(0, editor, [&] {
        came = true;
        mE->control<QPushButton>("cmdCancel")->click();
        mE->button(1)->trigger();
        mE->tabs()->setCurrentIndex(2);
        editor->SaveAtUserRequest();
    });
    editor->SaveKeepingPosition();
    QVERIFY(came);
    QVERIFY(mE->editor && !editor->isUnloaded());
    QCOMPARE(mE->tabs()->count(), 3);
    QCOMPARE(mE->tabs()->currentIndex(), 0);
    QCOMPARE(mE->cell(1, 3), QStringLiteral("One"));
}

QTEST_MAIN(tst_frmCDRoot)
#include "tst_frmCDRoot.moc"
