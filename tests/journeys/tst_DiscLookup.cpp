// Label: journey
#include "controls/list/DBListViewCTL.h"
#include "controls/tracks/trackgrid.h"
#include "platform/ado/connection.h"
#include "support/journey.h"
#include "support/standinproxy.h"
#include "support/standinserver.h"

#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>

namespace
{

const char *const screen = "frmDiscInfoCDDB";

// A record of a disc of three tracks; titles parted by "|".
QByteArray record(const QByteArray &title, const QByteArray &tracks = "One|Two|Three")
{
    QByteArray lines = "# xmcd\r\n# Track frame offsets:\r\n# 150\r\n# 450\r\n# 750\r\n"
                       "# Disc length: 14 seconds\r\n# Revision: 4\r\nDISCID=09000c03\r\nDTITLE=" +
                       title + "\r\nDYEAR=1985\r\nDGENRE=Rock\r\n";
    for (int number = 0; const QByteArray &track : tracks.split('|'))
        lines += "TTITLE" + QByteArray::number(number++) + '=' + track + "\r\n";
    return "210 rock 09000c03 follows\r\n" + lines + "EXTD=\r\nPLAYORDER=\r\n.\r\n";
}

const QByteArray exact = "200 rock 09000c03 Nora Vance / Harbour\r\n";

template <typename Control> Control *in(Form &form, const char *name)
{
    return form.findChild<Control *>(QLatin1String(name));
}

void click(Form &form, const char *button)
{
    in<QPushButton>(form, button)->click();
}

void fill(Form &form, const std::vector<std::pair<const char *, AnyText>> &fields)
{
    for (const auto &[field, text] : fields)
        in<QLineEdit>(form, field)->setText(text);
}

} // namespace

/// A person looks discs up, through the menu, at a server that stands in for the services.
class tst_DiscLookup : public Journey
{
    Q_OBJECT

private:
    std::unique_ptr<StandInServer> mServer;

    void serve(const QByteArray &query, const QByteArray &read = {})
    {
        mServer = std::make_unique<StandInServer>();
        mServer->answer("cddb query", query);
        mServer->answer("cddb read", read);
        mServer->answer("submit.cgi", "200 OK, submission has been sent.\r\n");
    }

    void signUp(bool agree = true)
    {
        mDesktop->expectModal(u"SignUp"_s, [=, this](Form &form) {
            fill(form, {{"txtMail", "jo@example.net"},
                        {"txtMusicBrainzAddress", mServer->address()},
                        {"txtCDDBAddress", mServer->address()}});
            click(form, agree ? "cmdYes" : "cmdNo");
        });
    }

    void begin(int language)
    {
        start(language);
        signUp();
        mProgram->choose("mnuRegisterCDDB");
        mProgram->choose("mnuCDDB");
    }

    void press(const char *button) { mProgram->control<QPushButton>(screen, button)->click(); }
    QString text(const char *field) { return mProgram->control<QLineEdit>(screen, field)->text(); }
    bool canImport() { return mProgram->control<QPushButton>(screen, "cmdImport")->isEnabled(); }

    // What is done in the editor of a disc, which then ends by this button.
    void expectEditor(const AnyText &title, const char *button = "OKButton")
    {
        mDesktop->expectModal(u"DiscEditor"_s, [=](Form &form) {
            fill(form, {{"txtTitle", title}});
            click(form, button);
        });
    }

    // Of three tracks of four seconds.
    void lookUp()
    {
        const QString image = mDesktop->folder + u"/disc.bin"_s;
        QFile sparse(image);
        QVERIFY(sparse.open(QIODevice::WriteOnly) && sparse.resize(900 * 2352));
        mDesktop->expectFile(
            writeFile(mDesktop->folder + u"/disc.cue"_s,
                      "FILE \"disc.bin\" BINARY\nTRACK 01 AUDIO\nINDEX 01 00:00:00\n"
                      "TRACK 02 AUDIO\nINDEX 01 00:04:00\nTRACK 03 AUDIO\nINDEX 01 00:08:00\n"));
        auto *drives = mProgram->control<QComboBox>(screen, "TheDrive");
        drives->setCurrentText(GetMessage("xImageEntry"));
        press("cmdDownload");
    }

    QByteArray submitted() const
    {
        for (const StandInServer::Request &request : mServer->requests) {
            if (request.method == "POST")
                return request.head + request.body;
        }
        return {};
    }

    QStringList songs()
    {
        return gConnection->housekeeping("select group_concat(Titel) from Tracks").split(u',');
    }

private slots:
    void foundAndImported_data() { languages(); }
    void foundAndImported()
    {
        QFETCH(int, language);
        serve(exact, record("Nora Vance / Harbour", "One|Two 'n' %1|<b>Three</b>"));
        begin(language);
        lookUp();
        QVERIFY(canImport());
        QStringList shown;
        for (const char *field : {"txtArtist", "txtTitle", "txtYear", "txtGenre", "txtDiscNo"})
            shown.append(text(field));
        QCOMPARE(shown, texts("Nora Vance", "Harbour", "1985", "Rock", "1"));
        mDesktop->expectBox(GetMessage("DataNotSent").left(20));
        press("cmdSubmitDisc");
        mDesktop->expectBox(GetMessage("MsgCDDBImported"));
        press("cmdImport");
        QCOMPARE(column("SngList", 2), texts("Harbour"));
        QCOMPARE(songs(), texts("One", "Two 'n' %1", "<b>Three</b>"));
        QVERIFY(submitted().isEmpty());
    }

    void oneOfSeveral()
    {
        serve("210 found\r\nrock 09000c03 A / First\r\nmisc 09000c03 B / Second\r\n.\r\n",
              record("B / Second"));
        begin(languageEnglish);
        mDesktop->expectModal(u"Candidates"_s, [](Form &form) { click(form, "CancelButton"); });
        mDesktop->expectBox(u"You cancelled the fuzzy match dialog."_s);
        lookUp();
        QVERIFY(!canImport());
        mDesktop->expectModal(u"Candidates"_s, [](Form &form) {
            auto *list = in<DBListViewCTL>(form, "CandidateList");
            list->setSelectedItem(list->ListItems().Item(2));
            click(form, "OKButton");
        });
        lookUp();
        QCOMPARE(text("txtTitle"), u"Second"_s);
        QVERIFY(mServer->words().last().contains("cddb read misc 09000c03"));
    }

    void aNewDiscIsSent_data() { languages(); }
    void aNewDiscIsSent()
    {
        QFETCH(int, language);
        serve("202 No match\r\n");
        begin(language);
        mDesktop->expectBox(GetMessage("QuestNoMatchFound").left(20), vbNo);
        lookUp();
        QVERIFY(!canImport());
        mDesktop->expectBox(GetMessage("QuestNoMatchFound").left(20), vbYes);
        mDesktop->expectBox(GetMessage("xNotSentTitle")); // once, before it is filled in
        mDesktop->expectBox(GetMessage("MsgDiscSubmitted"));
        mDesktop->expectModal(u"DiscEditor"_s, [](Form &form) {
            click(form, "OKButton");
            QVERIFY(form.isVisible());
            fill(form, {{"txtArtist", "Zoë"}, {"txtTitle", "New"}});
            auto *grid = in<TrackGrid>(form, "AlbumTracks");
            for (int row = 0; row < 3; ++row)
                grid->model()->setData(grid->model()->index(row, 1), u"Harbour %1"_s.arg(row));
            in<QComboBox>(form, "cboCategory")->setCurrentText(u"folk"_s);
            click(form, "OKButton");
        });
        lookUp();
        const QByteArray sent = submitted();
        QVERIFY(sent.contains("Category: folk") && sent.contains("User-Email: jo@example.net"));
        QVERIFY(sent.contains("DTITLE=Zo\xC3\xAB / New") && sent.contains("TTITLE2=Harbour 2"));
        QVERIFY(sent.contains("# Revision: 0") && canImport());
    }

    void anEditedDiscIsSentOnce()
    {
        serve(exact, record("Nora Vance / Harbour"));
        begin(languageEnglish);
        lookUp();
        expectEditor("Harbor");
        press("cmdUpdateInfo");
        QCOMPARE(text("txtTitle"), u"Harbor"_s);
        mDesktop->expectBox(u"Updated data have been submitted!"_s);
        press("cmdSubmitDisc");
        QVERIFY(submitted().contains("# Revision: 5") && submitted().contains("/ Harbor\n"));
        mDesktop->expectBox(u"You did not change"_s);
        press("cmdSubmitDisc");
        expectEditor("thrown away", "CancelButton");
        mDesktop->expectBox(u"Do you want to discard your changes?"_s, vbYes);
        press("cmdUpdateInfo");
        QCOMPARE(text("txtTitle"), u"Harbor"_s);

        expectEditor("changed and not sent");
        press("cmdUpdateInfo");
        lookUp(); // what was changed before says nothing about the next disc
        mDesktop->expectBox(u"You did not change"_s);
        press("cmdSubmitDisc");
    }

    void aCompilationWithDummies()
    {
        serve(exact, record("Various / Hits", "A / One|B / Two|"));
        begin(languageDutch);
        lookUp();
        QCOMPARE(
            mProgram->control<DBListViewCTL>(screen, "DlvTracks")->ListItems().Item(2).SubItems(1),
            u"B"_s);
        mDesktop->expectModal(u"frmWhatNow"_s, [](Form &form) {
            in<QRadioButton>(form, "optInsertWithDummies")->click();
            click(form, "OKButton");
        });
        mDesktop->expectBox(GetMessage("MsgCDDBImported"));
        press("cmdImport");
        QCOMPARE(column("ColList", 1), texts("Hits"));
        QCOMPARE(songs(), texts("One", "Two", "?"));
    }

    void declinedNothingIsSent()
    {
        serve(exact);
        start(languageEnglish);
        mProgram->choose("mnuCDDB");
        signUp(false);
        lookUp();
        QVERIFY(mServer->requests.isEmpty() && !canImport());
    }

    void withoutANetwork_data() { languages(); }
    void withoutANetwork()
    {
        QFETCH(int, language);
        serve(exact, record("Nora Vance / Harbour"));
        begin(language);
        lookUp();
        mServer->close();
        mDesktop->expectBox(GetMessage("xKeptPart1"));
        lookUp();
        QCOMPARE(text("txtTitle"), u"Harbour"_s);
        QVERIFY(QDir(mDesktop->folder + u"/Answers"_s).removeRecursively());
        mDesktop->expectBox(GetMessage("MsgHostNotFound").left(20));
        lookUp();
        QVERIFY(!canImport() && text("txtTitle").isEmpty());
    }

    void throughAProxy()
    {
        serve(exact, record("Nora Vance / Harbour"));
        StandInProxy proxy("jo", "secret");
        start(languageEnglish);
        mDesktop->expectModal(u"ProxyInfo"_s, [&](Form &form) {
            const auto *ok = in<QPushButton>(form, "cmdOK");
            in<QCheckBox>(form, "chkUseProxy")->setChecked(true);
            fill(form, {{"ProxyServer", "127.0.0.1"}, {"ProxyServerPort", "80a"}});
            QVERIFY(!ok->isEnabled());
            fill(form, {{"ProxyServerPort", QString::number(proxy.serverPort())}});
            QVERIFY(ok->isEnabled());
            fill(form, {{"ProxyUserName", "jo"}});
            QVERIFY(!ok->isEnabled());
            fill(form, {{"ProxyPassword", "secret"}});
            click(form, "cmdOK");
        });
        mProgram->choose("mnuProxy");
        signUp();
        mProgram->choose("mnuRegisterCDDB");
        mProgram->choose("mnuCDDB");
        lookUp();
        QVERIFY(canImport() && proxy.passed >= 2);
    }

    void byWords()
    {
        serve(exact);
        mServer->answer("/ws/2/release?", R"({"releases": []})");
        begin(languageEnglish);
        mDesktop->expectModal(u"SearchByWords"_s, [](Form &form) {
            QVERIFY(!in<QPushButton>(form, "OKButton")->isEnabled());
            fill(form, {{"txtBarcode", "8 712345-000017"}});
            click(form, "OKButton");
        });
        mDesktop->expectBox(u"No disc was found for these words."_s);
        mProgram->control<QComboBox>(screen, "TheDrive")->setCurrentText(GetMessage("xWordsEntry"));
        press("cmdDownload");
        QVERIFY(mServer->words().last().contains("barcode:\"8712345000017\""));
    }
};

QTEST_MAIN(tst_DiscLookup)
#include "tst_DiscLookup.moc"
