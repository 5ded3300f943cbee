// Label: screen
#include "controls/tracks/Disk.h"
#include "controls/tracks/DiskE.h"
#include "controls/tracks/celledit.h"
#include "platform/ado/connection.h"
#include "support/screentest.h"

#include <QApplication>
#include <QClipboard>
#include <QListWidget>
#include <QSignalSpy>
#include <QVBoxLayout>

namespace
{

/// Takes each typed key and posts it again, as the bridge to a screen reader does.
class ScreenReader : public QObject
{
public:
    ScreenReader() { qApp->installEventFilter(this); }

protected:
    bool eventFilter(QObject *to, QEvent *event) override
    {
        const auto type = event->type();
        if ((type != QEvent::KeyPress && type != QEvent::KeyRelease) || !event->spontaneous())
            return false;
        const auto *key = static_cast<QKeyEvent *>(event);
        QCoreApplication::postEvent(to,
                                    new QKeyEvent(type, key->key(), key->modifiers(), key->text()));
        return true;
    }
};

} // namespace

/// Both track grids on a screen with a field before them, as a person uses them.
class tst_Disk : public ScreenTest
{
    Q_OBJECT

private:
    template <typename Grid> void show()
    {
        mScreen = std::make_unique<QWidget>();
        auto *layout = new QVBoxLayout(mScreen.get());
        auto *grid = new Grid;
        mGrid = grid;
        layout->addWidget(mBefore = new QLineEdit);
        layout->addWidget(grid);
        grid->setLanguage(gLanguage);
        grid->setConnection(gConnection.get());
        grid->setCdId(std::is_same_v<Grid, Disk> ? 1 : 2);
        grid->setDiscNo(1);
        grid->LoadDisc();
        mScreen->resize(700, 400);
        mScreen->show();
        QApplication::setActiveWindow(mScreen.get());
        grid->setFocus();
    }

    void showDisk() { show<Disk>(); }

    void save()
    {
        ADODB::Transaction transaction(*gConnection);
        mGrid->SaveDisc();
        if (mGrid->HasError())
            transaction.RollbackTrans();
        else
            transaction.CommitTrans();
    }

    // Plain text; "{Key}" and "{Mod+Key}" are typed keys.
    void type(const char *keys)
    {
        static const QRegularExpression key(u"\\{([^}]+)\\}|([^{])"_s);
        for (const auto &match : key.globalMatch(QString::fromUtf8(keys))) {
            QWidget *to = QApplication::focusWidget();
            if (match.captured(1).isEmpty()) {
                QTest::sendKeyEvent(QTest::Click, to, Qt::Key_unknown, match.captured(2), {});
            } else {
                const QKeyCombination typed = QKeySequence(match.captured(1))[0];
                QTest::keyClick(to, typed.key(), typed.keyboardModifiers());
            }
            QCoreApplication::sendPostedEvents(nullptr, QEvent::KeyPress);
            QCoreApplication::sendPostedEvents(nullptr, QEvent::KeyRelease);
        }
    }

    QString cells() const
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

    QString place() const
    {
        return QString::number(mGrid->CurrentRow()) + u'.' +
               QString::number(mGrid->CurrentColumn());
    }

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

    const QString mAsItWas = u"Abba,Waterloo,Pop,1974/Beck,Loser,,1994/"_s;
    std::unique_ptr<QWidget> mScreen;
    QPointer<TrackGrid> mGrid;
    QLineEdit *mBefore = nullptr;

private slots:
    void init()
    {
        ScreenTest::init();
        mCatalogue->exec(
            "insert into artiesten values (1,'Abba'),(2,'Beck'),(3,'Belle and Sebastian');"
            "insert into tracks values (1,1,'Waterloo','Pop',1974),(2,1,'SOS',NULL,NULL),"
            "(3,2,'Loser',NULL,1994);"
            "insert into cdtitels values (1,'Hits',NULL,'V',NULL,NULL),(2,'Gold',1,'E',NULL,NULL);"
            "insert into compactdiscs values (1,1,1,1,1,NULL),(2,1,1,2,3,NULL),(3,2,1,1,1,NULL)");
    }

    void cleanup()
    {
        mScreen.reset();
        ScreenTest::cleanup();
    }

    void typing_data()
    {
        // keys: from the first artist on
        const DataRows<QByteArray, QString, QString> row("keys", "cells", "place");
        row("Cher{Return}", "Cher,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
        row("x{Esc}{Esc}", mAsItWas, "1.2");
        row("{Tab}x{Tab}y{Shift+Tab}z{Return}", "Abba,z,y,1974/Beck,Loser,,1994/", "2.3");
        row("{Delete}", ",Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
        row("{Down}{Down}Cher{Tab}Believe{Tab}{Tab}1998{Tab}Dido",
            mAsItWas + u"Cher,Believe,,1998/", "4.2");
        row("x{Home}y{End}z{Return}", "yxz,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
        row("x{Insert}", ",,,/x,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
        row("{End}", "Beck,Loser,,1994/", "1.2");
        row("b{Down}{Down}{Return}", "Belle and Sebastian,Waterloo,Pop,1974/Beck,Loser,,1994/",
            "2.2");
    }

    void typing()
    {
        QFETCH(QByteArray, keys);
        showDisk();
        type(keys.constData());
        QTEST(cells(), "cells");
        QTEST(place(), "place");
        QVERIFY(mScreen->isVisible());
    }

    void typingWithAScreenReader_data() { typing_data(); }
    void typingWithAScreenReader()
    {
        const ScreenReader reader;
        typing();
    }

    // A button of the screen sends keys, here while a cell is being edited, suggestions open.
    void keysOfTheToolbar_data()
    {
        const DataRows<QByteArray, QByteArray, QString, QString> row("typed", "sent", "cells",
                                                                     "place");
        row("Down", "B", "Down", "B,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
        row("Tab", "B", "Tab", "B,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.3");
        row("Ins", "B", "Ins", ",,,/B,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
        row("End", "{Down}B", "End", "Abba,Waterloo,Pop,1974/", "2.2");
    }

    void keysOfTheToolbar()
    {
        QFETCH(QByteArray, typed);
        QFETCH(QByteArray, sent);
        showDisk();
        type(typed.constData());
        mDesktop->sendKeys(QLatin1String(sent));
        QTEST(cells(), "cells");
        QTEST(place(), "place");
        QVERIFY(!popup());
    }

    void tabLeavesAtTheEnds()
    {
        show<DiskE>();
        QSignalSpy forward(mGrid, &TrackGrid::LeaveForward), back(mGrid, &TrackGrid::LeaveBackward);
        type("{Tab}{Tab}{Tab}{Tab}{Tab}");
        QVERIFY(place() == u"2.4" && forward.isEmpty());
        type("{Tab}");
        QVERIFY(place() == u"2.4" && forward.size() == 1);
        type("{Shift+Tab}{Shift+Tab}{Shift+Tab}");
        QCOMPARE(place(), u"1.4"_s);
        type("{Shift+Tab}{Shift+Tab}");
        QVERIFY(place() == u"1.2" && back.isEmpty());
        type("x{Shift+Tab}");
        QCOMPARE(back.size(), 1);
        QCOMPARE(cells(), u"x,Pop,1974/"_s);
    }

    void focusIsTheGridsWhileItEdits()
    {
        showDisk();
        mBefore->setFocus();
        QSignalSpy got(mGrid, &TrackGrid::GotFocus), lost(mGrid, &TrackGrid::LostFocus);
        mGrid->setFocus();
        type("x");
        QVERIFY(edit() && edit()->hasFocus());
        type("{Return}");
        QVERIFY(mGrid->hasFocus());
        QWidget box; // of the program's own: no other control
        box.show();
        QApplication::setActiveWindow(&box);
        QCOMPARE(lost.size(), 0);
        box.hide();
        QApplication::setActiveWindow(mScreen.get());
        type("y");
        mBefore->setFocus();
        QCOMPARE(lost.size(), 1);
        QCOMPARE(got.size(), 1);
        QCOMPARE(cells(), u"x,Waterloo,Pop,1974/y,Loser,,1994/"_s); // kept
    }

    void yearsAreChecked()
    {
        showDisk();
        mGrid->setCurrentRow(2);
        for (const char *year : {"1900", "abcd", "0x7c"}) {
            mGrid->setCurrentColumn(5);
            mDesktop->expectBox(u"error [Songcase] Invalid year!"_s);
            type(year);
            type("{Return}");
            mDesktop->verifyAllCame();
            QCOMPARE(place(), u"2.5"_s);
            QCOMPARE(edit()->selectedText(), QLatin1String(year));
        }
        type("1e10{Return}");
        QCOMPARE(place(), u"3.5"_s);
        save();
        QVERIFY(!mGrid->HasError());
    }

    void completion()
    {
        showDisk();
        type("b");
        QCOMPARE(popup()->count(), 2);
        type("{Return}"); // what was typed, nothing else
        QVERIFY(cells().startsWith(u"b,"));
        type("{Up}be{Down}{Down}{Up}{Return}");
        QVERIFY(cells().startsWith(u"Beck,"));
        type("{Up}be{Down}{Up}{Return}"); // back to the field
        QVERIFY(cells().startsWith(u"be,"));
        type("{Up}be");
        QTest::mouseClick(popup()->viewport(), Qt::LeftButton, {},
                          popup()->visualItemRect(popup()->item(1)).center());
        QCOMPARE(edit()->text(), u"Belle and Sebastian"_s);
        type("{Tab}l");
        QVERIFY(!popup()); // no title of hers
        type("{Esc}{Down}l{Esc}");
        QVERIFY(!popup());
        show<DiskE>();
        type("s{Down}{Tab}");
        QCOMPARE(cells(), u"SOS,Pop,1974/"_s);
    }

    void genres()
    {
        gLanguage = languageDutch;
        showDisk();
        mGrid->setCurrentColumn(4);
        type("{Return}{Alt+Down}");
        QVERIFY(popup());
        type("{Esc}r{Down}{Tab}");
        QCOMPARE(cells(), u"Abba,Waterloo,R&B,1974/Beck,Loser,,1994/"_s);
        type("{Shift+Tab}(my own{Return}");
        QCOMPARE(cells(), u"Abba,Waterloo,(my own,1974/Beck,Loser,,1994/"_s);
    }

    void clipboardAndUndo()
    {
        showDisk();
        type("{Shift+Right}{Shift+Down}{Ctrl+C}");
        QCOMPARE(QApplication::clipboard()->text(), u"Abba\tWaterloo\nBeck\tLoser"_s);
        type("{Left}{Down}{Ctrl+V}{Ctrl+X}");
        QCOMPARE(cells(), u"Abba,Waterloo,Pop,1974/Beck,Loser,,1994/,,,/,,,/"_s);
        type("{Ctrl+Z}{Ctrl+Z}");
        QCOMPARE(cells(), mAsItWas);
        QCOMPARE(place(), u"3.2"_s);
        mGrid->LoadDisc();
        type("{Ctrl+Shift+Z}");
        QCOMPARE(cells(), mAsItWas);
        QApplication::clipboard()->setText(u"two\nlines"_s);
        type("x{Ctrl+V}{Return}"); // into the text of one cell
        QVERIFY(cells().startsWith(u"xtwo lines,"));
    }

    // A text of another program may be longer than one that is typed.
    void longTexts()
    {
        const QString stored = QString(300, u'x') + u' ', typed(260, u'y');
        mCatalogue->exec(u"update tracks set titel = '"_s + stored + u"' where id = 1"_s);
        showDisk();
        mGrid->setCurrentColumn(3);
        type("{Return}{Return}"); // opened and left
        QVERIFY(cells().startsWith(u"Abba,"_s + stored + u",Pop"_s));
        QVERIFY(!mGrid->IsChanged());
        const auto paste = [&](const char *keys) {
            QApplication::clipboard()->setText(typed);
            mDesktop->expectBox(GetMessage("xTextCut"));
            type(keys);
            QCoreApplication::processEvents();
            mDesktop->verifyAllCame();
            type("{Return}");
            QCOMPARE(cells().count(u'y'), 255);
            mGrid->LoadDisc();
        };
        mGrid->setCurrentRow(2);
        paste("{Ctrl+V}");                // into cells
        paste("{Down}x{Ctrl+A}{Ctrl+V}"); // into the text of one
    }

    void refusedRows_data()
    {
        // pasted: into a new row behind an empty one
        const DataRows<bool, QString, QString, QString> row("album", "pasted", "box", "place");
        row("title alone", false, "\tx", "Track 3: please fill in the artist!", "4.2");
        row("artist alone", false, "x", "Track 3: please fill in the title!", "4.3");
        row("genre alone", false, "\t\tx", "Track 3: please fill in artist and title!", "4.2");
        row("year alone", true, "\t\t1980", "Track 2: please fill in the title!", "3.2");
        row("no year", true, "x\t\t80", "Track 2: Invalid year!", "3.4");
    }

    void refusedRows()
    {
        QFETCH(bool, album);
        QFETCH(QString, pasted);
        QFETCH(QString, box);
        album ? show<DiskE>() : show<Disk>();
        mGrid->setCurrentRow(99);
        QApplication::clipboard()->setText(u'\n' + pasted);
        type("{Ctrl+V}");
        mBefore->setFocus();
        mDesktop->expectBox(box);
        save();
        QVERIFY(mGrid->HasError() && mGrid->IsChanged() && mGrid->hasFocus());
        QTEST(place(), "place");
        QCOMPARE(mCatalogue->count("select count(*) from compactdiscs"), 3);
    }

    void keptValuesAreTold()
    {
        showDisk();
        type("{Tab}{Tab}Disco{Down}");
        mGrid->setCurrentColumn(2);
        type("beck{Return}");
        const QString before = cells();
        mDesktop->expectBox(u"information [Songcase] "_s);
        save();
        QVERIFY(!mGrid->HasError() && !mGrid->IsChanged());
        QVERIFY(mDesktop->boxes[0].contains(u"spelling:\r1. Abba - Waterloo\r\r"_s));
        QVERIFY(mDesktop->boxes[0].endsWith(u"these tracks:\r2. beck - Loser"_s));
        QCOMPARE(cells(), before);
        QCOMPARE(place(), u"3.2"_s);
        QCOMPARE(mCatalogue->rows("select genre from tracks where id = 1"), texts("Pop"));
        save(); // and are not told again
        mGrid->LoadDisc();
        QCOMPARE(cells(), mAsItWas);
    }

    // The disk is full when the screen commits: nothing of the save counts, and the next one makes
    // up.
    void aRollbackUndoesTheSave()
    {
        showDisk();
        type("{Down}{Down}Cher{Tab}Believe{Return}");
        {
            ADODB::Transaction transaction(*gConnection);
            mGrid->SaveDisc();
            QVERIFY(!mGrid->IsChanged());
        }
        gConnection->RollbackTrans();
        QVERIFY(mGrid->IsChanged());
        save();
        QVERIFY(!mGrid->IsChanged());
        QCOMPARE(mCatalogue->rows("select titel from tracks where id > 3"), texts("Believe"));
        QCOMPARE(mCatalogue->count("select count(*) from compactdiscs where cdtitels_id = 1"), 3);
    }
};

QTEST_MAIN(tst_Disk)
#include "tst_Disk.moc"
