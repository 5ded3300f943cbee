// Label: screen
#include "controls/Disk.h"
#include "controls/DiskE.h"
#include "controls/celledit.h"
#include "platform/ado/connection.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QApplication>
#include <QClipboard>
#include <QHeaderView>
#include <QListWidget>
#include <QSignalSpy>
#include <QTest>
#include <QVBoxLayout>

/// Both track grids on a screen with a field before and one behind, as a person uses them.
class tst_Disk : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase() { QApplication::setActiveWindow(nullptr); }
    void init();
    void cleanup();
    void columnsAndHeads_data();
    void columnsAndHeads();
    void typing_data();
    void typing();
    void keysOfTheToolbar_data();
    void keysOfTheToolbar();
    void tabLeavesAtTheEnds();
    void requests_data();
    void requests();
    void focusIsTheGridsWhileItEdits();
    void yearsAreChecked_data();
    void yearsAreChecked();
    void completion();
    void genres_data();
    void genres();
    void clipboard();
    void undo();
    void refusedRows_data();
    void refusedRows();
    void keptValuesAreTold();
    void savesWhatIsBeingTyped();
    void aRollbackUndoesTheSave();
    void positions();
    void widthsFollow();

private:
    template <typename Grid> Grid *show();
    Disk *showDisk() { return show<Disk>(); }
    void save();
    void type(const char *keys); // plain text; "{Key}" and "{Mod+Key}" are typed keys
    void send(const char *keys) { mDesktop->sendKeys(QLatin1String(keys)); }
    QString cells() const;
    QString place() const;
    CellEdit *edit() const { return shown<CellEdit>(); }
    QListWidget *popup() const { return shown<QListWidget>(); }

    // The one that is on the screen: earlier ones go when the event loop comes round.
    template <typename Widget> Widget *shown() const
    {
        for (auto *widget : mScreen->findChildren<Widget *>())
            if (widget->isVisible())
                return widget;
        return nullptr;
    }

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
    std::unique_ptr<QWidget> mScreen;
    QPointer<TrackGrid> mGrid;
    QLineEdit *mBefore = nullptr, *mBehind = nullptr;
};

void tst_Disk::init()
{
    gLanguage = languageEnglish;
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
    mCatalogue->exec(QStringLiteral(
        "insert into artiesten values (1,'Abba'),(2,'Beck'),(3,'Belle and Sebastian');"
        "insert into tracks values (1,1,'Waterloo','Pop',1974),(2,1,'SOS',NULL,NULL),"
        "(3,2,'Loser',NULL,1994);"
        "insert into cdtitels values (1,'Hits',NULL,'V',NULL,NULL),(2,'Gold',1,'E',NULL,NULL);"
        "insert into compactdiscs values (1,1,1,1,1,NULL),(2,1,1,2,3,NULL),(3,2,1,1,1,NULL)"));
}

void tst_Disk::cleanup()
{
    mScreen.reset();
    mDesktop->verifyAllCame();
    mCatalogue.reset();
    mDesktop.reset();
}

template <typename Grid> Grid *tst_Disk::show()
{
    mScreen = std::make_unique<QWidget>();
    auto *layout = new QVBoxLayout(mScreen.get());
    auto *grid = new Grid;
    mGrid = grid;
    layout->addWidget(mBefore = new QLineEdit);
    layout->addWidget(grid);
    layout->addWidget(mBehind = new QLineEdit);
    grid->setLanguage(gLanguage);
    grid->setConnection(gConnection.get());
    grid->setCdId(std::is_same_v<Grid, Disk> ? 1 : 2);
    grid->setDiscNo(1);
    grid->LoadDisc();
    mScreen->resize(700, 400);
    mScreen->show();
    QApplication::setActiveWindow(mScreen.get());
    grid->setFocus();
    return grid;
}

void tst_Disk::save()
{
    ADODB::Transaction transaction(*gConnection);
    mGrid->SaveDisc();
    if (mGrid->HasError())
        transaction.RollbackTrans();
    else
        transaction.CommitTrans();
}

void tst_Disk::type(const char *keys)
{
    static const QRegularExpression parts(QStringLiteral("\\{([^}]+)\\}|([^{]+)"));
    auto it = parts.globalMatch(QString::fromUtf8(keys));
    while (it.hasNext()) {
        const auto match = it.next();
        if (match.captured(1).isEmpty()) {
            for (const QChar c : match.captured(2))
                QTest::sendKeyEvent(QTest::Click, QApplication::focusWidget(), Qt::Key_unknown,
                                    QString(c), Qt::NoModifier);
            continue;
        }
        const QKeyCombination key = QKeySequence(match.captured(1))[0];
        QTest::keyClick(QApplication::focusWidget(), key.key(), key.keyboardModifiers());
    }
}

QString tst_Disk::cells() const
{
    const auto *model = mGrid->model();
    QString all;
    for (int row = 0; row + 1 < model->rowCount(); ++row) {
        QStringList line;
        for (int column = 1; column < model->columnCount(); ++column)
            line.append(model->index(row, column).data().toString());
        all += line.join(u',') + u'/';
    }
    return all;
}

QString tst_Disk::place() const
{
    return QString::number(mGrid->CurrentRow()) + u'.' + QString::number(mGrid->CurrentColumn());
}

void tst_Disk::columnsAndHeads_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QStringList>("disk");
    QTest::newRow("English") << languageEnglish
                             << texts("Track", "Artist", "Title", "Genre", "Hityear");
    QTest::newRow("Dutch") << languageDutch
                           << texts("Tracknr", "Artiest", "Titel", "Genre", "Hitjaar");
}

void tst_Disk::columnsAndHeads()
{
    QFETCH(int, language);
    QFETCH(QStringList, disk);
    gLanguage = language;
    const auto heads = [this] {
        QStringList found;
        for (int column = 0; column < mGrid->model()->columnCount(); ++column)
            found.append(mGrid->model()->headerData(column, Qt::Horizontal).toString());
        return found;
    };
    showDisk();
    QCOMPARE(mGrid->Language(), language);
    QCOMPARE(heads(), disk);
    QCOMPARE(cells(), QStringLiteral("Abba,Waterloo,Pop,1974/Beck,Loser,,1994/"));
    QVERIFY(!mGrid->accessibleName().isEmpty());
    type("{Return}");
    QCOMPARE(edit()->accessibleName(), disk[1]);
    show<DiskE>();
    disk.removeAt(1);
    QCOMPARE(heads(), disk);
    QCOMPARE(cells(), QStringLiteral("Waterloo,Pop,1974/"));
}

void tst_Disk::typing_data()
{
    QTest::addColumn<QByteArray>("keys"); // from the first artist on
    QTest::addColumn<QString>("cells");
    QTest::addColumn<QString>("place");
    const auto row = [](const char *keys, const char *cells, const char *place) {
        QTest::newRow(keys) << QByteArray(keys) << QString::fromUtf8(cells)
                            << QString::fromUtf8(place);
    };
    const char *const asItWas = "Abba,Waterloo,Pop,1974/Beck,Loser,,1994/";
    row("Cher{Return}", "Cher,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
    row("{Return}!{Return}", "Abba!,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
    row("{F2}x{Esc}", asItWas, "1.2");
    row("x{Esc}{Esc}", asItWas, "1.2");
    row("{Left}x{Tab}", "x,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.3");
    row("{Tab}x{Tab}y{Shift+Tab}z{Return}", "Abba,z,y,1974/Beck,Loser,,1994/", "2.3");
    row("{Delete}", ",Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
    row("{Down}{Down}Cher{Tab}Believe{Tab}{Tab}1998{Tab}Dido",
        "Abba,Waterloo,Pop,1974/Beck,Loser,,1994/Cher,Believe,,1998/", "4.2");
    row("{Down}{Down}{Down}Cher{Return}", "Abba,Waterloo,Pop,1974/Beck,Loser,,1994/Cher,,,/",
        "4.2");
    row("x{Down}", "x,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
    row("x{Home}y{End}z{Return}", "yxz,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
    row("x{Insert}", ",,,/x,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
    row("{PgDown}{Insert}q{PgUp}", "Abba,Waterloo,Pop,1974/q,,,/Beck,Loser,,1994/", "1.2");
    row("{End}", "Beck,Loser,,1994/", "1.2");
}

void tst_Disk::typing()
{
    QFETCH(QByteArray, keys);
    showDisk();
    type(keys.constData());
    QTEST(cells(), "cells");
    QTEST(place(), "place");
    QVERIFY(mScreen->isVisible());
}

void tst_Disk::keysOfTheToolbar_data()
{
    QTest::addColumn<QByteArray>("typed");
    QTest::addColumn<QByteArray>("sent");
    QTest::addColumn<QString>("cells");
    QTest::addColumn<QString>("place");
    const auto row = [](const char *typed, const char *sent, const char *cells, const char *place) {
        QTest::newRow(qPrintable(QLatin1String(typed) + u' ' + QLatin1String(sent)))
            << QByteArray(typed) << QByteArray(sent) << QString::fromUtf8(cells)
            << QString::fromUtf8(place);
    };
    const char *const asItWas = "Abba,Waterloo,Pop,1974/Beck,Loser,,1994/";
    row("", "Ins", ",,,/Abba,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
    row("", "End", "Beck,Loser,,1994/", "1.2");
    row("{Down}{Down}", "End", asItWas, "3.2");
    row("", "PgDown", asItWas, "2.2");
    row("{Down}{Down}", "PgUp", asItWas, "1.2");
    row("", "Tab", asItWas, "1.3");
    row("{Right}", "Shift+Tab", asItWas, "1.2");
    row("", "Down", asItWas, "2.2");
    row("{Down}", "Up", asItWas, "1.2");
    // In a cell that is being edited, with suggestions open.
    const char *const typed = "B,Waterloo,Pop,1974/Beck,Loser,,1994/";
    row("B", "Down", typed, "2.2");
    row("B", "Tab", typed, "1.3");
    row("B", "PgDown", typed, "2.2");
    row("B", "Ins", ",,,/B,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
    row("{Down}B", "End", "Abba,Waterloo,Pop,1974/", "2.2");
}

void tst_Disk::keysOfTheToolbar()
{
    QFETCH(QByteArray, typed);
    QFETCH(QByteArray, sent);
    showDisk();
    type(typed.constData());
    send(sent.constData());
    QTEST(cells(), "cells");
    QTEST(place(), "place");
    QVERIFY(!popup());
}

void tst_Disk::tabLeavesAtTheEnds()
{
    show<DiskE>();
    QSignalSpy forward(mGrid, &TrackGrid::LeaveForward), back(mGrid, &TrackGrid::LeaveBackward);
    for (const char *place : {"1.3", "1.4", "2.2", "2.3", "2.4"}) {
        QCOMPARE(forward.size(), 0);
        type("{Tab}");
        QCOMPARE(this->place(), QLatin1String(place));
    }
    type("{Tab}");
    QCOMPARE(forward.size(), 1);
    for (const char *place : {"2.3", "2.2", "1.4", "1.3", "1.2"}) {
        QCOMPARE(back.size(), 0);
        type("{Shift+Tab}");
        QCOMPARE(this->place(), QLatin1String(place));
    }
    type("x{Shift+Tab}");
    QCOMPARE(back.size(), 1);
    QCOMPARE(cells(), QStringLiteral("x,Pop,1974/"));
    mGrid->setCurrentColumn(1);
    type("{Shift+Tab}");
    QCOMPARE(back.size(), 2);
}

void tst_Disk::requests_data()
{
    QTest::addColumn<QByteArray>("keys");
    QTest::addColumn<QString>("raised");
    QTest::newRow("save") << QByteArray("x{Ctrl+Return}") << QStringLiteral("1 0 0");
    QTest::newRow("add") << QByteArray("x{Shift+Ins}") << QStringLiteral("0 1 0");
    QTest::newRow("delete") << QByteArray("x{Return}{Shift+End}") << QStringLiteral("0 0 1");
    // While a cell is being edited it selects text, as everywhere.
    QTest::newRow("select") << QByteArray("x{Shift+End}{Return}") << QStringLiteral("0 0 0");
}

void tst_Disk::requests()
{
    QFETCH(QByteArray, keys);
    showDisk();
    QSignalSpy saves(mGrid, &TrackGrid::RequestSave), adds(mGrid, &TrackGrid::RequestAddDisc),
        deletes(mGrid, &TrackGrid::RequestDeleteDisc);
    QApplication::clipboard()->setText(QStringLiteral("not pasted"));
    type(keys.constData());
    const QString raised =
        QStringLiteral("%1 %2 %3").arg(saves.size()).arg(adds.size()).arg(deletes.size());
    QTEST(raised, "raised");
    QVERIFY(cells().startsWith(QStringLiteral("x,Waterloo")));
}

void tst_Disk::focusIsTheGridsWhileItEdits()
{
    showDisk();
    mBefore->setFocus();
    QSignalSpy got(mGrid, &TrackGrid::GotFocus), lost(mGrid, &TrackGrid::LostFocus);
    mGrid->setFocus();
    type("x");
    QVERIFY(edit() && edit()->hasFocus());
    type("{Return}");
    QVERIFY(mGrid->hasFocus());
    QCOMPARE(got.size(), 1);
    // A window of the program's own in front is no other control.
    QWidget box;
    box.show();
    QApplication::setActiveWindow(&box);
    QCOMPARE(lost.size(), 0);
    box.hide();
    QApplication::setActiveWindow(mScreen.get());
    type("y");
    mBehind->setFocus();
    QCOMPARE(lost.size(), 1);
    QCOMPARE(got.size(), 1);
    QCOMPARE(cells(), QStringLiteral("x,Waterloo,Pop,1974/y,Loser,,1994/")); // kept
}

void tst_Disk::yearsAreChecked_data()
{
    QTest::addColumn<QByteArray>("year");
    QTest::addColumn<bool>("taken");
    for (const char *year : {"", "1901", "9999", "1e10", "2020 "})
        QTest::newRow(year) << QByteArray(year) << true;
    for (const char *year : {"1900", "190", "19011", "abcd", "199x", "0x7c"})
        QTest::newRow(year) << QByteArray(year) << false;
}

void tst_Disk::yearsAreChecked()
{
    QFETCH(QByteArray, year);
    QFETCH(bool, taken);
    showDisk();
    mGrid->setCurrentRow(2);
    mGrid->setCurrentColumn(5);
    if (!taken)
        mDesktop->expectBox(QStringLiteral("error [Songcase] Invalid year!"));
    year.append("{Return}");
    type(year == "{Return}" ? "1{Backspace}{Return}" : year.constData());
    year.chop(8);
    mDesktop->verifyAllCame();
    QCOMPARE(place(), taken ? QStringLiteral("3.5") : QStringLiteral("2.5"));
    QCOMPARE(edit() != nullptr, !taken);
    if (!taken) {
        QCOMPARE(edit()->selectedText(), QString::fromLatin1(year));
        type("1980{Return}");
        QCOMPARE(place(), QStringLiteral("3.5"));
        return;
    }
    QCOMPARE(mGrid->model()->index(1, 4).data().toString(), QString::fromLatin1(year).trimmed());
    save();
    QVERIFY(!mGrid->HasError());
}

void tst_Disk::completion()
{
    showDisk();
    type("b");
    QCOMPARE(popup()->count(), 2);
    type("{Return}"); // what was typed, nothing else
    QVERIFY(cells().startsWith(QStringLiteral("b,")));
    type("{Up}be{Down}{Down}{Up}{Return}");
    QVERIFY(cells().startsWith(QStringLiteral("Beck,")));
    QVERIFY(!popup());
    type("{Up}be{Down}{Up}{Return}"); // back to the field
    QVERIFY(cells().startsWith(QStringLiteral("be,")));
    type("{Up}be");
    const auto *item = popup()->item(1);
    QTest::mouseClick(popup()->viewport(), Qt::LeftButton, {},
                      popup()->visualItemRect(item).center());
    QCOMPARE(edit()->text(), QStringLiteral("Belle and Sebastian"));
    QVERIFY(edit()->hasFocus());
    type("{Tab}l");
    QVERIFY(!popup()); // no title of hers
    type("{Esc}{Down}l");
    QCOMPARE(popup()->item(0)->text(), QStringLiteral("Loser"));
    type("{Esc}");
    QVERIFY(!popup());
    show<DiskE>();
    type("s{Down}{Tab}");
    QCOMPARE(cells(), QStringLiteral("SOS,Pop,1974/"));
}

void tst_Disk::genres_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QString>("last");
    QTest::newRow("English") << languageEnglish << QStringLiteral("Other");
    QTest::newRow("Dutch") << languageDutch << QStringLiteral("Overig");
}

void tst_Disk::genres()
{
    QFETCH(int, language);
    QFETCH(QString, last);
    gLanguage = language;
    showDisk();
    mGrid->setCurrentColumn(4);
    type("{Return}{Alt+Down}");
    QCOMPARE(popup()->count(), 27);
    QCOMPARE(popup()->item(26)->text(), last);
    type("{Esc}r");
    QCOMPARE(popup()->count(), 3);
    type("{Down}{Tab}");
    QCOMPARE(cells(), QStringLiteral("Abba,Waterloo,R&B,1974/Beck,Loser,,1994/"));
    type("{Shift+Tab}(my own{Return}");
    QCOMPARE(cells(), QStringLiteral("Abba,Waterloo,(my own,1974/Beck,Loser,,1994/"));
}

void tst_Disk::clipboard()
{
    showDisk();
    type("{Shift+Right}{Shift+Down}{Ctrl+C}");
    QCOMPARE(QApplication::clipboard()->text(), QStringLiteral("Abba\tWaterloo\nBeck\tLoser"));
    type("{Left}{Down}{Ctrl+V}");
    QCOMPARE(cells(), QStringLiteral("Abba,Waterloo,Pop,1974/Beck,Loser,,1994/Abba,Waterloo,,/"
                                     "Beck,Loser,,/"));
    type("{Ctrl+X}");
    QCOMPARE(cells(), QStringLiteral("Abba,Waterloo,Pop,1974/Beck,Loser,,1994/,,,/,,,/"));
    QApplication::clipboard()->setText(QStringLiteral("two\nlines"));
    type("x{Ctrl+V}{Return}"); // into the text of one cell
    QVERIFY(cells().contains(QStringLiteral("/xtwo lines,")));
}

void tst_Disk::undo()
{
    showDisk();
    const QString before = cells();
    type("x{Return}{End}{Ctrl+Z}");
    QCOMPARE(cells(), QStringLiteral("x,Waterloo,Pop,1974/Beck,Loser,,1994/"));
    QCOMPARE(place(), QStringLiteral("2.2"));
    type("{Ctrl+Z}");
    QCOMPARE(cells(), before);
    QCOMPARE(place(), QStringLiteral("1.2"));
    type("{Ctrl+Z}{Ctrl+Shift+Z}{Ctrl+Shift+Z}");
    QCOMPARE(cells(), QStringLiteral("x,Waterloo,Pop,1974/"));
    mGrid->LoadDisc();
    type("{Ctrl+Z}");
    QCOMPARE(cells(), before);
}

void tst_Disk::refusedRows_data()
{
    QTest::addColumn<bool>("album");
    QTest::addColumn<QString>("pasted"); // into a new row behind an empty one
    QTest::addColumn<int>("language");
    QTest::addColumn<QString>("box");
    QTest::addColumn<QString>("place");
    const auto row = [](const char *name, bool album, const char *pasted, int language,
                        const char *box, const char *place) {
        QTest::newRow(name) << album << QString::fromUtf8(pasted) << language
                            << QString::fromUtf8(box) << QString::fromUtf8(place);
    };
    row("title alone", false, "\tx", 1, "Track 3: please fill in the artist!", "4.2");
    row("artist alone", false, "x", 19, "Tracknr 3: vul de titel in!", "4.3");
    row("genre alone", false, "\t\tx", 1, "Track 3: please fill in artist and title!", "4.2");
    row("year alone", true, "\t\t1980", 19, "Tracknr 2: vul de titel in!", "3.2");
    row("no year", true, "x\t\t80", 1, "Track 2: Invalid year!", "3.4");
}

void tst_Disk::refusedRows()
{
    QFETCH(bool, album);
    QFETCH(QString, pasted);
    QFETCH(int, language);
    QFETCH(QString, box);
    gLanguage = language;
    if (album)
        show<DiskE>();
    else
        showDisk();
    mGrid->setCurrentRow(99);
    QApplication::clipboard()->setText(QStringLiteral("\n") + pasted);
    type("{Ctrl+V}");
    mBefore->setFocus();
    mDesktop->expectBox(box);
    save();
    QVERIFY(mGrid->HasError());
    QVERIFY(mGrid->IsChanged());
    QVERIFY(mGrid->hasFocus());
    QTEST(place(), "place");
    QCOMPARE(mCatalogue->count(QStringLiteral("select count(*) from compactdiscs")), 3);
    mGrid->LoadDisc();
    QVERIFY(!mGrid->HasError() && !mGrid->IsChanged());
}

void tst_Disk::keptValuesAreTold()
{
    showDisk();
    mGrid->setCurrentRow(1);
    mGrid->setCurrentColumn(4);
    type("Disco{Return}");
    mGrid->setCurrentColumn(2);
    type("beck{Return}");
    const QString before = cells();
    mDesktop->expectBox(QStringLiteral("information [Songcase] "));
    save();
    QVERIFY(!mGrid->HasError() && !mGrid->IsChanged());
    QCOMPARE(mDesktop->boxes.size(), 1);
    QVERIFY(mDesktop->boxes[0].contains(QStringLiteral("spelling:\r1. Abba - Waterloo\r\r")));
    QVERIFY(mDesktop->boxes[0].endsWith(QStringLiteral("these tracks:\r2. beck - Loser")));
    QCOMPARE(cells(), before);
    QCOMPARE(place(), QStringLiteral("3.2"));
    QCOMPARE(mCatalogue->rows(QStringLiteral("select genre from tracks where id = 1")),
             texts("Pop"));
    save(); // and are not told again
    mGrid->LoadDisc();
    QCOMPARE(cells(), QStringLiteral("Abba,Waterloo,Pop,1974/Beck,Loser,,1994/"));
}

void tst_Disk::savesWhatIsBeingTyped()
{
    show<DiskE>();
    QVERIFY(!mGrid->IsChanged());
    type("{Down}New");
    QVERIFY(mGrid->IsChanged());
    save();
    QVERIFY(!mGrid->IsChanged());
    QCOMPARE(mCatalogue->rows(QStringLiteral("select titel from tracks where id > 3")),
             texts("New"));
    type("{Up}x");
    mGrid->CommitEdit();
    QVERIFY(cells().startsWith(QStringLiteral("x,")));
    type("y");
    mGrid->LoadDisc(); // forgets
    QCOMPARE(cells(), QStringLiteral("Waterloo,Pop,1974/New,,/"));
    mGrid->setDiscNo(2);
    mGrid->LoadDisc();
    QCOMPARE(cells(), QString());
    mGrid->setDiscNo(1);
    mGrid->RemoveDisc();
    QCOMPARE(mCatalogue->count(QStringLiteral("select count(*) from compactdiscs where "
                                              "cdtitels_id = 2")),
             0);
    QVERIFY(!mGrid->IsChanged());
}

// The disk is full when the screen commits: nothing of the save counts, and the next one makes up.
void tst_Disk::aRollbackUndoesTheSave()
{
    showDisk();
    mGrid->setCurrentRow(3);
    type("Cher{Tab}Believe{Return}");
    {
        ADODB::Transaction transaction(*gConnection);
        mGrid->SaveDisc();
        QVERIFY(!mGrid->IsChanged());
    }
    gConnection->RollbackTrans();
    QVERIFY(mGrid->IsChanged());
    save();
    QVERIFY(!mGrid->IsChanged());
    QCOMPARE(mCatalogue->rows(QStringLiteral("select titel from tracks where id > 3")),
             texts("Believe"));
}

void tst_Disk::positions()
{
    Disk *grid = showDisk();
    grid->setCurrentRow(2);
    grid->setCurrentColumn(5);
    QCOMPARE(place(), QStringLiteral("2.5"));
    grid->setCurrentRow(99);
    grid->setCurrentColumn(99);
    QCOMPARE(place(), QStringLiteral("3.5"));
    grid->setCurrentRow(0);
    grid->setCurrentColumn(-1);
    QCOMPARE(place(), QStringLiteral("1.1"));
    const QPoint title = grid->visualRect(grid->model()->index(1, 2)).center();
    QTest::mouseClick(grid->viewport(), Qt::LeftButton, {}, title);
    QCOMPARE(place(), QStringLiteral("2.3"));
    QTest::mouseDClick(grid->viewport(), Qt::LeftButton, {}, title);
    type("!{Return}");
    QVERIFY(cells().contains(QStringLiteral("Loser!")));
}

void tst_Disk::widthsFollow()
{
    showDisk();
    const auto total = [this] { return mGrid->horizontalHeader()->length(); };
    QCOMPARE(total(), mGrid->viewport()->width());
    mScreen->resize(1400, 400);
    QTRY_COMPARE(total(), mGrid->viewport()->width());
    QVERIFY(mGrid->columnWidth(2) > mGrid->columnWidth(1));
    mScreen->resize(200, 200);
    QTRY_VERIFY(mGrid->viewport()->width() < 300);
    QVERIFY(mGrid->columnWidth(2) > 20);
}

QTEST_MAIN(tst_Disk)
#include "tst_Disk.moc"
