// Label: journey
#include "collection/recordtree.h"
#include "controls/list/DBListViewCTL.h"
#include "platform/ado/recordset.h"
#include "reports/reportview.h"
#include "services/browser.h"
#include "support/journey.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAccessible>
#include <QLineEdit>
#include <QTabWidget>
#include <QToolBar>
#include <private/qguiapplication_p.h>
#include <qpa/qplatformaccessibility.h>
#include <qpa/qplatformintegration.h>

namespace
{

// As if a screen reader had come or gone; there is no public way without one.
void setListening(bool listening)
{
    QGuiApplicationPrivate::platformIntegration()->accessibility()->setActive(listening);
}

// "focus <text>", "expanded <text>", in the order in which a tool that listens is told.
QStringList gTold;

void listen(QAccessibleEvent *event)
{
    QAccessibleInterface *told = event->accessibleInterface();
    const QString name = told ? told->text(QAccessible::Name) : u"nothing"_s;
    if (event->type() == QAccessible::Focus)
        gTold.append(u"focus "_s + name);
    if (event->type() == QAccessible::StateChanged) {
        const auto changed = static_cast<QAccessibleStateChangeEvent *>(event)->changedStates();
        if (changed.expanded)
            gTold.append((told->state().expanded ? u"expanded "_s : u"collapsed "_s) + name);
    }
}

} // namespace

/// What a screen reader is told.
class tst_Assistive : public Journey
{
    Q_OBJECT

private slots:
    void init()
    {
        start(languageEnglish);
        gConnection->Execute(u"insert into Artiesten values (1,'Zed')"_s);
        gConnection->Execute(u"insert into Artiesten values (2,'Ann')"_s);
        gConnection->Execute(u"insert into Tracks values (1,2,'One',null,null)"_s);
        gConnection->Execute(u"insert into CDTitels values (1,'Zebra',1,'E',null,null)"_s);
        gConnection->Execute(u"insert into CDTitels values (2,'Aap',2,'E',null,null)"_s);
        gConnection->Execute(u"insert into CompactDiscs values (1,1,1,1,1,null)"_s);
        gConnection->Execute(u"insert into CompactDiscs values (2,2,1,1,1,null)"_s);
        refreshBrowser();
        static_cast<void>(QApplication::processEvents());
        setListening(true);
        QAccessible::installUpdateHandler(listen);
        gTold.clear();
    }

    void cleanup()
    {
        QAccessible::installUpdateHandler(nullptr);
        setListening(false);
        Journey::cleanup();
    }

    void rowsAreTold()
    {
        showPage(1);
        QTRY_COMPARE(gTold.value(gTold.size() - 1), u"focus Ann, Aap"_s);
        auto *list = mProgram->control<DBListViewCTL>("frmCDList", "SngList");
        QTest::keyClick(list, Qt::Key_Down);
        QCOMPARE(gTold.last(), u"focus Zed, Zebra"_s);
        QTest::mouseClick(list->viewport(), Qt::LeftButton, {},
                          list->visualRect(list->model()->index(0, 2)).center());
        QCOMPARE(gTold.last(), u"focus Ann, Aap"_s);
    }

    void openedNodesAreTold()
    {
        showPage(2);
        auto *tree = mProgram->control<RecordTree>("frmCDList", "Platenbak");
        QTRY_COMPARE(gTold.value(gTold.size() - 1), u"focus A"_s);
        QTest::keyClick(tree, Qt::Key_Right);
        QCOMPARE(gTold.last(), u"expanded A"_s);
        QTest::keyClick(tree, Qt::Key_Down);
        QCOMPARE(gTold.last(), u"focus Ann"_s);
        QTest::keyClick(tree, Qt::Key_Up);
        QTest::keyClick(tree, Qt::Key_Left);
        QCOMPARE(gTold.last(), u"collapsed A"_s);
    }

    void eachStepOfTabIsTold_data()
    {
        const DataRows<QString, QString> row("entry", "screen");
        row("mnuUpdate", "frmCDList");
        row("mnuSearchArtistsTitles", "frmSearchArtistsTitles");
        row("mnuInsertEnkelCD", "frmCDRootE");
        row("Import", "frmImportWizard");
    }

    void eachStepOfTabIsTold()
    {
        QFETCH(QString, entry);
        QFETCH(QString, screen);
        mProgram->choose(entry.toLatin1());
        QStringList silent;
        for (int i = 0; i < 20; ++i) {
            gTold.clear();
            const QPointer<QWidget> before = QApplication::focusWidget();
            QTest::keyClick(before, Qt::Key_Tab);
            QWidget *now = QApplication::focusWidget();
            const bool hasRows = qobject_cast<QAbstractItemView *>(now);
            const QString name =
                QAccessible::queryAccessibleInterface(now)->text(QAccessible::Name);
            if (before != now && gTold.value(gTold.size() - 1) != u"focus "_s + name && !hasRows)
                silent.append(now->objectName());
        }
        QCOMPARE(silent.join(u' '), QString());
    }

    void modalScreensAreDialogs()
    {
        const auto isDialog = [](Form &form) {
            QAccessibleInterface *told = QAccessible::queryAccessibleInterface(&form);
            QCOMPARE(told->role(), QAccessible::Dialog);
            QVERIFY(told->state().modal);
            form.Unload();
        };
        mDesktop->expectModal(u"frmSplash"_s, isDialog);
        mProgram->choose("Over");
        mProgram->control<QAbstractButton>("frmCDList", "cmdStartReport")->click();
        mDesktop->expectModal(u"frmPageSetup"_s, isDialog);
        mProgram->control<QAbstractButton>("CompilationReport", "cmdPageSetup")->click();
        QAccessibleInterface *report =
            QAccessible::queryAccessibleInterface(mProgram->screen("CompilationReport"));
        QVERIFY(report->role() != QAccessible::Dialog);
    }

    void names()
    {
        const auto nameOf = [](QWidget *w) {
            return QAccessible::queryAccessibleInterface(w)->text(QAccessible::Name);
        };
        QCOMPARE(nameOf(mProgram->frame().findChild<QToolBar *>(u"MainToolbar"_s)), u"Toolbar"_s);
        mProgram->choose("mnuSearchArtistsTitles");
        const auto field = [&](const char *name) {
            return nameOf(mProgram->control<QLineEdit>("frmSearchArtistsTitles", name));
        };
        QCOMPARE(field("txtHitjaarvan"), u"Hityear between:"_s);
        QCOMPARE(field("txtHitjaartm"), u"Last hityear"_s);
    }

    void thePreviewIsText()
    {
        showPage(1);
        mProgram->control<QAbstractButton>("frmCDList", "cmdStartReport")->click();
        auto *view = mProgram->control<ReportView>("AlbumReport", "Preview");
        QAccessibleInterface *page = QAccessible::queryAccessibleInterface(view);
        QCOMPARE(page->role(), QAccessible::Document);
        const auto *text = page->textInterface();
        QVERIFY(text);
        const QStringList lines = text->text(0, text->characterCount()).split(u'\n');
        QCOMPARE(lines.mid(0, 4), texts("Albums", "Artist\tTitle", "Ann\tAap", "Zed\tZebra"));
        QCOMPARE(lines.last(), u"Page 1 of 1"_s);
    }

private:
    void showPage(int page)
    {
        mProgram->control<QTabWidget>("frmCDList", "CDTab")->setCurrentIndex(page);
    }
};

QTEST_MAIN(tst_Assistive)
#include "tst_Assistive.moc"
