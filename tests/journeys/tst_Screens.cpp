// Label: journey
#include "catalogue/cataloguefile.h"
#include "collection/frmCDList.h"
#include "collection/frmCDRoot.h"
#include "collection/frmCDRootE.h"
#include "collection/frmSearchArtistsTitles.h"
#include "conversion/frmAutoUpdateUtility.h"
#include "discdata/Candidates.h"
#include "discdata/Credits.h"
#include "discdata/DiscEditor.h"
#include "discdata/ProxyInfo.h"
#include "discdata/SearchByWords.h"
#include "discdata/SignUp.h"
#include "discdata/frmDiscInfoCDDB.h"
#include "discdata/frmWhatCD.h"
#include "discdata/frmWhatNow.h"
#include "mp3/EditMP3Tags.h"
#include "mp3/RenamePreview.h"
#include "mp3/UndoChanges.h"
#include "mp3/frmCDRootMP3.h"
#include "mp3/frmMatchWithSongcase.h"
#include "mp3/frmTagWizardPg1.h"
#include "mp3/frmTracks.h"
#include "platform/ado/connection.h"
#include "reports/frmPageSetup.h"
#include "reports/reportpaper.h"
#include "reports/reports.h"
#include "reports/reportview.h"
#include "services/globals.h"
#include "services/messages.h"
#include "shell/frmHelp.h"
#include "shell/frmSplash.h"
#include "support/datarows.h"
#include "support/program.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"
#include "textimport/frmImport.h"
#include "textimport/frmImportBusy.h"
#include "textimport/frmImportDBBusy.h"
#include "textimport/frmImportWizard.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAbstractSpinBox>
#include <QComboBox>
#include <QDirIterator>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QRadioButton>
#include <QStatusBar>
#include <QTabBar>
#include <QTabWidget>
#include <QTest>
#include <QTimer>
#include <QToolBar>

namespace
{

using Make = Form *(*)();

template <typename Screen> Form *make()
{
    return new Screen;
}

Form *makeCollectionEditor()
{
    auto *editor = new frmCDRootMP3;
    editor->Mode = u"I"_s;
    return editor;
}

// Of a record of Ground: by design nobody leaves the empty year of a new one by Tab.
template <typename Editor, qint64 id> Form *makeEditor()
{
    auto *editor = new Editor;
    editor->Mode = u"U"_s;
    editor->CdId = id;
    return editor;
}

// The browser on one of its pages.
template <int page> Form *makeBrowser()
{
    auto *browser = new frmCDList;
    browser->Load();
    browser->findChild<QTabWidget *>(u"CDTab"_s)->setCurrentIndex(page);
    return browser;
}

// With all that was found, so that nothing is disabled.
Form *makeSearch()
{
    auto *search = new frmSearchArtistsTitles;
    search->Show();
    search->findChild<QPushButton *>(u"cmdSearch"_s)->click();
    return search;
}

// With the rows that its command gives.
template <typename PrintedReport> Form *makeReport()
{
    auto *report = new PrintedReport;
    report->setDataSource(gConnection->Execute(PrintedReport::command()));
    report->setCaption(PrintedReport::caption());
    return report;
}

DiscRecord aDisc()
{
    DiscRecord disc;
    disc.title = u"Best"_s;
    disc.artist.name = u"Zed"_s;
    disc.tracks.resize(2);
    return disc;
}

Form *makeDiscEditor()
{
    return new DiscEditor(aDisc(), TableOfContents(), {u"Rock"_s});
}

Form *makeCandidates()
{
    return new Candidates({aDisc(), aDisc()});
}

Form *makeSignUp()
{
    CddbUserProfile profile;
    profile.services = knownServices();
    return new SignUp(profile);
}

// With a row whose file has gone.
Form *makeTagWizard()
{
    auto *wizard = new frmTagWizardPg1;
    wizard->Folder = u"/gone/"_s;
    wizard->FileRecords = std::make_shared<ADODB::Recordset>();
    for (const char *name :
         {"Nr", "Filename", "Album", "Artist", "Title", "TrackPosition", "PartOfSet", "TrackYear",
          "Genre", "CopyrightHolder", "Label", "Comments", "ID"})
        wizard->FileRecords->appendField(QLatin1String(name), ADODB::adVarWChar);
    wizard->FileRecords->Open();
    wizard->FileRecords->AddNew();
    wizard->FileRecords->Fields(u"Filename").setValue(u"gone.mp3"_s);
    return wizard;
}

Form *makeTagEditor()
{
    auto *editor = new EditMP3Tags;
    editor->Load();
    editor->EnableTagItems();
    return editor;
}

Form *makeWhatCD()
{
    auto *question = new frmWhatCD;
    question->CDType = u"E"_s;
    return question;
}

Form *makeRenamePreview()
{
    NewName name;
    name.name = u"01-Zed-One.mp3"_s;
    return new RenamePreview({{1, u"one.mp3"_s, name}});
}

template <QPageLayout::Orientation orientation> Form *makePageSetup()
{
    const auto rows = gConnection->Execute(AlbumReport::command());
    const auto content = std::make_shared<ReportContent>(rows, AlbumReport::caption(), QDate());
    return new frmPageSetup(content, reportpaper::layout(QPageSize::A4, orientation, QMargins()));
}

QString textOf(const QWidget *w)
{
    QString text = w->property("text").toString() + w->property("title").toString() +
                   w->windowTitle() + w->toolTip() + w->accessibleName();
    if (const auto *bar = qobject_cast<const QTabBar *>(w)) {
        for (int tab = 0; tab < bar->count(); ++tab)
            text += bar->tabText(tab);
    }
    if (const auto *head = qobject_cast<const QHeaderView *>(w); head && head->model()) {
        for (int section = 0; section < head->count(); ++section)
            text += head->model()->headerData(section, head->orientation()).toString();
    }
    if (const auto *bar = qobject_cast<const QStatusBar *>(w))
        text += bar->currentMessage();
    return text;
}

template <typename... Control> bool isOneOf(const QWidget *w)
{
    return (qobject_cast<const Control *>(w) || ...);
}

bool needsName(const QWidget *w)
{
    return isOneOf<QAbstractButton, QLineEdit, QAbstractItemView, QProgressBar>(w);
}

bool hasName(const QWidget *w, const QWidget *screen)
{
    const auto *button = qobject_cast<const QAbstractButton *>(w);
    if (!w->accessibleName().isEmpty() || (button && !button->text().isEmpty()))
        return true;
    const auto labels = screen->findChildren<QLabel *>();
    return std::any_of(labels.begin(), labels.end(), [w](QLabel *l) { return l->buddy() == w; });
}

bool isCut(const QWidget *w)
{
    if (const auto *label = qobject_cast<const QLabel *>(w); label && label->wordWrap())
        return label->heightForWidth(label->width()) > label->height();
    return isOneOf<QLabel, QAbstractButton>(w) &&
           (w->sizeHint().width() > w->width() || w->sizeHint().height() > w->height());
}

bool takesInput(const QWidget *w)
{
    const auto *label = qobject_cast<const QLabel *>(w);
    return needsName(w) || isOneOf<QComboBox, QAbstractSpinBox, QTabBar, ReportView>(w) ||
           (label && label->textInteractionFlags() & Qt::LinksAccessibleByKeyboard);
}

// The keys of a toolbar go to the grid, so its buttons take no focus, and arrows walk the buttons
// of a group; what shows a percentage takes nothing.
bool isPartOfAnother(const QWidget *w)
{
    return w->objectName().isEmpty() || w->objectName().startsWith("qt_"_L1);
}

bool isTabStop(const QWidget *w)
{
    const auto *radio = qobject_cast<const QRadioButton *>(w);
    const QWidget *parent = w->parentWidget();
    return takesInput(w) && w->isVisible() && w->isEnabled() && !w->focusProxy() &&
           !isPartOfAnother(w) && !(radio && !radio->isChecked()) &&
           !qobject_cast<const QProgressBar *>(w) && !qobject_cast<const QToolBar *>(parent);
}

QString missedBy(Qt::Key key, Form *screen)
{
    QSet<const QWidget *> reached;
    constexpr int enough = 100;
    for (int i = 0; i < enough && QApplication::focusWidget(); ++i) {
        reached.insert(QApplication::focusWidget());
        QTest::keyClick(QApplication::focusWidget(), key);
    }
    QStringList missed;
    for (const QWidget *w : screen->findChildren<QWidget *>()) {
        if (isTabStop(w) && !reached.contains(w))
            missed.append(w->objectName());
    }
    return missed.join(u' ');
}

} // namespace

/// What holds for every screen in both languages: each text comes from the table, is shown whole,
/// each control has a name that a screen reader can say, and is reached by Tab and by Shift+Tab.
class tst_Screens : public QObject
{
    Q_OBJECT

    /// How a screen is made, and what of it Shift+Tab alone reaches; "-": nobody walks through it.
    struct Screen {
        const char *name;
        Make make;
        const char *byShiftTabAlone = "";
    };
    static std::vector<Screen> screens()
    {
        return {{"frmSplash", make<frmSplash>, "-"},
                {"frmHelp", make<frmHelp>},
                {"frmCDList", makeBrowser<0>},
                {"frmCDList, albums", makeBrowser<1>},
                {"frmCDList, records", makeBrowser<2>},
                {"frmCDList, MP3", makeBrowser<3>},
                {"frmCDRoot", makeEditor<frmCDRoot, 1>, "DiscsTab cmdCancel"},
                {"frmCDRootE", makeEditor<frmCDRootE, 2>, "DiscsTab cmdCancel"},
                {"frmCDRootMP3", makeCollectionEditor},
                {"frmImportWizard", make<frmImportWizard>},
                {"frmImportBusy", make<frmImportBusy>, "-"},
                {"frmImport", make<frmImport>},
                {"frmImportDBBusy", make<frmImportDBBusy>, "-"},
                {"frmSearchArtistsTitles", makeSearch},
                {"CompilationReport", makeReport<CompilationReport>},
                {"AlbumReport", makeReport<AlbumReport>},
                {"PlatenbakReport", makeReport<PlatenbakReport>},
                {"frmPageSetup", makePageSetup<QPageLayout::Portrait>},
                {"frmPageSetup, landscape", makePageSetup<QPageLayout::Landscape>},
                {"frmAutoUpdateUtility", make<frmAutoUpdateUtility>, "-"},
                {"frmDiscInfoCDDB", make<frmDiscInfoCDDB>},
                {"DiscEditor", makeDiscEditor},
                {"Candidates", makeCandidates},
                {"SearchByWords", make<SearchByWords>},
                {"SignUp", makeSignUp},
                {"Credits", make<Credits>},
                {"ProxyInfo", make<ProxyInfo>},
                {"frmWhatNow", make<frmWhatNow>},
                {"frmWhatCD", makeWhatCD},
                {"EditMP3Tags", makeTagEditor},
                {"frmTracks", make<frmTracks>},
                {"frmMatchWithSongcase", make<frmMatchWithSongcase>},
                {"frmTagWizardPg1", makeTagWizard},
                {"RenamePreview", makeRenamePreview},
                {"UndoChanges", make<UndoChanges>}};
    }

    /// Discs on every page of the browser, so that nothing is disabled; a user who has signed up.
    struct Ground {
        ScriptedDesktop desktop;
        TestCatalogue catalogue;
        Ground()
        {
            CddbUserProfile profile;
            profile.registered = true;
            profile.store();
            catalogue.exec(uR"(insert into Artiesten values (1,'Zed');
            insert into Tracks values (1,1,'One',null,null);
            insert into CDTitels values (1,'Best',null,'V',null,1990),(2,'Zebra',1,'E',null,1990);
            insert into CompactDiscs values (1,1,1,1,1,null),(2,2,1,1,1,null),(3,1,2,1,1,null);
            insert into MP3Collections values (1,'/b','Second');)"_s);
        }
    };

    static void check(const QWidget *screen)
    {
        for (const QWidget *w : screen->findChildren<QWidget *>()) {
            const QByteArray name = w->objectName().toLatin1();
            const QString text = textOf(w);
            QVERIFY2(!text.contains("Unknown"_L1) && !text.contains("Onbekend"_L1), name);
            if (isPartOfAnother(w) || !w->isVisible())
                continue;
            QVERIFY2(!needsName(w) || hasName(w, screen),
                     QByteArray(name).append(": no name for a screen reader"));
            QVERIFY2(!isCut(w), QByteArray(name).append(": text cut: ").append(text.toUtf8()));
        }
    }

private slots:
    void everyFileOfAScreenIsHere()
    {
        const Ground ground;
        QSet<QString> here{u"MainScreen"_s}; // by theFrame()
        for (const auto &[name, make, _] : screens()) {
            const std::unique_ptr<Form> screen(make());
            for (auto *type = screen->metaObject(); type; type = type->superClass())
                here.insert(QString::fromLatin1(type->className()));
        }
        QStringList missing;
        QDirIterator it(qEnvironmentVariable("SONGCASE_SOURCE") + u"/src"_s, {u"*.ui"_s},
                        QDir::Files, QDirIterator::Subdirectories);
        QVERIFY(it.hasNext());
        while (it.hasNext()) {
            const QString name = QFileInfo(it.next()).completeBaseName();
            if (!here.contains(name))
                missing.append(name);
        }
        QCOMPARE(missing, QStringList());
    }

    void theFrame_data()
    {
        const DataRows<int> row("language");
        row("English", languageEnglish);
        row("Dutch", languageDutch);
    }
    void theFrame()
    {
        QFETCH(int, language);
        ScriptedDesktop desktop;
        cataloguefile::create(desktop.folder + u"/Compact4.orv"_s);
        storeLanguage(language);
        Program program(desktop);
        QVERIFY(program.start());
        check(&program.frame());
        QVERIFY(program.end());
    }

    // By design the last track of an editor leads to the first field: what stands below is reached
    // from there, by Shift+Tab.
    void everyScreen_data()
    {
        const DataRows<int, Make, QString> row("language", "make", "byShiftTabAlone");
        for (const auto &[name, make, byShiftTabAlone] : screens()) {
            row(QByteArray(name) + ", English", languageEnglish, make, byShiftTabAlone);
            row(QByteArray(name) + ", Dutch", languageDutch, make, byShiftTabAlone);
        }
    }

    void everyScreen()
    {
        QFETCH(int, language);
        QFETCH(Make, make);
        gLanguage = language;
        const Ground ground;
        Form *screen = make();
        QCOMPARE(screen->Name(), QString::fromLatin1(QTest::currentDataTag()).section(u',', 0, 0));
        for (QTimer *timer : screen->findChildren<QTimer *>())
            timer->stop();
        screen->Show();
        screen->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(screen));
        QVERIFY2(!screen->windowTitle().isEmpty(), "a window without a title");
        check(screen);
        QFETCH(QString, byShiftTabAlone);
        if (byShiftTabAlone != "-"_L1) {
            QCOMPARE(missedBy(Qt::Key_Tab, screen), byShiftTabAlone);
            QCOMPARE(missedBy(Qt::Key_Backtab, screen), QString());
        }
        screen->Unload();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
};

QTEST_MAIN(tst_Screens)
#include "tst_Screens.moc"
