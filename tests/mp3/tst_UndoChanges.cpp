// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "discdata/changedfiles.h"
#include "mp3/UndoChanges.h"
#include "support/screentest.h"
#include "tags/filechanges.h"

#include <QDir>
#include <QPlainTextEdit>
#include <QPushButton>

/// Commands that changed files are taken back on the screen, several at a time.
class tst_UndoChanges : public ScreenTest
{
    Q_OBJECT

private:
    QString path(const QString &name) const { return mCatalogue->path(name); }

    // One command that gives a file other names, one behind the other.
    void change(const QStringList &names)
    {
        FileChanges changes(changedFiles(), {mDesktop->now(), names.last(), u"/music"_s});
        for (qsizetype next = 1; next < names.size(); ++next)
            changes.move(path(names[next - 1]), path(names[next]));
    }

    void show()
    {
        mScreen = new UndoChanges;
        mScreen->Show();
    }
    template <typename Control> Control *control(const QString &name) const
    {
        return mScreen->findChild<Control *>(name);
    }
    DBListViewCTL *list() const { return control<DBListViewCTL>(u"ChangeList"_s); }
    QStringList lines() const
    {
        QStringList all;
        for (int index = 1; index <= list()->ListItems().Count(); ++index) {
            const ListItem item = list()->ListItems().Item(index);
            all.append(item.SubItems(1) + u'|' + item.SubItems(2) + u'|' + item.SubItems(4) + u'|' +
                       item.SubItems(5));
        }
        return all;
    }
    void press(const QString &button) { control<QPushButton>(button)->click(); }

    QPointer<UndoChanges> mScreen;

private slots:
    void init()
    {
        ScreenTest::init();
        writeFile(path(u"a.mp3"_s), "a");
        writeFile(path(u"x.mp3"_s), "x");
        gTagsChanged = false;
    }

    // The one that came last goes first, whatever the order of the choice. The collection that was
    // stored meanwhile finds its file.
    void severalAtATime()
    {
        change({u"a.mp3"_s, u"b.mp3"_s});
        mDesktop->time = mDesktop->time.addDays(1);
        change({u"b.mp3"_s, u"c.mp3"_s});
        mCatalogue->exec(u"insert into MP3Files values (1,1,'c.mp3',1),(2,2,'x.mp3',1);"
                         "insert into MP3Collections values (1,'"_s +
                         QFileInfo(path(u"c.mp3"_s)).path() + u"','All')"_s);
        show();
        QCOMPARE(lines(),
                 texts("23 Nov 2026, 12:00|c.mp3|b.mp3|", "22 Nov 2026, 12:00|b.mp3|a.mp3|"));
        list()->selectAll();
        mDesktop->expectBox(u"yes-no [Songcase] Do you want to take back what was changed? "
                            "Number of files: 2"_s,
                            vbYes);
        mDesktop->expectBox(u"as they were before: 2"_s);
        press(u"cmdUndo"_s);
        QCOMPARE(readFile(path(u"a.mp3"_s)), "a");
        QCOMPARE(mCatalogue->rows("select FileName from MP3Files order by ID"),
                 texts("a.mp3", "x.mp3"));
        QVERIFY(gTagsChanged);
        QCOMPARE(lines(), texts("23 Nov 2026, 12:00|Undo: b.mp3|b.mp3|",
                                "23 Nov 2026, 12:00|Undo: c.mp3|c.mp3|",
                                "23 Nov 2026, 12:00|c.mp3|b.mp3|taken back",
                                "22 Nov 2026, 12:00|b.mp3|a.mp3|taken back"));
    }

    void whatIsLeftIsTold()
    {
        change({u"a.mp3"_s, u"b.mp3"_s});
        writeFile(path(u"a.mp3"_s), "another");
        show();
        mDesktop->expectBox(u"Do you want"_s, vbYes);
        mDesktop->expectBox(u"left as they are: 1"_s);
        press(u"cmdUndo"_s);
        QVERIFY(control<QPlainTextEdit>(u"txtLeft"_s)->toPlainText().contains(u".mp3: "_s));
        QCOMPARE(readFile(path(u"a.mp3"_s)), "another");
        QCOMPARE(readFile(path(u"b.mp3"_s)), "a");
    }

    // The reason of a failed move names its file by itself.
    void whatIsLeftIsNamedOnce()
    {
        QVERIFY(QDir().mkpath(path(u"sub"_s)));
        writeFile(path(u"sub/a.mp3"_s), "a");
        change({u"sub/a.mp3"_s, u"b.mp3"_s});
        QVERIFY(QDir().rmdir(path(u"sub"_s)));
        show();
        mDesktop->expectBox(u"Do you want"_s, vbYes);
        mDesktop->expectBox(u"left as they are: 1"_s);
        press(u"cmdUndo"_s);
        const QString left = control<QPlainTextEdit>(u"txtLeft"_s)->toPlainText();
        QVERIFY(left.startsWith(path(u"b.mp3"_s) + u": "_s));
        QCOMPARE(left.count(u"b.mp3"_s), 1);
    }

    // As long as the texts of Dutch; the folder's column has room for all.
    void linesAreShownWhole()
    {
        change({u"a.mp3"_s, u"b.mp3"_s, u"c.mp3"_s, u"Ongedaan maken: Bestanden hernoemen"_s});
        show();
        QCOMPARE(list()->ListItems().Item(1).SubItems(4), u"a.mp3 and 2 more"_s);
        const QAbstractItemView *view = list();
        for (int column = 1; column <= 5; ++column)
            QVERIFY(list()->columnWidth(column) >= view->sizeHintForColumn(column));
    }

    void whatWasDoneIsToldInTheLanguageOfNow()
    {
        change({u"a.mp3"_s, u"xRedoOf xRenameFiles"_s});
        show();
        QCOMPARE(list()->ListItems().Item(1).SubItems(2), u"Redo: Rename files"_s);
        gLanguage = languageDutch;
        mScreen->Unload();
        show();
        QCOMPARE(list()->ListItems().Item(1).SubItems(2), u"Opnieuw: Bestanden hernoemen"_s);
    }

    void noneIsChosenOrWanted()
    {
        show();
        QVERIFY(!control<QPushButton>(u"cmdUndo"_s)->isEnabled());
        change({u"a.mp3"_s, u"b.mp3"_s});
        mScreen->Unload();
        show();
        mDesktop->expectBox(u"Do you want"_s, vbNo);
        press(u"cmdUndo"_s);
        QCOMPARE(readFile(path(u"b.mp3"_s)), "a");
        press(u"cmdClose"_s);
        QVERIFY(mScreen->isUnloaded());
    }
};

QTEST_MAIN(tst_UndoChanges)
#include "tst_UndoChanges.moc"
