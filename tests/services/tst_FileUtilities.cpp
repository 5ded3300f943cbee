// Label: unit
#include "services/fileutilities.h"
#include "support/datarows.h"
#include "support/ordinaryuser.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>

/// Files, folders and the walk through a tree, on a real one.
class tst_FileUtilities : public QObject
{
    Q_OBJECT

private:
    QString put(const char *name, const QByteArray &content = "x")
    {
        const QString full = at(QString::fromUtf8(name));
        QDir().mkpath(QFileInfo(full).absolutePath());
        return writeFile(full, content);
    }

    QString at(const QString &name) const { return mFolder->filePath(name); }

    std::unique_ptr<QTemporaryDir> mFolder;

private slots:
    void init() { mFolder = std::make_unique<QTemporaryDir>(); }

    void fileExists_data()
    {
        const DataRows<QString, bool> row("name", "there");
        row("a.mp3", true);
        row("A.MP3", false);
        row("sub/", true);
        row("sub\\b.txt", true); // as an older catalogue has it
        row("AC\\DC.mp3", true); // as it is comes first
        row("?.MP3", true);
        row("??.mp3", false);
        row("sub\\*.t?t", true);
        row("Album [Disc 1].mp3", true);
        row("Album [Dx]*", false);
        row("a.mp", false);
        row("*.hidden", true);
    }

    void fileExists()
    {
        QFETCH(QString, name);
        for (const char *file :
             {"a.mp3", "sub/b.txt", "AC\\DC.mp3", "Album [Disc 1].mp3", ".x.hidden"})
            put(file);
        QTEST(FileExists(at(name)), "there");
        QVERIFY(!FileExists(QString()));
    }

    void dirExists()
    {
        put("sub/b.txt");
        for (const char *name : {"%", " %/sub/ ", "%\\sub\\"}) // "%" is the folder
            QVERIFY2(DirExists(QString::fromLatin1(name).replace(u'%', mFolder->path())), name);
        for (const char *name : {"%/sub/b.txt", "%/su", "  "})
            QVERIFY2(!DirExists(QString::fromLatin1(name).replace(u'%', mFolder->path())), name);
    }

    void walks_data()
    {
        const DataRows<QString, QString> row("pattern", "found");
        row("*.mp3", "A.MP3|a/c.mp3|a/deep/d.Mp3|a/processed/n.mp3|linked.mp3");
        row("*.txt", "x.txt");
        row("?.mp3", "A.MP3|a/c.mp3|a/deep/d.Mp3|a/processed/n.mp3");
        row("[d].mp3", "");
        row("d.mp3", "a/deep/d.Mp3");
        row("*.ogg", "");
    }

    void walks()
    {
        QFETCH(QString, pattern);
        for (const char *file : {"A.MP3", "x.txt", "b.mp3x", "a/c.mp3", "a/deep/d.Mp3",
                                 "a/Processed/e.mp3", "a/xProcessedx/f/g.mp3", "a/processed/n.mp3",
                                 "SYSTEM FILES/h.mp3", "folder.mp3/readme"})
            put(file);
        QFile::link(at(u"A.MP3"_s), at(u"linked.mp3"_s));
        QFile::link(mFolder->path(), at(u"a/round"_s)); // must not go round for ever
        for (const QString &end : {QString(), u"/"_s}) {
            QStringList found = FindFilesInTree(mFolder->path() + end, pattern, 1);
            QCOMPARE(gFoundFiles, found);
            for (QString &name : found)
                name = QDir(mFolder->path()).relativeFilePath(name);
            found.sort();
            QTEST(found.join(u'|'), "found");
        }
    }

    void moves()
    {
        const QString from = put("from.mp3", "new"), to = put("to.mp3", "old");
        QVERIFY(!MoveFileReplace(from, to));
        QVERIFY(!FileExists(from));
        QCOMPARE(readFile(to), QByteArray("new"));
        QVERIFY(!MoveFileReplace(to, at(u"To.mp3"_s)));
        QVERIFY(FileExists(at(u"To.mp3"_s)));
    }

    void movesNot()
    {
        const QString from = put("from.mp3");
        put("folder/x");
        QVERIFY(MoveFileReplace(at(u"none"_s), at(u"x"_s)));
        QVERIFY(MoveFileReplace(from, at(u"folder"_s)));
        QVERIFY(MoveFileReplace(from, at(u"none/x"_s)));
        QVERIFY(MoveFileReplace(from, u"/proc/self/x"_s)); // another disk
        {
            const OrdinaryUser user;
            QVERIFY(MoveFileReplace(from, at(u"y"_s)));
        }
        QVERIFY(FileExists(from));
    }
};

QTEST_GUILESS_MAIN(tst_FileUtilities)
#include "tst_FileUtilities.moc"
