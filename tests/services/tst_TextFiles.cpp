// Label: unit
#include "services/textfiles.h"
#include "support/datarows.h"
#include "support/fulldisk.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>
#include <QSaveFile>

/// Text files, line by line, in and out.
class tst_TextFiles : public QObject
{
    Q_OBJECT

private:
    QString at(const char *name) const { return mFolder->filePath(QString::fromUtf8(name)); }
    std::unique_ptr<QTemporaryDir> mFolder;

private slots:
    void init() { mFolder = std::make_unique<QTemporaryDir>(); }

    void reads_data()
    {
        // lines: joined by "|", one behind each
        const DataRows<QByteArray, QString> row("bytes", "lines");
        row("empty", "", "");
        row("one line without end", "a", "a|");
        row("every end", "a\r\nb\rc\n\r\rd\r", "a|b|c|||d|");
        row("a mark", "\xEF\xBB\xBFx\n", "x|");
        row("nothing but a mark", "\xEF\xBB\xBF", "");
        row("UTF-8", "\xF0\x9F\x8E\xB5\n", "\U0001F3B5|");
        row("Windows-1252", "caf\xE9 \x80\x93\n", "café €“|");
        row("one bad byte decides for all", "caf\xC3\xA9\n\xE9", "cafÃ©|é|");
        row("blanks stay", " a \t\n", " a \t|");
    }

    void reads()
    {
        QFETCH(QByteArray, bytes);
        QFETCH(QString, lines);
        InputTextFile file;
        QVERIFY(OpenInputFile(writeFile(at("in.txt"), bytes), file));
        QCOMPARE(file.countLines(), int(lines.count(u'|')));
        writeFile(at("in.txt"), "changed meanwhile");
        QString all;
        while (!file.atEnd())
            all += ReadTextLine(file) + u'|';
        QCOMPARE(all, lines);
        QCOMPARE(ReadTextLine(file), QString()); // behind the end: nothing, and no box
        QVERIFY(CloseTextFile(file));
        QVERIFY(file.atEnd());
    }

    void opensNot()
    {
        InputTextFile in;
        QVERIFY(!OpenInputFile(at("none"), in));
        QVERIFY(!OpenInputFile(QString(), in));
        QVERIFY(!OpenInputFile(mFolder->path(), in));
        QVERIFY(in.atEnd());
        OutputTextFile out;
        for (const QString &name : {at("none/x"), mFolder->path(), QString()}) {
            QVERIFY(!OpenOutputFile(name, out));
            QVERIFY(!WriteTextLine(out, u"x"_s));
            QVERIFY(!CloseTextFile(out));
        }
        QVERIFY(QDir(mFolder->path()).isEmpty());
    }

    void writes()
    {
        // A name just chosen: the backslash is part of it.
        for (const char *name : {"out.txt", "AC\\DC \U0001F3B5.txt"}) {
            writeFile(at(name), "an older and longer one\n");
            OutputTextFile file;
            QVERIFY(OpenOutputFile(at(name), file));
            QVERIFY(WriteTextLine(file, u"\"café\";\"\U0001F3B5\""_s));
            QVERIFY(WriteTextLine(file, QString()));
            QCOMPARE(readFile(at(name)), QByteArray("an older and longer one\n"));
            QVERIFY(CloseTextFile(file));
            QCOMPARE(readFile(at(name)), QByteArray("\"caf\xC3\xA9\";\"\xF0\x9F\x8E\xB5\"\n\n"));
            QVERIFY(!CloseTextFile(file));
            QVERIFY(!WriteTextLine(file, u"x"_s));
        }
        QCOMPARE(QDir(mFolder->path()).entryList(QDir::Files).size(), 2);
    }

    void leavesTheOldFile()
    {
        for (const bool diskFull : {false, true}) { // else it is never closed
            writeFile(at("out.txt"), "old");
            bool closed = false;
            {
                const FullDisk full(diskFull ? 4000 : RLIM_INFINITY);
                OutputTextFile file;
                QVERIFY(OpenOutputFile(at("out.txt"), file));
                for (int i = 0; i < 5; ++i)
                    WriteTextLine(file, QString(1000, u'x'));
                closed = diskFull && CloseTextFile(file);
            }
            QVERIFY(!closed);
            QCOMPARE(readFile(at("out.txt")), QByteArray("old"));
            QCOMPARE(QDir(mFolder->path()).entryList(QDir::Files).size(), 1);
        }
    }
};

QTEST_APPLESS_MAIN(tst_TextFiles)
#include "tst_TextFiles.moc"
