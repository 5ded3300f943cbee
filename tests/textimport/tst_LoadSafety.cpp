// Label: screen
#include "catalogue/cataloguefile.h"
#include "platform/ado/recordset.h"
#include "support/importfixture.h"
#include "textimport/catalogueload.h"
#include "textimport/filereading.h"
#include "textimport/frmImportDBBusy.h"

#include <QApplication>
#include <QProcess>
#include <csignal>
#include <cstdio>
#include <sys/mount.h>
#include <sys/resource.h>
#include <unistd.h>

namespace
{

constexpr int trackCount = 3000;

QByteArray manyTracks()
{
    QByteArray content = "A Long List\n";
    for (int i = 0; i < trackCount; ++i)
        content += "Artist " + QByteArray::number(i % 700) + "*A Song With The Number " +
                   QByteArray::number(i) + "*Pop*1985\n";
    return content;
}

// The other process: loads the file and, before this track, tells and stands still. Its cache is so
// small that most of the load is on the disk by then, as that of a long one would be.
int loadAndStop(const QString &catalogue, const QString &file, int track)
{
    openConnection(catalogue);
    gConnection->housekeeping("PRAGMA cache_size=10");
    chooseImport('C', file);
    FileReading().run();
    CatalogueLoad load;
    int number = 0;
    const auto stop = [] {
        std::puts("here");
        std::fflush(stdout);
        pause();
    };
    load.step = [&](qint64, qint64) {
        if (++number == track)
            stop();
        return true;
    };
    load.run();
    stop();
    return 0;
}

QStringList everything(TestCatalogue &catalogue)
{
    return catalogue.rows("select * from Artiesten") + catalogue.rows("select * from Tracks") +
           catalogue.rows("select * from CDTitels") + catalogue.rows("select * from CompactDiscs");
}

void load(ScriptedDesktop &desktop, const QStringList &boxes)
{
    for (const QString &box : boxes)
        desktop.expectBox(box);
    desktop.expectModal(u"frmImportDBBusy"_s);
    defaultInstance<frmImportDBBusy>().ShowModal();
    desktop.verifyAllCame();
}

/// A disk with room for a catalogue and little more. Only the super-user can make a real one; for
/// others no file may grow, which fails alike but with another code.
class SmallDisk
{
public:
    explicit SmallDisk(const QString &folder) : mFolder(folder.toLocal8Bit())
    {
        mReal = ::mount("tmpfs", mFolder.constData(), "tmpfs", 0, "size=1m") == 0;
    }
    ~SmallDisk()
    {
        makeRoom();
        if (mReal)
            ::umount2(mFolder.constData(), MNT_DETACH);
    }
    void fill()
    {
        if (mReal)
            writeFile(filler(), QByteArray(900 << 10, 'x'));
        else
            limitFiles(100 << 10);
    }
    void makeRoom()
    {
        if (mReal)
            QFile::remove(filler());
        else
            limitFiles(RLIM_INFINITY);
    }
    QString message() const { return mReal ? u"The disk is full"_s : u"The disk"_s; }

private:
    QString filler() const { return QString::fromLocal8Bit(mFolder) + u"/filler"_s; }
    static void limitFiles(rlim_t size)
    {
        std::signal(SIGXFSZ, SIG_IGN);
        rlimit limit;
        getrlimit(RLIMIT_FSIZE, &limit);
        limit.rlim_cur = std::min(size, limit.rlim_max);
        setrlimit(RLIMIT_FSIZE, &limit);
    }

    QByteArray mFolder;
    bool mReal;
};

} // namespace

/// What happens to the catalogue when a load is killed or the disk fills up: nothing.
class tst_LoadSafety : public QObject
{
    Q_OBJECT

private slots:
    void aKilledLoadLeavesNoTrace_data()
    {
        const DataRows<int, bool> row("track", "loaded");
        row("early", 30, false);
        row("before the last track", trackCount, false);
        row("behind the commit", trackCount + 1, true);
    }

    void aKilledLoadLeavesNoTrace()
    {
        QFETCH(int, track);
        QFETCH(bool, loaded);
        TestCatalogue catalogue;
        catalogue.exec("insert into Artiesten values (1,'Artist 1'); "
                       "insert into Tracks values (1,1,'X',NULL,NULL)");
        gConnection->Close();
        const QStringList before = everything(catalogue);
        const QString file = writeFile(catalogue.path("in.txt"), manyTracks());

        QProcess other;
        other.start(QCoreApplication::applicationFilePath(),
                    {u"--load"_s, catalogue.file(), file, QString::number(track)});
        QVERIFY(other.waitForReadyRead(20000));
        QCOMPARE(other.readAllStandardOutput().trimmed(), QByteArray("here"));
        const bool halfWritten = track > 1 && !loaded;
        QCOMPARE(QFileInfo(catalogue.file() + u"-journal"_s).size() > 0, halfWritten);
        other.kill();
        QVERIFY(other.waitForFinished());

        openConnection(catalogue.file());
        cataloguefile::verify(*gConnection, true);
        if (loaded)
            QCOMPARE(catalogue.count("select count(*) from CompactDiscs"), trackCount);
        else
            QCOMPARE(everything(catalogue), before);
    }

    void aFullDiskLeavesNoTrace()
    {
        ScriptedDesktop desktop;
        QTemporaryDir folder;
        SmallDisk disk(folder.path());
        const QString file = folder.filePath(u"Compact4.orv"_s);
        cataloguefile::create(file);
        openConnection(file);
        gConnection->Execute(u"insert into Artiesten(ID,Naam) values (1,'Artist 1')"_s);
        QTemporaryDir elsewhere;
        chooseImport('C', writeFile(elsewhere.filePath(u"in.txt"_s), manyTracks()));
        FileReading().run();

        disk.fill();
        load(desktop, {disk.message(), disk.message()});
        QCOMPARE(gConnection->housekeeping("select group_concat(ID) from Artiesten"), u"1"_s);
        QCOMPARE(gConnection->housekeeping("select count(*) from Tracks"), u"0"_s);
        QCOMPARE(gConnection->housekeeping("PRAGMA integrity_check"), u"ok"_s);

        disk.makeRoom();
        load(desktop, {u"Number of imported tracks: %1"_s.arg(trackCount)});
        QCOMPARE(gConnection->housekeeping("select count(*) from CompactDiscs"),
                 QString::number(trackCount));
        gConnection.reset();
    }
};

int main(int argc, char **argv)
{
    QApplication application(argc, argv);
    const QStringList arguments = QCoreApplication::arguments();
    if (arguments.value(1) == "--load"_L1)
        return loadAndStop(arguments.value(2), arguments.value(3), arguments.value(4).toInt());
    tst_LoadSafety test;
    return QTest::qExec(&test, argc, argv);
}
#include "tst_LoadSafety.moc"
