// Label: journey
#include "catalogue/cataloguefile.h"
#include "controls/DBListViewCTL.h"
#include "platform/ado/connection.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/editing.h"
#include "support/program.h"

#include <QApplication>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QTabWidget>
#include <QTest>

/// A person enters and changes discs in the whole program, with the keyboard alone.
class tst_Editors : public QObject
{
    Q_OBJECT

private slots:
    void cleanup();
    void aNewCompilationOfTwoDiscs_data() { languages(); }
    void aNewCompilationOfTwoDiscs();
    void anEmptyTitleKeepsTheDisc_data() { languages(); }
    void anEmptyTitleKeepsTheDisc();
    void theMiddleDiscOfThree_data() { languages(); }
    void theMiddleDiscOfThree();
    void theArtistOfAnAlbum_data() { languages(); }
    void theArtistOfAnAlbum();
    void closingWithYesNoAndRefused_data() { languages(); }
    void closingWithYesNoAndRefused();
    void saveAllOverThreeEditors_data() { languages(); }
    void saveAllOverThreeEditors();
    void aRecordDeletedInTheBrowserIsSavedAgain();
    void aMinimizedEditorComesUpAgain();
    void theFrameMakesRoom();
    void theProgramEndsThroughTheQuestion();

private:
    static void languages();
    void start(int language);
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = {})
    {
        keyboard::press(key, modifiers);
    }
    void newCompilation(const QString &title);
    void newAlbum(const QString &artist, const QString &title);
    void tracks(const QStringList &fields) { keyboard::fill(fields); }
    void closeWindow() { press(Qt::Key_F4, Qt::ControlModifier); }
    CdEditor *active() const;
    QTabBar *tabs() const { return active()->findChild<QTabBar *>(QStringLiteral("DiscsTab")); }
    QStringList stored(); // all that the catalogue has
    QStringList column(const char *list, int n) const;

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Program> mProgram;
};

void tst_Editors::languages()
{
    QTest::addColumn<int>("language");
    QTest::newRow("English") << languageEnglish;
    QTest::newRow("Dutch") << languageDutch;
}

void tst_Editors::start(int language)
{
    mDesktop = std::make_unique<ScriptedDesktop>();
    cataloguefile::create(mDesktop->folder + QStringLiteral("/Compact4.orv"));
    storeLanguage(language);
    mProgram = std::make_unique<Program>(*mDesktop);
    QVERIFY(mProgram->start());
    if (Form *help = mProgram->screen("frmHelp"))
        help->Unload();
    mProgram->frame().activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(&mProgram->frame()));
    mProgram->choose("mnuUpdate");
}

void tst_Editors::cleanup()
{
    if (mProgram)
        QVERIFY(mProgram->end());
    mProgram.reset();
    if (mDesktop)
        mDesktop->verifyAllCame();
    mDesktop.reset();
}

CdEditor *tst_Editors::active() const
{
    auto *area = mProgram->frame().findChild<QMdiArea *>();
    QMdiSubWindow *window = area->activeSubWindow();
    return window ? qobject_cast<CdEditor *>(window->widget()) : nullptr;
}

void tst_Editors::newCompilation(const QString &title)
{
    QTest::keyClick(&mProgram->frame(), Qt::Key_F2);
    tracks({title, QStringLiteral("Pop"), QStringLiteral("1999")});
    QVERIFY2(active()->findChild<TrackGrid *>()->hasFocus(), "the tracks come behind the year");
}

void tst_Editors::newAlbum(const QString &artist, const QString &title)
{
    QTest::keyClick(&mProgram->frame(), Qt::Key_F3);
    tracks({artist, title, QString(), QStringLiteral("1999")});
}

QStringList tst_Editors::stored()
{
    const QString all =
        gConnection->housekeeping("select group_concat(line, char(10)) from (select d.Titel || ' ' "
                                  "|| DiskNo || '/' || TrackNo || ' ' || "
                                  "Naam || ': ' || t.Titel as line from CompactDiscs c join "
                                  "CDTitels d on d.ID = c.CDTitels_ID join Tracks t "
                                  "on t.ID = c.Track_ID join Artiesten a on a.ID = t.Artiest_ID "
                                  "order by d.ID, DiskNo, TrackNo)");
    return all.split(QLatin1Char('\n'), Qt::SkipEmptyParts);
}

QStringList tst_Editors::column(const char *name, int n) const
{
    auto *list = mProgram->control<DBListViewCTL>("frmCDList", name);
    QStringList found;
    for (int i = 1; i <= list->ListItems().Count(); ++i)
        found.append(list->ListItems().Item(i).SubItems(n));
    return found;
}

void tst_Editors::aNewCompilationOfTwoDiscs()
{
    QFETCH(int, language);
    start(language);
    newCompilation(QStringLiteral("Hits '99"));
    tracks(texts("Anna", "One", "Pop", "1985", "Bob", "Two", "", "", "Anna", "Three", "", ""));
    press(Qt::Key_Insert, Qt::ShiftModifier);
    QCOMPARE(tabs()->count(), 2);
    tracks(texts("Cleo", "Four", "", "", "Anna", "One", "", "", "Bob", "Five", "", ""));
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
    QCOMPARE(active()->findChild<QLineEdit *>(QStringLiteral("txtTitel"))->text(),
             QStringLiteral("Hits '99"));
    press(Qt::Key_PageUp);
    press(Qt::Key_Down);
    tracks(texts("Dora", "Six"));
    press(Qt::Key_Return, Qt::ControlModifier);
    QCOMPARE(stored().value(1), QStringLiteral("Hits '99 1/2 Dora: Six"));
    QCOMPARE(stored().size(), 6);
    closeWindow();
}

void tst_Editors::anEmptyTitleKeepsTheDisc()
{
    QFETCH(int, language);
    start(language);
    newCompilation(QStringLiteral("T"));
    tracks(texts("Anna", "One"));
    press(Qt::Key_Insert, Qt::ShiftModifier);
    tracks(texts("Bob", "Two"));
    auto *title = active()->findChild<QLineEdit *>(QStringLiteral("txtTitel"));
    title->setFocus();
    press(Qt::Key_Delete);
    mDesktop->expectBox(GetMessage("MsgCompNoTitle"));
    mDesktop->expectBox(GetMessage("MsgDiscNav"));
    press(Qt::Key_1, Qt::AltModifier);
    QCOMPARE(tabs()->currentIndex(), 1);
    QCOMPARE(stored().size(), 1);
    keyboard::type(QStringLiteral("New"));
    press(Qt::Key_1, Qt::AltModifier);
    QCOMPARE(tabs()->currentIndex(), 0);
    QCOMPARE(stored(), texts("New 1/1 Anna: One", "New 2/1 Bob: Two"));
    closeWindow();
}

void tst_Editors::theMiddleDiscOfThree()
{
    QFETCH(int, language);
    start(language);
    newCompilation(QStringLiteral("T"));
    for (const char *track : {"One", "Two", "Three"}) {
        if (QLatin1String(track) != QLatin1String("One"))
            press(Qt::Key_Insert, Qt::ShiftModifier);
        tracks(texts("Anna", track));
    }
    press(Qt::Key_2, Qt::AltModifier);
    press(Qt::Key_End, Qt::ShiftModifier);
    QCOMPARE(tabs()->count(), 2);
    QCOMPARE(tabs()->currentIndex(), 1);
    QCOMPARE(stored(), texts("T 1/1 Anna: One", "T 2/1 Anna: Three"));
    closeWindow();
}

void tst_Editors::theArtistOfAnAlbum()
{
    QFETCH(int, language);
    start(language);
    newCompilation(QStringLiteral("Hits"));
    tracks(texts("Anna", "One", "", "", "Bob", "Two"));
    press(Qt::Key_S, Qt::ControlModifier);
    closeWindow();
    newAlbum(QStringLiteral("Anna"), QStringLiteral("Album"));
    tracks(texts("One", "", "", "Two"));
    press(Qt::Key_S, Qt::ControlModifier);
    for (const char *artist : {"Cleo", "Bob"}) {
        active()->findChild<QLineEdit *>(QStringLiteral("txtArtiest"))->setFocus();
        press(Qt::Key_A, Qt::ControlModifier);
        keyboard::type(QLatin1String(artist));
        press(Qt::Key_S, Qt::ControlModifier);
        const QString by = QLatin1String(artist);
        QCOMPARE(
            stored(),
            QStringList({QStringLiteral("Hits 1/1 Anna: One"), QStringLiteral("Hits 1/2 Bob: Two"),
                         QStringLiteral("Album 1/1 ") + by + QStringLiteral(": One"),
                         QStringLiteral("Album 1/2 ") + by + QStringLiteral(": Two")}));
        QCOMPARE(column("SngList", 1), QStringList(by));
    }
    QCOMPARE(gConnection->housekeeping(
                 "select group_concat(Naam) from (select Naam from Artiesten order by Naam)"),
             QStringLiteral("Anna,Bob"));
    closeWindow();
}

void tst_Editors::closingWithYesNoAndRefused()
{
    QFETCH(int, language);
    start(language);
    newCompilation(QStringLiteral("T"));
    tracks(texts("Anna", "One"));
    mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbYes);
    closeWindow();
    QCOMPARE(stored().size(), 1);

    QTest::keyClick(mProgram->control<DBListViewCTL>("frmCDList", "ColList"), Qt::Key_Return);
    keyboard::type(QStringLiteral("Never kept"));
    mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbNo);
    closeWindow();
    QCOMPARE(column("ColList", 1), texts("T"));

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

void tst_Editors::saveAllOverThreeEditors()
{
    QFETCH(int, language);
    start(language);
    newCompilation(QStringLiteral("First"));
    tracks(texts("Anna", "One"));
    newAlbum(QStringLiteral("Bob"), QStringLiteral("Second"));
    tracks(texts("Two"));
    newCompilation(QStringLiteral("Third"));
    tracks(texts("Cleo"));
    keyboard::type(QStringLiteral("Three")); // still being typed
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

void tst_Editors::aRecordDeletedInTheBrowserIsSavedAgain()
{
    start(languageEnglish);
    newCompilation(QStringLiteral("T"));
    tracks(texts("Anna", "One", "", "", "Bob", "Two"));
    press(Qt::Key_S, Qt::ControlModifier);
    mDesktop->expectBox(GetMessage("QuestDelete"), vbYes);
    QTest::keyClick(mProgram->control<DBListViewCTL>("frmCDList", "ColList"), Qt::Key_Delete);
    QVERIFY(stored().isEmpty());
    mProgram->choose("tbSave");
    QCOMPARE(stored(), texts("T 1/1 Anna: One", "T 1/2 Bob: Two"));
    QCOMPARE(column("ColList", 1), texts("T"));
}

void tst_Editors::aMinimizedEditorComesUpAgain()
{
    start(languageEnglish);
    newCompilation(QStringLiteral("T"));
    tracks(texts("Anna", "One"));
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

void tst_Editors::theFrameMakesRoom()
{
    start(languageEnglish);
    MainScreen &frame = mProgram->frame();
    frame.resize(600, 400);
    newCompilation(QStringLiteral("T"));
    QCOMPARE(frame.QMainWindow::size(), QSize(740 * 14 / 10, 490 * 12 / 10));
    QCOMPARE(active()->parentWidget()->pos(), QPoint(qRound(740 * 1.4 * 0.2), 0));
    press(Qt::Key_Escape);
    press(Qt::Key_Backtab);
    press(Qt::Key_Escape);
}

void tst_Editors::theProgramEndsThroughTheQuestion()
{
    start(languageEnglish);
    newCompilation(QString());
    tracks(texts("Anna", "One"));
    mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbYes);
    mDesktop->expectBox(GetMessage("MsgCompNoTitle"));
    mDesktop->expectBox(GetMessage("MsgWindowCannotBeClosed"));
    QVERIFY(!mProgram->end());
    QVERIFY(mProgram->screen("frmCDRoot")->isVisible());
    mDesktop->expectBox(GetMessage("QuestSaveChanges"), vbNo);
}

QTEST_MAIN(tst_Editors)
#include "tst_Editors.moc"
