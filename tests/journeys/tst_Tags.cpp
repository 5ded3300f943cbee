// Label: journey
#include "collection/frmCDList.h"
#include "controls/list/DBListViewCTL.h"
#include "support/journey.h"
#include "support/tagscreentest.h"

#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTabWidget>

/// A person fills the tags of files that say nothing, from the browser on, and takes it back.
class tst_Tags : public Journey
{
    Q_OBJECT

private:
    static constexpr auto editor = "frmCDRootMP3";
    std::unique_ptr<StandInServer> mServer;
    QStringList mFiles;

    // A collection of twelve files, and the disc that they are in the catalogue.
    void begin(int language)
    {
        start(language);
        mServer = std::make_unique<StandInServer>();
        signUpAt(*mServer);
        std::vector<std::pair<QString, int>> sounds;
        QStringList sql{
            u"begin;insert into Artiesten values (1,'Nora');insert into CDTitels values "
            "(1,'Harbour',1,'E',null,1990);"_s};
        for (int number = 1; number <= 12; ++number) {
            const QString n = QString::number(number);
            sounds.emplace_back(n + u".mp3"_s, 10000 * number);
            sql.append(u"insert into Tracks values ("_s + n + u",1,'Own "_s + n + u"',null,null);" +
                       u"insert into CompactDiscs values ("_s + n + u",1,1,"_s + n + u","_s + n +
                       u",null);insert into MP3Files values("_s + n + u","_s + n + u",'"_s + n +
                       u".mp3',1);"_s);
        }
        mFiles = makeSounds(mDesktop->folder, sounds);
        sql.append(u"insert into MP3Collections values (1,'"_s + mDesktop->folder +
                   u"','Mine');commit;"_s);
        const OtherProgram other(gDatabasePath);
        QCOMPARE(other.run(sql.join(QString()).toUtf8()), 0);
        auto *browser = qobject_cast<frmCDList *>(mProgram->screen("frmCDList"));
        browser->findChild<QTabWidget *>(u"CDTab"_s)->setCurrentIndex(3);
        browser->RefreshLists();
        emit browser->findChild<DBListViewCTL *>(u"MP3List"_s)->DblClick();
        QVERIFY(mProgram->screen(editor));
    }
    DBListViewCTL *list() { return mProgram->control<DBListViewCTL>(editor, "TheMP3Collection"); }
    void press(const char *button) { mProgram->control<QPushButton>(editor, button)->click(); }
    static void click(Form &form, const char *button)
    {
        form.findChild<QPushButton *>(QLatin1String(button))->click();
    }
    QStringList titles()
    {
        QStringList all;
        for (int row = 1; row <= list()->ListItems().Count(); ++row)
            all.append(list()->ListItems().Item(row).SubItems(4));
        return all;
    }
    static QStringList numbered(const QString &name)
    {
        QStringList all;
        for (int number = 1; number <= 12; ++number)
            all.append(name + QString::number(number));
        return all;
    }
    void tagAll(const std::function<void(Form &form)> &match)
    {
        list()->selectAll();
        emit list()->ItemClick(list()->SelectedItem());
        mDesktop->expectModal(u"frmTagWizardPg1"_s, [=, this](Form &form) {
            QCoreApplication::processEvents();
            match(form);
            mDesktop->expectBox(GetMessage("MP3ProcAllTagsSaved"));
            click(form, "cmdSaveTags");
        });
        press("cmdTagWizard");
    }

private slots:
    void filledFromAService_data() { languages(); }
    void filledFromAService()
    {
        QFETCH(int, language);
        begin(language);
        mServer->answer("discid/", discsOfService({u"Found"_s}, 12));
        tagAll([this](Form &form) {
            mDesktop->expectBox(GetMessage("MP3ProcTagItemsSubstituted").section(u'\r', 0, 0));
            click(form, "OKButton");
        });
        QCOMPARE(titles(), numbered(u"Song "_s)); // read again from the files
    }

    void filledFromTheCatalogue_data() { languages(); }
    void filledFromTheCatalogue()
    {
        QFETCH(int, language);
        begin(language);
        tagAll([this](Form &form) {
            form.findChild<QRadioButton *>(u"optRelateToDatabase"_s)->click();
            mDesktop->expectModal(u"frmMatchWithSongcase"_s, [](Form &search) {
                click(search, "cmdSearch");
                click(search, "cmdChoose");
            });
            mDesktop->expectBox(GetMessage("MP3ProcTagItemsSubstituted").section(u'\r', 0, 0));
            click(form, "OKButton");
        });
        QCOMPARE(titles(), numbered(u"Own "_s));
    }

    void oneFileTyped()
    {
        begin(languageEnglish);
        list()->setSelectedItem(list()->ListItems().Item(2));
        emit list()->ItemClick(list()->SelectedItem());
        mDesktop->expectModal(u"EditMP3Tags"_s, [](Form &form) {
            form.findChild<QLineEdit *>(u"txtTrackTitle"_s)->setText(u"Typed"_s);
            click(form, "cmdOK");
        });
        press("cmdUpdateID3");
        QCOMPARE(titles().at(1), u"Typed"_s);
        QVERIFY(QFile::remove(mFiles[1]));
        mDesktop->expectBox({}); // that a file is missing
        press("cmdUpdateID3");
        QCOMPARE(titles().at(1), u"?"_s);
    }
};

QTEST_MAIN(tst_Tags)
#include "tst_Tags.moc"
