// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "mp3/frmCDRootMP3.h"
#include "platform/work/longwork.h"
#include "services/clsRegistry.h"
#include "services/messages.h"
#include "support/countingbrowser.h"
#include "support/madesound.h"
#include "support/screentest.h"

#include <QDir>
#include <QKeySequence>
#include <QLineEdit>
#include <QPushButton>
#include <QTimer>
#include <atomic>
#include <fcntl.h>
#include <mutex>
#include <sys/stat.h>

namespace
{

std::mutex gMedium; // while it is held nothing tells what is on the medium
std::atomic<bool> gIsDead;

} // namespace

// Before that of the system.
extern "C" int stat(const char *path, struct stat *about) noexcept
{
    if (gIsDead)
        const std::lock_guard wait(gMedium);
    return ::fstatat(AT_FDCWD, path, about, 0);
}

/// The editor of a collection on a real catalogue and real files.
class tst_frmCDRootMP3 : public ScreenTest
{
    Q_OBJECT

private:
    QString folder() const { return mCatalogue->path("music"); }

    void put(const QString &name)
    {
        const QString full = folder() + u'/' + name;
        QDir().mkpath(QFileInfo(full).absolutePath());
        writeFile(full, id3Tag({{"TIT2", u"Title of "_s + name}, {"TPE1", u"Artist"_s}}));
    }

    // A stored collection of files, which are put on the disk as well.
    void store(const QStringList &names)
    {
        mCatalogue->exec(u"insert into MP3Collections values (7,'%1','Mine')"_s.arg(folder()));
        for (int number = 1; const QString &name : names) {
            put(name);
            mCatalogue->exec(
                u"insert into MP3Files values (%1,%1,'%2',7)"_s.arg(QString::number(number), name));
            ++number;
        }
    }

    void show(const QString &mode)
    {
        mEditor = new frmCDRootMP3;
        mEditor->Mode = mode;
        mEditor->CollectionId = 7;
        mEditor->Show();
        mEditor->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(mEditor));
    }

    void showNew()
    {
        QDir().mkpath(folder());
        show(u"I"_s);
        field("txtFolder")->setText(folder());
        field("txtTitel")->setText(u"Mine"_s);
    }

    template <typename Control> Control *control(const char *name) const
    {
        return mEditor->findChild<Control *>(QLatin1String(name));
    }
    QLineEdit *field(const char *name) const { return control<QLineEdit>(name); }
    void press(const char *button) { control<QPushButton>(button)->click(); }
    DBListViewCTL *list() const { return mEditor->findChild<DBListViewCTL *>(); }
    ListItem item(int index) const { return list()->ListItems().Item(index); }

    QString files() const
    {
        QStringList all;
        for (int i = 1; i <= list()->ListItems().Count(); ++i)
            all.append(item(i).Text() + item(i).SubItems(1));
        return all.join(u' ');
    }

    QString selected() const
    {
        QString all;
        for (int i = 1; i <= list()->ListItems().Count(); ++i)
            all += item(i).Selected() ? QString::number(i) : QString();
        return all;
    }

    // What can be used, of those that are not always so.
    QString usable() const
    {
        QStringList names;
        for (const char *name : {"TheMP3Collection", "cmdAdd", "cmdScan", "cmdImportAsCD",
                                 "cmdDelete", "cmdRefreshList", "cmdRename", "cmdOK"}) {
            if (control<QWidget>(name)->isEnabled())
                names.append(QLatin1String(name).sliced(3));
        }
        return names.join(u' ');
    }

    QPoint at(int index) const
    {
        return list()->visualRect(list()->model()->index(index - 1, 1)).center();
    }

    void drag(int from, int to)
    {
        QTest::mousePress(list()->viewport(), Qt::RightButton, {}, at(from));
        QTest::mouseMove(list()->viewport(), at(to));
        QTest::mouseRelease(list()->viewport(), Qt::RightButton, {}, at(to));
    }

    QPointer<frmCDRootMP3> mEditor;

private slots:
    void init()
    {
        ScreenTest::init();
        mEditor.clear();
    }

    void whatCanBeUsed()
    {
        showNew();
        QCOMPARE(usable(), u"Add Scan"_s);
        field("txtTitel")->clear();
        QCOMPARE(usable(), QString());
        mEditor->Unload();
        store({u"a.mp3"_s, u"b.mp3"_s});
        show(u"U"_s);
        QCOMPARE(usable(), u"MP3Collection Add Scan ImportAsCD Delete RefreshList Rename OK"_s);
        mDesktop->expectBox(u"error [Songcase] Name/title is not optional!"_s);
        field("txtTitel")->clear();
        QCOMPARE(usable(), u"MP3Collection"_s);
        QTest::keyClick(field("txtTitel"), Qt::Key_Z, Qt::ControlModifier);
        QCOMPARE(field("txtTitel")->text(), u"Mine"_s);
        QFile::remove(folder() + u"/a.mp3"_s);
        mDesktop->expectBox(u"warning [Songcase] One or more files"_s);
        mDesktop->duringBox = [this] { QVERIFY(mEditor->updatesEnabled()); };
        press("cmdRefreshList");
        QCOMPARE(usable(), u"MP3Collection ImportAsCD Delete RefreshList Rename"_s);
        QVERIFY(item(1).Bold() && item(1).ForeColor() == QColor(255, 0, 0) && !item(2).Bold());
        QCOMPARE(item(1).SubItems(4) + item(2).SubItems(4), u"?Title of b.mp3"_s);
        QVERIFY(QDir().rename(folder(), folder() + u'2')); // the folder goes as well
        press("cmdRefreshList");
        QVERIFY(item(2).Bold() && !list()->isEnabled());
    }

    void buttonsBelowTheListAreEven()
    {
        gLanguage = languageDutch;
        showNew();
        int widest = 0, needed = 0, narrowest = INT_MAX;
        for (const QPushButton *button : mEditor->findChildren<QPushButton *>()) {
            if (button->parentWidget() != mEditor)
                continue; // beside the folder
            widest = std::max(widest, button->width());
            narrowest = std::min(narrowest, button->width());
            needed = std::max(needed, button->sizeHint().width());
        }
        QVERIFY(widest - narrowest <= 1);
        QVERIFY(narrowest >= needed);
    }

    void aMediumThatGivesNoAnswer()
    {
        store({u"a.mp3"_s});
        show(u"U"_s);
        std::unique_lock dead(gMedium);
        gIsDead = true;
        QTimer cancel;
        connect(&cancel, &QTimer::timeout, &LongWork::cancelAll);
        cancel.start(20);
        field("txtTitel")->setText(u"Other"_s);
        QCOMPARE(usable(), u"Delete RefreshList"_s);
        field("txtFolder")->setText(u"/other"_s);
        QCOMPARE(field("txtFolder")->text(), folder());
        cancel.stop();
        gIsDead = false;
        dead.unlock();
        press("cmdRefreshList");
        QCOMPARE(field("txtTitel")->text() + files(), u"Other1a.mp3"_s);
        QVERIFY(control<QPushButton>("cmdOK")->isEnabled());
    }

    void scanning()
    {
        for (const char *name : {"10.mp3", "9.mp3", "x/y.MP3"})
            put(QLatin1String(name));
        showNew();
        press("cmdScan");
        QCOMPARE(files(), u"19.mp3 210.mp3 3x/y.MP3"_s);
        QCOMPARE(selected(), u"123"_s);
        list()->setColumnWidth(1, 321);
        put(u"11.mp3"_s);
        mDesktop->expectBox(u"in the list already: 3. Would"_s, vbYes);
        press("cmdScan");
        QCOMPARE(files(), u"19.mp3 210.mp3 3x/y.MP3 411.mp3"_s);
        QCOMPARE(selected(), u"4"_s);
        QCOMPARE(list()->columnWidth(1), 321);
        mDesktop->expectBox(u"in the list already: 4. Would"_s, vbNo);
        press("cmdScan");
        QCOMPARE(list()->ListItems().Count(), 8);
    }

    void scanningWhatAnOlderCatalogueHas()
    {
        store({u"x/y.mp3"_s});
        mCatalogue->exec(u"update MP3Files set FileName = 'x\\y.mp3'"_s);
        show(u"U"_s);
        mDesktop->expectBox(u"in the list already: 1"_s, vbYes);
        press("cmdScan");
        QCOMPARE(files(), u"1x\\y.mp3"_s);
    }

    void adding()
    {
        for (const char *name : {"a.mp3", "b.mp3", "c.mp3", "d.txt"})
            put(QLatin1String(name));
        showNew();
        mDesktop->expectFiles(
            {folder() + u"/a.mp3"_s, folder() + u"/b.mp3"_s, folder() + u"/c.mp3"_s});
        press("cmdAdd");
        QCOMPARE(files(), u"1b.mp3 2c.mp3 3a.mp3"_s);
        mDesktop->expectFiles({folder() + u"/d.txt"_s});
        mDesktop->expectBox(u"error [Songcase] Only mp3 files can be chosen!"_s);
        mDesktop->expectFiles({mCatalogue->path("other.mp3")});
        mDesktop->expectBox(u"error [Songcase] Invalid directory chosen"_s);
        QTest::keyClick(list(), Qt::Key_Insert);
        mDesktop->expectFiles({mCatalogue->path("other.txt"), mCatalogue->path("other.mp3")});
        mDesktop->expectBox(u"error [Songcase] Invalid directory chosen"_s); // and that is all
        press("cmdAdd");
        mDesktop->expectFiles({}); // cancelled
        press("cmdAdd");
        QCOMPARE(files(), u"1b.mp3 2c.mp3 3a.mp3"_s);
    }

    void dragging_data()
    {
        const DataRows<int, int, QString> row("from", "to", "files");
        row("down", 1, 3, "1b 2c 3a 4d");
        row("up", 4, 2, "1a 2d 3b 4c");
        row("to the end", 2, 4, "1a 2c 3d 4b");
        row("onto itself", 2, 2, "1a 2b 3c 4d");
    }

    void dragging()
    {
        QFETCH(int, from);
        QFETCH(int, to);
        store({u"a"_s, u"b"_s, u"c"_s, u"d"_s});
        show(u"U"_s);
        const int step = from < to ? 1 : -1;
        drag(from, to);
        QTEST(files(), "files");
        QCOMPARE(selected(), QString::number(to));
        QCOMPARE(mEditor->HasRecordSetChanged(), from != to);
        for (int row = to; row != from; row -= step) // back again
            QTest::keyClick(list(), step < 0 ? Qt::Key_Down : Qt::Key_Up, Qt::AltModifier);
        QCOMPARE(files(), u"1a 2b 3c 4d"_s);
        QVERIFY(!mEditor->HasRecordSetChanged());
    }

    void deleting()
    {
        store({u"a"_s, u"b"_s, u"a"_s, u"c"_s});
        show(u"U"_s);
        list()->setSelectedItem(item(3));
        QTest::keyClick(list(), Qt::Key_Delete);
        QCOMPARE(files(), u"1b 2a 3c"_s); // the first of that name
        QTest::keyClick(list(), Qt::Key_A, Qt::ControlModifier);
        QCOMPARE(selected(), u"123"_s);
        QTest::keyClick(list(), Qt::Key_Delete);
        QCOMPARE(usable(), u"Add Scan"_s);
    }

    void withNoRowSelected_data()
    {
        const DataRows<int, int, QString> row("button", "modifiers", "place");
        row("right press below", int(Qt::RightButton), 0, "below");
        row("click below", int(Qt::LeftButton), 0, "below");
        row("taken out again", int(Qt::LeftButton), int(Qt::ControlModifier), "row");
        row("drag given up", int(Qt::RightButton), 0, "row");
    }

    // Nothing is done then, and nothing said.
    void withNoRowSelected()
    {
        QFETCH(int, button);
        QFETCH(int, modifiers);
        QFETCH(QString, place);
        store({u"a.mp3"_s, u"b.mp3"_s});
        show(u"U"_s);
        QTest::mouseClick(list()->viewport(), Qt::LeftButton, {}, at(2));
        if (modifiers == 0)
            QTest::keyClick(list(), Qt::Key_A, Qt::ControlModifier);
        const QPoint to = place == u"row" ? at(2) : QPoint(9, list()->viewport()->height() - 9);
        const Qt::KeyboardModifiers with(modifiers);
        QTest::mousePress(list()->viewport(), Qt::MouseButton(button), with, to);
        if (place == u"row" && modifiers == 0)
            QTest::keyClick(list(), Qt::Key_Escape);
        QTest::mouseRelease(list()->viewport(), Qt::MouseButton(button), with, to);
        QCOMPARE(selected(), QString());
        QVERIFY(!control<QPushButton>("cmdUpdateID3")->isEnabled());
        QVERIFY(control<QPushButton>("cmdTagWizard")->isEnabled());
        press("cmdRename");
        emit list()->DblClick();
        QTest::keyClick(list(), Qt::Key_Up, Qt::AltModifier);
        QCOMPARE(selected(), u"2"_s); // by the key, not by a move
        list()->selectionModel()->clearSelection();
        QTest::keyClick(list(), Qt::Key_Delete);
        QCOMPARE(files(), u"1a.mp3 2b.mp3"_s);
        QVERIFY(!mEditor->HasRecordSetChanged());
    }

    void anotherFolder()
    {
        store({u"a"_s});
        show(u"U"_s);
        mDesktop->expectBox(u"yes-no [Songcase] If you change the folder"_s, vbNo);
        field("txtFolder")->setText(u"/none"_s);
        QCOMPARE(field("txtFolder")->text(), folder());
        QDir().mkpath(mCatalogue->path("other"));
        mDesktop->expectFile(mCatalogue->path("other"));
        mDesktop->expectBox(u"yes-no [Songcase] If you change the folder"_s, vbYes);
        press("cmdBrowse");
        QCOMPARE(field("txtFolder")->text(), mCatalogue->path("other"));
        QCOMPARE(files(), QString());
        mDesktop->expectFile({});
        press("cmdBrowse");
        clsRegistry settings;
        QCOMPARE(settings.GetValue(settingsReadKey, u"LastDir"_s), QVariant(QString()));
    }

    void saving()
    {
        put(u"it's.mp3"_s);
        CountingBrowser browser;
        showNew();
        press("cmdScan");
        press("cmdOK");
        QVERIFY(!mEditor || mEditor->isUnloaded());
        QCOMPARE(mCatalogue->rows("select ID, Album from MP3Collections"), texts("1|Mine"));
        QCOMPARE(mCatalogue->rows("select * from MP3Files"), texts("1|1|it's.mp3|1"));
        QCOMPARE(browser.refreshed, 1);
    }

    void savingChanges()
    {
        store({u"a"_s, u"b"_s});
        CountingBrowser browser;
        show(u"U"_s);
        mCatalogue->exec(
            "create trigger no before insert on MP3Files begin select raise(abort,'no'); end");
        QTest::keyClick(list(), Qt::Key_Down, Qt::AltModifier);
        mDesktop->expectBox(u"error [Songcase] -2147217873: "_s);
        press("cmdOK");
        QCOMPARE(mCatalogue->rows("select * from MP3Files"), texts("1|1|a|7", "2|2|b|7"));
        mCatalogue->exec("drop trigger no");
        press("cmdOK");
        QCOMPARE(mCatalogue->rows("select * from MP3Files"), texts("1|1|b|7", "2|2|a|7"));
        QCOMPARE(browser.refreshed, 0);
        QVERIFY(mEditor->isUnloaded());
    }

    // A collection that somebody deletes meanwhile, whose id another one gets.
    void savingWhatHasGone()
    {
        store({u"a"_s, u"b"_s});
        show(u"U"_s);
        QTest::keyClick(list(), Qt::Key_Down, Qt::AltModifier);
        mCatalogue->exec("delete from MP3Files; update MP3Collections set Album = 'Other'");
        mDesktop->expectBox(u"error [Songcase] This collection has been deleted"_s);
        press("cmdOK");
        QCOMPARE(mCatalogue->rows("select * from MP3Files"), QStringList());
        press("cmdOK");
        QCOMPARE(mCatalogue->rows("select ID, Album from MP3Collections"),
                 texts("7|Other", "8|Mine"));
        QCOMPARE(mCatalogue->rows("select * from MP3Files"), texts("1|1|b|8", "2|2|a|8"));
    }

    // A second press while the first one still handles events is passed over.
    void pressesInBetween()
    {
        store({u"a"_s, u"b"_s, u"c"_s});
        show(u"U"_s);
        QMetaObject::invokeMethod(
            mEditor, [this] { press("cmdDelete"); }, Qt::QueuedConnection);
        QMetaObject::invokeMethod(
            mEditor, [this] { QVERIFY(!mEditor->Unload()); }, Qt::QueuedConnection);
        press("cmdDelete");
        QCOMPARE(files(), u"1b 2c"_s);
    }

    // By design others share one. The menu bar is seen with the editor.
    void thePreviewHasAKeyOfItsOwn()
    {
        const auto keyOf = [](const QString &text) { return QKeySequence::mnemonic(text); };
        const auto keyFor = [&](const char *text, int language) {
            return keyOf(GetMessage(QLatin1String(text), language));
        };
        for (const int language : {languageEnglish, languageDutch}) {
            QList<QKeySequence> others = {keyOf(u"Inf&o"_s), keyOf(u"&Scan"_s)};
            for (const char *key :
                 {"File", "mnuLiedkist", "mnuInstellingen", "mnuTaal", "AddFile", "BrowseFolder",
                  "CancelMP3collection", "MP3CollectionGereed", "UpdateID3Tag", "TagWizard",
                  "ImportAsCD", "DeleteMP3FileFromCollection", "RefreshList", "Rename"})
                others.append(keyFor(key, language));
            const QKeySequence own = keyFor("xPreviewNames", language);
            QVERIFY(!own.isEmpty() && !others.contains(own));
        }
    }
};

QTEST_MAIN(tst_frmCDRootMP3)
#include "tst_frmCDRootMP3.moc"
