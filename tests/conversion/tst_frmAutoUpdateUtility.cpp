// Label: screen
#include "conversion/frmAutoUpdateUtility.h"
#include "platform/ado/connection.h"
#include "support/fulldisk.h"
#include "support/jetfile.h"
#include "support/screentest.h"

#include <QElapsedTimer>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTimer>
#include <csignal>

/// Catalogues of the older program, and what is none: taken over whole or not at all.
class tst_frmAutoUpdateUtility : public ScreenTest
{
    Q_OBJECT

    static frmAutoUpdateUtility *show()
    {
        auto *screen = new frmAutoUpdateUtility;
        screen->Show();
        return screen;
    }
    template <typename Control> static Control *control(const Form *screen, const char *name)
    {
        return screen->findChild<Control *>(QLatin1String(name));
    }
    static QPushButton *button(const Form *screen, const char *name)
    {
        return control<QPushButton>(screen, name);
    }
    static QStringList log(const Form *screen)
    {
        return control<QPlainTextEdit>(screen, "ReportList")
            ->toPlainText()
            .split(u'\n', Qt::SkipEmptyParts);
    }
    static void convert(const Form *screen, const QString &file)
    {
        control<QLineEdit>(screen, "txtOldDatabaseFileName")->setText(file);
        button(screen, "cmdStartConversion")->click();
    }

    // The log of one conversion.
    QStringList convert(const QString &name, const QByteArray &bytes) const
    {
        const QString file = writeFile(mCatalogue->path(name), bytes);
        auto *screen = show();
        convert(screen, file);
        const QStringList lines = log(screen);
        button(screen, "cmdCancel")->click();
        if (!screen->isUnloaded() || readFile(file) != bytes)
            return {u"the screen stays, or the file has changed"_s};
        return lines;
    }
    QStringList everything() const
    {
        QStringList all;
        for (const char *table :
             {"Artiesten", "Tracks", "CDTitels", "CompactDiscs", "MP3Collections", "MP3Files"})
            all += mCatalogue->rows(u"select * from "_s + QLatin1String(table) + u" order by ID"_s);
        return all;
    }

private slots:
    void wholeCatalogue_data()
    {
        const DataRows<int, QString> row("generation", "name");
        row("Jet 4", 4, "Compact3.orv");
        row("Jet 4, of the newest program", 4, "Compact4 100%41.orv");
        row("Jet 3", 3, "Compact3.orv");
        row("Jet 3, without MP3", 3, "Compact.orv");
        row("Jet 4, with MP3 tables that are damaged", 4, "Compact.orv");
    }
    void wholeCatalogue()
    {
        QFETCH(int, generation);
        QFETCH(QString, name);
        const bool withMP3 = name != "Compact.orv"_L1;
        auto tables = oldCatalogue();
        if (generation == 3 && !withMP3)
            tables.resize(4);
        else if (!withMP3)
            tables[4].statedRows = 9;
        const QStringList lines = convert(name, jetFile(tables, {generation, 0, {}}));
        QStringList wanted = texts("3|Guns N' Roses", "7|Édith Piaf", "5|3|November Rain|Rock|1992",
                                   "6|7|Milord|NULL|NULL", "9|7|No \"1\"\\\t%_||0",
                                   "2|Use Your Illusion|3|E|NULL|1991", "4|Mix|NULL|V|Pop|NULL",
                                   "1|2|1|1|5|NULL", "2|4|2|12|6|NULL", "3|4|2|13|9|NULL");
        QStringList found = texts("Opening old database", "Start at: 11/22/26 12:00:00",
                                  "Analyzing data....", "Found 2 artists....", "Found 3 tracks....",
                                  "Found 2 titles of albums and compilations....",
                                  "Found 3 tracks on these albums and compilations....");
        QStringList done =
            texts("50% of artists conversion completed", "67% of tracks conversion completed",
                  "50% of cd titles completed", "67% of discs conversion completed");
        if (withMP3) {
            wanted += texts("1|D:\\Muziek\\Pop|Pop", "8|1|Café.mp3|1");
            found += texts("Found 1  MP3 collections....", "Found 1  MP3 files....");
            done += texts("0% of MP3 collection conversion completed",
                          "0% of MP3 filenames conversion completed");
        }
        QCOMPARE(lines, found + done + texts("Ready at 11/22/26 12:00:00"));
        QCOMPARE(everything(), wanted);
    }

    // Letters of all kinds and lengths, as rows of one page and of many.
    void longTexts()
    {
        auto tables = oldCatalogue();
        QString all;
        for (const QString &sign : {u"ß"_s, u"Ж"_s, u"漢"_s, u"ع"_s, u"😀"_s, u"α"_s})
            all += sign.repeated(255 / 6 / int(sign.size()));
        const QString memo = u"Ω memo "_s.repeated(9000);
        for (int id = 100; id < 160; ++id)
            tables[0].rows.push_back(QVariantList{QString(all + QString::number(id)), id});
        tables[0].rows.push_back({QByteArray("\xFF\xFE"
                                             "Za\0\x14\x04\x30\x04\0z",
                                             11),
                                  99});
        tables[0].rows.push_back({QByteArray("\x41\x00\x00\xD8\x42\x00", 6), 98});
        tables[2].rows.push_back({8, memo, QVariant(), u"V"_s, QVariant(), QVariant()});
        QCOMPARE(convert(u"Compact3.orv"_s, jetFile(tables)).last(),
                 u"Ready at 11/22/26 12:00:00"_s);
        QCOMPARE(mCatalogue->rows("select Naam from Artiesten where ID in (98,99,159) order by ID"),
                 QStringList({u"A\uFFFDB"_s, u"ZaДаz"_s, all + u"159"_s}));
        QCOMPARE(mCatalogue->rows("select Titel from CDTitels where ID = 8"), QStringList(memo));
    }

    void deletedAndMovedRows()
    {
        auto tables = emptyOldCatalogue();
        tables[0].rows = {{u"deleted"_s, 1}, {u"was here"_s, 2}, {u"moved"_s, 3}, {u"stays"_s, 4}};
        tables[0].marks = {0xC000, 0x4000, 0x8000};
        tables[0].statedRows = 2;
        convert(u"Compact3.orv"_s, jetFile(tables));
        QCOMPARE(everything(), texts("3|moved", "4|stays"));
    }

    void emptyCatalogue()
    {
        const QStringList lines = convert(u"Compact3.orv"_s, jetFile(emptyOldCatalogue()));
        QCOMPARE(lines.size(), 10);
        QCOMPARE(lines[8], u"Found 0  MP3 files...."_s);
        QCOMPARE(lines[9], u"Ready at 11/22/26 12:00:00"_s);
    }

    void notTakenOver_data()
    {
        // said: key of the text, and what stands behind it
        const DataRows<QString, QByteArray, QByteArray, QString> row("name", "file", "said",
                                                                     "detail");
        const QByteArray good = jetFile(oldCatalogue());
        const auto changed = [](const std::function<void(std::vector<JetTable> &)> &change) {
            auto tables = oldCatalogue();
            change(tables);
            return jetFile(tables);
        };
        const auto with = [&](int table, const QVariantList &values) {
            return changed([&](auto &tables) { tables[size_t(table)].rows.push_back(values); });
        };
        row("no database", "Compact3.orv", "hello", "xOldNotADatabase", "");
        row("empty file", "Compact3.orv", "", "xOldNotADatabase", "");
        QByteArray newer = good;
        row("newer", "Compact3.orv", newer.replace(4, 15, "Standard ACE DB"), "xOldNewerFormat",
            "");
        newer = good;
        newer[0x14] = 2;
        row("newer version", "Compact3.orv", newer, "xOldNewerFormat", "");
        row("own", "Compact3.orv", readFile(TestCatalogue().file()), "xOldOwnFormat", "");
        row("encrypted", "Compact3.orv", jetFile(oldCatalogue(), {4, 5, {}}), "xOldProtected", "");
        row("password", "Compact3.orv", jetFile(oldCatalogue(), {4, 0, "s\0e\0"}), "xOldProtected",
            "");
        row("password, Jet 3", "Compact3.orv", jetFile(oldCatalogue(), {3, 0, "secret"}),
            "xOldProtected", "");
        row("cut within a page", "Compact3.orv", good.chopped(100), "xOldCutOff", "");
        row("first page alone", "Compact3.orv", good.left(4096), "xOldCutOff", "");
        row("last table cut", "Compact3.orv", good.chopped(5 * 4096), "xOldCutOff", "");
        row("zeros", "Compact3.orv", good.left(4096) + QByteArray(good.size() - 4096, 0),
            "xOldDamaged", "");
        row("rows missing", "Compact3.orv", changed([](auto &tables) { tables[1].statedRows = 4; }),
            "xOldDamaged", "");
        row("more rows than stated", "Compact3.orv",
            changed([](auto &tables) { tables[1].statedRows = 2; }), "xOldDamaged", "");
        row("table missing", "Compact.orv",
            changed([](auto &tables) { tables.erase(tables.begin() + 1); }), "xOldNoTable",
            "Tracks");
        row("no MP3, in capitals", "COMPACT.ORV", changed([](auto &tables) { tables.resize(4); }),
            "xOldNoMP3Table", "MP3Collections");
        row("column missing", "Compact3.orv",
            changed([](auto &tables) { tables[5].columns[2].name = "Name"; }), "xOldNoColumn",
            "MP3Files.FileName");
        row("same id", "Compact3.orv", with(0, {u"Abba"_s, 7}), "xOldTwice", "Artiesten, ID 7");
        row("no name", "Compact3.orv", with(0, {QVariant(), 8}), "xOldValue",
            "Artiesten, ID 8, Naam");
        row("no id", "Compact3.orv", with(4, {QVariant(), u"a"_s, u"b"_s}), "xOldValue",
            "MP3Collections, #2, ID");
        row("no artist", "Compact3.orv", with(1, {12, QVariant(), u"a"_s, u""_s, 1}), "xOldValue",
            "Tracks, ID 12, Artiest_ID");
    }
    void notTakenOver()
    {
        QFETCH(QString, name);
        QFETCH(QByteArray, file);
        QFETCH(QByteArray, said);
        QFETCH(QString, detail);
        const QStringList lines = convert(name, file);
        QVERIFY(lines.size() >= 4);
        QCOMPARE(lines[lines.size() - 3],
                 u"Fatal error: "_s + GetMessage(said.constData()) + detail);
        QCOMPARE(lines[lines.size() - 2], u"No data were imported."_s);
        QCOMPARE(lines.last(), u"Stopped at 11/22/26 12:00:00"_s);
        QCOMPARE(everything(), QStringList());
        QCOMPARE(convert(u"Compact3.orv"_s, jetFile(oldCatalogue())).last(),
                 u"Ready at 11/22/26 12:00:00"_s);
    }

    void failureIsRedOnBlack()
    {
        const Form *screen = show();
        convert(screen, mCatalogue->path("."));
        const auto *report = control<QPlainTextEdit>(screen, "ReportList");
        QVERIFY2(log(screen)[1].endsWith(GetMessage("xOldNotAFile")), qPrintable(log(screen)[1]));
        QCOMPARE(report->palette().color(QPalette::Base), QColor(Qt::black));
        QCOMPARE(report->palette().color(QPalette::Text), QColor(Qt::red));
        QVERIFY(report->isReadOnly());
    }

    void fullDiskLeavesNothing()
    {
        auto tables = oldCatalogue();
        for (int id = 100; id < 2000; ++id)
            tables[0].rows.push_back({QString(QString(200, u'x') + QString::number(id)), id});
        const QByteArray bytes = jetFile(tables);
        const QString file = writeFile(mCatalogue->path("Compact3.orv"), bytes);
        {
            const FullDisk full(200'000);
            const Form *screen = show();
            convert(screen, file);
            QVERIFY2(log(screen).contains(u"No data were imported."_s),
                     "the disk was large enough");
        }
        QCOMPARE(everything(), QStringList());
    }

    void cancel_data()
    {
        const DataRows<QString, bool> row("how", "stays");
        row("button", true);
        row("window", false);
        row("end of the program", false);
    }
    void cancel()
    {
        QFETCH(QString, how);
        QFETCH(bool, stays);
        auto tables = oldCatalogue();
        for (int id = 100; id < 5000; ++id)
            tables[0].rows.push_back(QVariantList{QString::number(id), id});
        const QString file = writeFile(mCatalogue->path("Compact3.orv"), jetFile(tables));
        const QPointer<Form> screen = show();
        QTimer timer;
        connect(&timer, &QTimer::timeout, screen, [&] {
            if (!log(screen).last().contains("of artists conversion"_L1))
                return;
            timer.stop();
            if (how == "button"_L1)
                button(screen, "cmdCancel")->click();
            else if (how == "window"_L1)
                screen->close();
            else
                Form::UnloadAll({}, true);
        });
        timer.start(0);
        convert(screen, file);
        QVERIFY(!timer.isActive());
        QCOMPARE(everything(), QStringList());
        QCOMPARE(screen && !screen->isUnloaded(), stays);
        if (!stays)
            return;
        QCOMPARE(log(screen).mid(log(screen).size() - 2),
                 texts("Conversion cancelled.", "Stopped at 11/22/26 12:00:00"));
        button(screen, "cmdCancel")->click();
        QVERIFY(screen->isUnloaded());
    }

    // On a dying medium, or where the library does not come to an end.
    void cancelWhileTheFileHangs()
    {
        const QString file = writeFile(mCatalogue->path("Compact3.orv"), jetFile(oldCatalogue()));
        const QPointer<Form> screen = show();
        QTimer timer;
        connect(&timer, &QTimer::timeout, screen, [&] {
            const int helper = readFile(u"/proc/thread-self/children"_s).trimmed().toInt();
            if (helper <= 0)
                return;
            timer.stop();
            kill(helper, SIGSTOP);
            button(screen, "cmdCancel")->click();
        });
        timer.start(0);
        QElapsedTimer time;
        time.start();
        convert(screen, file);
        QVERIFY(time.elapsed() < 10'000);
        QVERIFY(!timer.isActive() && screen->isUnloaded());
    }

    void notIntoACatalogueWithArtists()
    {
        mCatalogue->exec("insert into Artiesten values (1,'Zed')");
        const Form *screen = show();
        const auto *text = control<QLabel>(screen, "lblAutoUpdateUtilityText");
        QCOMPARE(text->palette().color(QPalette::WindowText), QColor(Qt::red));
        QVERIFY(text->text().contains("appears not to be empty"_L1));
        for (const char *name : {"cmdStartConversion", "cmdCancel", "cmdBrowse"})
            QVERIFY(!button(screen, name)->isVisible());
    }

    void catalogueThatCannotBeRead()
    {
        mCatalogue->exec("drop table Artiesten");
        mDesktop->expectBox(u"artiesten"_s);
        QVERIFY(show()->isUnloaded());
    }

    void choosingTheFile()
    {
        const QString folder = mCatalogue->path("old");
        QDir().mkpath(folder);
        const Form *screen = show();
        const auto *name = control<QLineEdit>(screen, "txtOldDatabaseFileName");
        QVERIFY(name->text().isEmpty() && !button(screen, "cmdStartConversion")->isEnabled());
        mDesktop->expectFile(folder);
        mDesktop->expectBox(u"error"_s);
        button(screen, "cmdBrowse")->click();
        for (const QString &file : {u"/Compact.orv"_s, u"/Compact3.orv"_s}) { // the newer one first
            writeFile(folder + file, "x");
            mDesktop->expectFile(folder);
            button(screen, "cmdBrowse")->click();
            QCOMPARE(name->text(), folder + file);
        }
        QVERIFY(button(screen, "cmdStartConversion")->isEnabled());

        mDesktop->expectBox(u"Invalid filename"_s);
        convert(screen, folder + u"/gone.orv"_s);
        QVERIFY(button(screen, "cmdStartConversion")->isEnabled());

        writeFile(mDesktop->folder + u"/Compact.orv"_s, "x");
        QCOMPARE(control<QLineEdit>(show(), "txtOldDatabaseFileName")->text(),
                 mDesktop->folder + u"/Compact.orv"_s);
    }
};

QTEST_MAIN(tst_frmAutoUpdateUtility)
#include "tst_frmAutoUpdateUtility.moc"
