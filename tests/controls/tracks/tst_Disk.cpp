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
#include <QTextDocumentFragment>
#include <QToolTip>
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

/// Both track grids on a screen with a field before and one behind, as a person uses them.
class tst_Disk : public ScreenTest
{
    Q_OBJECT

private:
    template <typename Grid> Grid *show()
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

    Disk *showDisk() { return show<Disk>(); }

    void save()
    {
        ADODB::Transaction transaction(*gConnection);
        mGrid->SaveDisc();
        if (mGrid->HasError())
            transaction.RollbackTrans();
        else
            transaction.CommitTrans();
    }

    static void handlePostedKeys()
    {
        QCoreApplication::sendPostedEvents(nullptr, QEvent::KeyPress);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::KeyRelease);
    }

    // Plain text; "{Key}" and "{Mod+Key}" are typed keys.
    void type(const char *keys)
    {
        static const QRegularExpression parts(u"\\{([^}]+)\\}|([^{]+)"_s);
        auto it = parts.globalMatch(QString::fromUtf8(keys));
        while (it.hasNext()) {
            const auto match = it.next();
            if (match.captured(1).isEmpty()) {
                for (const QChar c : match.captured(2)) {
                    QTest::sendKeyEvent(QTest::Click, QApplication::focusWidget(), Qt::Key_unknown,
                                        QString(c), Qt::NoModifier);
                    handlePostedKeys();
                }
                continue;
            }
            const QKeyCombination key = QKeySequence(match.captured(1))[0];
            QTest::keyClick(QApplication::focusWidget(), key.key(), key.keyboardModifiers());
            handlePostedKeys();
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

    std::unique_ptr<QWidget> mScreen;
    QPointer<TrackGrid> mGrid;
    QLineEdit *mBefore = nullptr, *mBehind = nullptr;

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
        const char *const asItWas = "Abba,Waterloo,Pop,1974/Beck,Loser,,1994/";
        row("Cher{Return}", "Cher,Waterloo,Pop,1974/Beck,Loser,,1994/", "2.2");
        row("x{Esc}{Esc}", asItWas, "1.2");
        row("{Left}x{Tab}", "x,Waterloo,Pop,1974/Beck,Loser,,1994/", "1.3");
        row("{Tab}x{Tab}y{Shift+Tab}z{Return}", "Abba,z,y,1974/Beck,Loser,,1994/", "2.3");
        row("{Delete}", ",Waterloo,Pop,1974/Beck,Loser,,1994/", "1.2");
        row("{Down}{Down}Cher{Tab}Believe{Tab}{Tab}1998{Tab}Dido",
            "Abba,Waterloo,Pop,1974/Beck,Loser,,1994/Cher,Believe,,1998/", "4.2");
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
        const char *const kept = "B,Waterloo,Pop,1974/Beck,Loser,,1994/";
        row("Down", "B", "Down", kept, "2.2");
        row("Tab", "B", "Tab", kept, "1.3");
        row("PgDown", "B", "PgDown", kept, "2.2");
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
        for (const char *place : {"1.3", "1.4", "2.2", "2.3", "2.4", "2.4"}) {
            QCOMPARE(forward.size(), 0);
            type("{Tab}");
            QCOMPARE(this->place(), QLatin1String(place));
        }
        QCOMPARE(forward.size(), 1);
        for (const char *place : {"2.3", "2.2", "1.4", "1.3", "1.2"}) {
            type("{Shift+Tab}");
            QCOMPARE(this->place(), QLatin1String(place));
        }
        QCOMPARE(back.size(), 0);
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
        type("{Esc}{Down}l");
        QCOMPARE(popup()->item(0)->text(), u"Loser"_s);
        type("{Esc}");
        QVERIFY(!popup());
        show<DiskE>();
        type("s{Down}{Tab}");
        QCOMPARE(cells(), u"SOS,Pop,1974/"_s);
    }

    void genres()
    {
        gLanguage = languageDutch;
        showDisk();
        QCOMPARE(mGrid->model()->headerData(0, Qt::Horizontal).toString(), u"Tracknr"_s);
        mGrid->setCurrentColumn(4);
        type("{Return}{Alt+Down}");
        QCOMPARE(popup()->count(), 27);
        QCOMPARE(popup()->item(26)->text(), u"Overig"_s);
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
        QCOMPARE(cells(), u"Abba,Waterloo,Pop,1974/Beck,Loser,,1994/"_s);
        QCOMPARE(place(), u"3.2"_s);
        mGrid->LoadDisc();
        type("{Ctrl+Shift+Z}");
        QCOMPARE(cells(), u"Abba,Waterloo,Pop,1974/Beck,Loser,,1994/"_s);
        QApplication::clipboard()->setText(u"two\nlines"_s);
        type("x{Ctrl+V}{Return}"); // into the text of one cell
        QVERIFY(cells().startsWith(u"xtwo lines,"));
        type("\"x\"\"y\"{Return}{Up}{Ctrl+C}{Right}{Ctrl+V}");
        QVERIFY(cells().contains(u"\"x\"\"y\",\"x\"\"y\","_s));
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

    void aTextThatDoesNotFitShowsAsAToolTip()
    {
        mCatalogue->exec("update tracks set titel = 'Rock & Roll \"and\" more' where id = 1");
        showDisk();
        const QModelIndex cell = mGrid->model()->index(0, 2);
        for (const int width : {300, 20}) {
            mGrid->setColumnWidth(2, width);
            const QPoint at = mGrid->visualRect(cell).center();
            QHelpEvent event(QEvent::ToolTip, at, mGrid->viewport()->mapToGlobal(at));
            QApplication::sendEvent(mGrid->viewport(), &event);
            const QString tip = QToolTip::text(); // shown as it is unless it looks like rich text
            const bool rich = Qt::mightBeRichText(tip);
            QCOMPARE(rich ? QTextDocumentFragment::fromHtml(tip).toPlainText() : tip,
                     width == 20 ? u"Rock & Roll \"and\" more"_s : QString());
        }
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
        if (album)
            show<DiskE>();
        else
            showDisk();
        mGrid->setCurrentRow(99);
        QApplication::clipboard()->setText(u'\n' + pasted);
        type("{Ctrl+V}");
        mBefore->setFocus();
        mDesktop->expectBox(box);
        save();
        QVERIFY(mGrid->HasError() && mGrid->IsChanged() && mGrid->hasFocus());
        QTEST(place(), "place");
        QCOMPARE(mCatalogue->count("select count(*) from compactdiscs"), 3);
        mGrid->LoadDisc();
        QVERIFY(!mGrid->HasError() && !mGrid->IsChanged());
    }

    void keptValuesAreTold()
    {
        showDisk();
        mGrid->setCurrentRow(1);
        mGrid->setCurrentColumn(4);
        type("Disco{Return}");
        mGrid->setCurrentColumn(2);
        type("beck{Return}");
        const QString before = cells();
        mDesktop->expectBox(u"information [Songcase] "_s);
        save();
        QVERIFY(!mGrid->HasError() && !mGrid->IsChanged());
        QCOMPARE(mDesktop->boxes.size(), 1);
        QVERIFY(mDesktop->boxes[0].contains(u"spelling:\r1. Abba - Waterloo\r\r"_s));
        QVERIFY(mDesktop->boxes[0].endsWith(u"these tracks:\r2. beck - Loser"_s));
        QCOMPARE(cells(), before);
        QCOMPARE(place(), u"3.2"_s);
        QCOMPARE(mCatalogue->rows("select genre from tracks where id = 1"), texts("Pop"));
        save(); // and are not told again
        mGrid->LoadDisc();
        QCOMPARE(cells(), u"Abba,Waterloo,Pop,1974/Beck,Loser,,1994/"_s);
    }

    // The disk is full when the screen commits: nothing of the save counts, and the next one makes
    // up.
    void aRollbackUndoesTheSave()
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
        QCOMPARE(mCatalogue->rows("select titel from tracks where id > 3"), texts("Believe"));
        QCOMPARE(mCatalogue->count("select count(*) from compactdiscs where cdtitels_id = 1"), 3);
    }
};

QTEST_MAIN(tst_Disk)
#include "tst_Disk.moc"
