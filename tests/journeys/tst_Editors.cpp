// Label: journey
#include "controls/list/DBListViewCTL.h"
#include "platform/ado/connection.h"
#include "support/editing.h"
#include "support/journey.h"
#include "support/testcatalogue.h"

#include <QApplication>
#include <QDir>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QTabWidget>
#include <QTimer>

/// A person enters and changes discs in the whole program, with the keyboard alone.
class tst_Editors : public Journey
{
    Q_OBJECT

private:
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = {})
    {
        keyboard::press(key, modifiers);
    }
    void newCompilation(const QString &title)
    {
        QTest::keyClick(&mProgram->frame(), Qt::Key_F2);
        keyboard::fill({title, u"Pop"_s, u"1999"_s});
        QVERIFY2(active()->findChild<TrackGrid *>()->hasFocus(), "the tracks come behind the year");
    }

    void newAlbum(const QString &artist, const QString &title)
    {
        QTest::keyClick(&mProgram->frame(), Qt::Key_F3);
        keyboard::fill({artist, title, QString(), u"1999"_s});
    }

    void closeWindow() { press(Qt::Key_F4, Qt::ControlModifier); }

    CdEditor *active() const
    {
        auto *area = mProgram->frame().findChild<QMdiArea *>();
        QMdiSubWindow *window = area->activeSubWindow();
        return window ? qobject_cast<CdEditor *>(window->widget()) : nullptr;
    }

    QTabBar *tabs() const { return active()->findChild<QTabBar *>(u"DiscsTab"_s); }

    // All that the catalogue has.
    QStringList stored()
    {
        const QString all = gConnection->housekeeping(
            "select group_concat(line, char(10)) from (select d.Titel || ' ' "
            "|| DiskNo || '/' || TrackNo || ' ' || "
            "Naam || ': ' || t.Titel as line from CompactDiscs c join "
            "CDTitels d on d.ID = c.CDTitels_ID join Tracks t "
            "on t.ID = c.Track_ID join Artiesten a on a.ID = t.Artiest_ID "
            "order by d.ID, DiskNo, TrackNo)");
        return all.split(u'\n', Qt::SkipEmptyParts);
    }

    // As after a kill: nothing is asked, nothing is cleaned up.
    void startAgain()
    {
        active()->findChild<QTimer *>(u"RecoveryTimer"_s)->setInterval(0);
        QTRY_COMPARE(QDir(mDesktop->folder + u"/Unsaved"_s).entryList(QDir::Files).size(), 1);
        mProgram.reset();
        mProgram = std::make_unique<Program>(*mDesktop);
        QVERIFY(mProgram->start());
        mProgram->frame().activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(&mProgram->frame()));
    }
    bool copyIsThere() const { return QFileInfo::exists(mDesktop->folder + u"/Unsaved"_s); }

private slots:
    void aNewCompilationOfTwoDiscs_data() { languages(); }

    void aNewCompilationOfTwoDiscs()
    {
        QFETCH(int, language);
        start(language);
        newCompilation(u"Hits '99"_s);
        keyboard::fill(
            texts("Anna", "One", "Pop", "1985", "Bob", "Two", "", "", "Anna", "Three", "", ""));
        press(Qt::Key_Insert, Qt::ShiftModifier);
        QCOMPARE(tabs()->count(), 2);
        keyboard::fill(texts("Cleo", "Four", "", "", "Anna", "One", "", "", "Bob", "Five", "", ""));
        press(Qt::Key_S, Qt::ControlModifier);
        const QStringList saved =
            texts("Hits '99 1/1 Anna: One", "Hits '99 1/2 Bob: Two", "Hits '99 1/3 Anna: Three",
                  "Hits '99 2/1 Cleo: Four", "Hits '99 2/2 Anna: One", "Hits '99 2/3 Bob: Five");
        QCOMPARE(stored(), saved);
        closeWindow();
        QVERIFY(!mProgram->screen("frmCDRoot"));
        QCOMPARE(column("ColList", 1), texts("Hits '99"));

        // And changed: the second track is another song from now on.
        QTest::keyClick(mProgram->control<DBListViewCTL>("frmCDList", "ColList"), Qt::Key_Return);
        QCOMPARE(active()->findChild<QLineEdit *>(u"txtTitel"_s)->text(), u"Hits '99"_s);
        press(Qt::Key_PageUp);
        press(Qt::Key_Down);
        keyboard::fill(texts("Dora", "Six"));
        press(Qt::Key_Return, Qt::ControlModifier);
        QCOMPARE(stored().value(1), u"Hits '99 1/2 Dora: Six"_s);
        QCOMPARE(stored().size(), 6);
        closeWindow();
    }

    void closingIsRefused()
    {
        start(languageEnglish);
        newCompilation(u"T"_s);
        keyboard::fill(texts("Anna", "One"));
        mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbYes);
        closeWindow();
        QTest::keyClick(mProgram->control<DBListViewCTL>("frmCDList", "ColList"), Qt::Key_Return);
        press(Qt::Key_Delete);
        mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbYes);
        mDesktop->expectBox(GetMessage("MsgCompNoTitle"));
        mDesktop->expectBox(GetMessage("MsgWindowCannotBeClosed"));
        closeWindow();
        QVERIFY(active());
        press(Qt::Key_Escape); // gives up without a question
        QVERIFY(!mProgram->screen("frmCDRoot"));
        QCOMPARE(column("ColList", 1), texts("T"));
    }

    void saveAllOverThreeEditors()
    {
        start(languageEnglish);
        newCompilation(u"First"_s);
        keyboard::fill(texts("Anna", "One"));
        newAlbum(u"Bob"_s, u"Second"_s);
        keyboard::fill(texts("Two"));
        newCompilation(u"Third"_s);
        keyboard::fill(texts("Cleo"));
        keyboard::type("Three"); // still being typed
        press(Qt::Key_S, Qt::ControlModifier);
        QCOMPARE(stored(),
                 texts("First 1/1 Anna: One", "Second 1/1 Bob: Two", "Third 1/1 Cleo: Three"));
        const auto forms = Form::openForms();
        for (Form *form : forms) { // nothing is left to ask about
            if (qobject_cast<CdEditor *>(form))
                QVERIFY(form->parentWidget()->close());
        }
        QCOMPARE(column("ColList", 1), texts("First", "Third"));
        QCOMPARE(column("SngList", 2), texts("Second"));
    }

    void aMinimizedEditorComesUpAgain()
    {
        start(languageEnglish);
        newCompilation(u"T"_s);
        keyboard::fill(texts("Anna", "One"));
        press(Qt::Key_S, Qt::ControlModifier);
        auto *area = mProgram->frame().findChild<QMdiArea *>();
        QMdiSubWindow *window = area->activeSubWindow();
        window->showMinimized();
        QTest::keyClick(mProgram->control<DBListViewCTL>("frmCDList", "ColList"), Qt::Key_Return);
        QCOMPARE(area->subWindowList().size(), 2);
        QVERIFY(!window->isMinimized() && window->widget()->isVisible());
        window->showMaximized();
        press(Qt::Key_S, Qt::ControlModifier);
        QVERIFY2(window->isMaximized(), "a save leaves the window as it is");
    }

    void theProgramEndsThroughTheQuestion()
    {
        start(languageEnglish);
        newCompilation(QString());
        keyboard::fill(texts("Anna", "One"));
        mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbYes);
        mDesktop->expectBox(GetMessage("MsgCompNoTitle"));
        mDesktop->expectBox(GetMessage("MsgWindowCannotBeClosed"));
        QVERIFY(!mProgram->end());
        QVERIFY(mProgram->screen("frmCDRoot")->isVisible());
        mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbNo);
    }

    void whatWasNotSavedIsOffered_data()
    {
        const DataRows<QString, bool, QStringList> row("meanwhile", "again", "stored");
        const auto saved = texts("Hits 1/1 Anna: One", "Hits 1/2 Bob: Two");
        row("nothing", "", true, saved);
        row("it is not wanted", "", false, texts("Hits 1/1 Anna: One"));
        row("its record has changed", "update CDTitels set Genre='Jazz'", true,
            texts("Hits 1/1 Anna: One") + saved);
        row("its record has gone", "delete from CompactDiscs; delete from CDTitels", true, saved);
    }

    void whatWasNotSavedIsOffered()
    {
        QFETCH(QString, meanwhile);
        QFETCH(bool, again);
        start(languageEnglish);
        newCompilation(u"Hits"_s);
        keyboard::fill({u"Anna"_s, u"One"_s, QString(), QString()});
        mProgram->choose("mnuSave");
        QCOMPARE(stored(), texts("Hits 1/1 Anna: One"));
        QVERIFY(!copyIsThere());
        keyboard::fill({u"Bob"_s});
        keyboard::type(u"Two"_s); // in a cell that is still open
        mDesktop->expectBox(u"\"Hits\" was not saved. Open it again?"_s, again ? vbYes : vbNo);
        if (!meanwhile.isEmpty())
            OtherProgram(mDesktop->folder + u"/Compact4.orv"_s).run(meanwhile.toUtf8());
        startAgain();
        QCOMPARE(active() != nullptr, again);
        if (again) {
            QCOMPARE(active()->findChild<TrackGrid *>()->model()->rowCount(), 3);
            mProgram->choose("mnuSave");
        }
        QTEST(stored(), "stored");
        QVERIFY(!copyIsThere());
    }

    void aNewOneIsOfferedToo()
    {
        start(languageDutch);
        newAlbum(u"Anna"_s, QString());
        keyboard::fill({u"One"_s});
        mDesktop->expectBox(u"zonder titel"_s, vbYes);
        startAgain();
        QCOMPARE(active()->findChild<QLineEdit *>(u"txtArtiest"_s)->text(), u"Anna"_s);
        active()->findChild<QLineEdit *>(u"txtTitel"_s)->setText(u"Found"_s);
        mProgram->choose("mnuSave");
        QCOMPARE(stored(), texts("Found 1/1 Anna: One"));
    }
};

QTEST_MAIN(tst_Editors)
#include "tst_Editors.moc"
