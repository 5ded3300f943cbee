// Label: unit
#include "shell/services/fileutilities.h"
#include "support/ordinaryuser.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>
#include <QTest>

/// Files, folders and the walk through a tree, on a real one.
class tst_FileUtilities : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void fileExists_data();
    void fileExists();
    void dirExists_data();
    void dirExists();
    void walks_data();
    void walks();
    void walkKeepsItsOrder();
    void walkFromUnderProcessed();
    void walkSums();
    void moves();
    void movesNot();
    void stripsAtNull();
    void asksForAFolder();

private:
    QString put(const char *name, const QByteArray &content = "x");
    QString at(const QString &name) const { return mFolder->filePath(name); }

    std::unique_ptr<QTemporaryDir> mFolder;
};

void tst_FileUtilities::init()
{
    mFolder = std::make_unique<QTemporaryDir>();
}

QString tst_FileUtilities::put(const char *name, const QByteArray &content)
{
    const QString full = at(QString::fromUtf8(name));
    QDir().mkpath(QFileInfo(full).absolutePath());
    return writeFile(full, content);
}

void tst_FileUtilities::fileExists_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<bool>("there");
    const auto row = [](const char *name, bool there) {
        QTest::newRow(name) << QString::fromUtf8(name) << there;
    };
    row("a.mp3", true);
    row("A.MP3", false);
    row("sub", true);
    row("sub/", true);
    row("sub\\b.txt", true); // as an older catalogue has it
    row("AC\\DC.mp3", true); // as it is comes first
    row("*.MP3", true);
    row("?.mp3", true);
    row("??.mp3", false);
    row("sub/*.t?t", true);
    row("sub\\*.txt", true);
    row("nowhere/*.txt", false);
    row("Album [Disc 1].mp3", true);
    row("Album [Disc ?].mp3", true);
    row("Album [Dx]*", false);
    row("a.mp", false);
    row("a*mp3*x", false);
    row("\U0001F3B5*", true);
    row("*.hidden", true);
}

void tst_FileUtilities::fileExists()
{
    QFETCH(QString, name);
    for (const char *file : {"a.mp3", "sub/b.txt", "AC\\DC.mp3", "Album [Disc 1].mp3",
                             "\U0001F3B5 song.ogg", ".x.hidden"})
        put(file);
    QTEST(FileExists(at(name)), "there");
    QVERIFY(!FileExists(QString()));
}

void tst_FileUtilities::dirExists_data()
{
    QTest::addColumn<QString>("name"); // "%" is the folder
    QTest::addColumn<bool>("there");
    const auto row = [](const char *name, bool there) {
        QTest::newRow(name) << QString::fromUtf8(name) << there;
    };
    row("/", true);
    row("%", true);
    row("%/", true);
    row(" %/sub/ ", true);
    row("%\\sub\\", true);
    row("%/sub/", true);
    row("%/sub/b.txt", false);
    row("%/su", false);
    row("%/none", false);
    row("", false);
    row("  ", false);
    row("C:", false);
}

void tst_FileUtilities::dirExists()
{
    QFETCH(QString, name);
    put("sub/b.txt");
    QTEST(DirExists(name.replace(QLatin1Char('%'), mFolder->path())), "there");
}

void tst_FileUtilities::walks_data()
{
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QString>("found");
    const auto row = [](const char *pattern, const char *found) {
        QTest::newRow(pattern) << QString::fromUtf8(pattern) << QString::fromUtf8(found);
    };
    row("*.mp3", "A.MP3|a/c.mp3|a/deep/d.Mp3|a/processed/n.mp3|linked.mp3");
    row("*.txt", "x.txt");
    row("?.mp3", "A.MP3|a/c.mp3|a/deep/d.Mp3|a/processed/n.mp3");
    row("[d].mp3", "");
    row("d.mp3", "a/deep/d.Mp3");
    row("*.ogg", "");
}

void tst_FileUtilities::walks()
{
    QFETCH(QString, pattern);
    for (const char *file :
         {"A.MP3", "x.txt", "b.mp3x", "a/c.mp3", "a/deep/d.Mp3", "a/Processed/e.mp3",
          "a/xProcessedx/f/g.mp3", "a/processed/n.mp3", "SYSTEM FILES/h.mp3", "folder.mp3/readme"})
        put(file);
    QFile::link(at(QStringLiteral("A.MP3")), at(QStringLiteral("linked.mp3")));
    QFile::link(mFolder->path(), at(QStringLiteral("a/round"))); // must not go round for ever
    for (const QString &end : {QString(), QStringLiteral("/")}) {
        QStringList found = FindFilesInTree(mFolder->path() + end, pattern, 1);
        QCOMPARE(gFoundFiles, found);
        for (QString &name : found)
            name = QDir(mFolder->path()).relativeFilePath(name);
        found.sort();
        QTEST(found.join(QLatin1Char('|')), "found");
    }
}

void tst_FileUtilities::walkKeepsItsOrder()
{
    for (int i = 0; i < 30; ++i)
        put(QByteArray("d" + QByteArray::number(i) + "/f.mp3").constData());
    for (int i = 0; i < 30; ++i)
        put(QByteArray(QByteArray::number(i) + ".mp3").constData());
    const QStringList found = FindFilesInTree(mFolder->path(), QStringLiteral("*.mp3"), 1);
    QCOMPARE(found.size(), 60);
    for (int i = 0; i < 60; ++i) // its own files first
        QCOMPARE(found[i].contains(QStringLiteral("/d")), i >= 30);
}

void tst_FileUtilities::walkFromUnderProcessed()
{
    put("Processed/a.mp3");
    put("Processed/sub/b.mp3");
    const QString start = at(QStringLiteral("Processed"));
    QCOMPARE(FindFilesInTree(start, QStringLiteral("*.mp3"), 1),
             QStringList{start + QStringLiteral("/a.mp3")});
    QCOMPARE(FindFilesInTree(at(QStringLiteral("none")), QStringLiteral("*"), 1), QStringList());
}

void tst_FileUtilities::walkSums()
{
    put("a.mp3", "12345");
    put("b/c.mp3", "123");
    put("SYSTEM FILES/d.mp3", "1234567"); // counts, is not listed
    put("e.txt", "12345678");
    QCOMPARE(ScanFolderTree(mFolder->path(), QStringLiteral("*.mp3"), 0, 0), 15.0);
}

void tst_FileUtilities::moves()
{
    const QString from = put("from.mp3", "new"), to = put("to.mp3", "old");
    QVERIFY(!MoveFileReplace(from, to));
    QVERIFY(!FileExists(from));
    QFile file(to);
    QVERIFY(file.open(QIODevice::ReadOnly));
    QCOMPARE(file.readAll(), QByteArray("new"));
    QVERIFY(!MoveFileReplace(to, at(QStringLiteral("To.mp3"))));
    QVERIFY(FileExists(at(QStringLiteral("To.mp3"))));
}

void tst_FileUtilities::movesNot()
{
    const QString from = put("from.mp3");
    put("folder/x");
    QVERIFY(MoveFileReplace(at(QStringLiteral("none")), at(QStringLiteral("x"))));
    QVERIFY(MoveFileReplace(from, at(QStringLiteral("folder"))));
    QVERIFY(MoveFileReplace(from, at(QStringLiteral("none/x"))));
    QVERIFY(MoveFileReplace(from, QStringLiteral("/proc/self/x"))); // another disk
    {
        const OrdinaryUser user;
        QVERIFY(MoveFileReplace(from, at(QStringLiteral("y"))));
    }
    QVERIFY(FileExists(from));
}

void tst_FileUtilities::stripsAtNull()
{
    QString s = QStringLiteral("ab") + QChar(0) + QStringLiteral("c");
    QCOMPARE(StripAtNull(s), QStringLiteral("ab"));
    QCOMPARE(s, QStringLiteral("ab"));
    QCOMPARE(StripAtNull(s), QStringLiteral("ab"));
}

void tst_FileUtilities::asksForAFolder()
{
    ScriptedDesktop desktop;
    desktop.expectFile(QStringLiteral("/chosen"));
    desktop.expectFile(QString()); // cancelled
    QCOMPARE(BrowseForFolderDialog(QStringLiteral("t"), QStringLiteral("/from")),
             QStringLiteral("/chosen"));
    QVERIFY(gBrowseInitialFolder.startsWith(QStringLiteral("/from")));
    QCOMPARE(BrowseForFolderDialog(QStringLiteral("t"), QString()), QString());
    desktop.verifyAllCame();
}

QTEST_GUILESS_MAIN(tst_FileUtilities)
#include "tst_FileUtilities.moc"
