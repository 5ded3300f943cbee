// Label: screen
#include "discdata/drives.h"
#include "discdata/mmcontrol.h"
#include "discs/discid.h"
#include "platform/work/longwork.h"
#include "support/screentest.h"

#include <QFile>
#include <QTimer>
#include <QtEndian>
#include <sys/stat.h>

namespace
{

constexpr int sector = 2352;

QByteArray number(quint64 value, int bytes)
{
    QByteArray big(8, 0);
    qToBigEndian(value, big.data());
    return big.right(bytes);
}

QByteArray little(quint32 value)
{
    QByteArray bytes(4, 0);
    qToLittleEndian(value, bytes.data());
    return bytes;
}

QByteArray chunk(const QByteArray &name, const QByteArray &content)
{
    return name + number(quint64(content.size()), 4) + content;
}

// The end of an image of Nero: tracks of sound, each of so many frames.
QByteArray neroTrailer(const QList<int> &lengths)
{
    QByteArray cues = number(0x01000000, 4) + number(quint64(-150), 4);
    QByteArray tracks = number(0, 4) + QByteArray(14, 0) + number(1, 3);
    tracks += number(quint64(lengths.size()), 1);
    int at = 0;
    for (int i = 0; i < lengths.size(); ++i) {
        const quint64 track = 0x01000000u + (quint64(i + 1) << 16);
        cues += number(track, 4) + number(quint64(i == 0 ? -150 : at), 4);
        cues += number(track | 0x100, 4) + number(quint64(at), 4);
        const quint64 start = quint64(at) * sector;
        at += lengths[i];
        tracks += QByteArray(12, 0) + number(sector, 2) + number(0x07000001, 4) + number(start, 8) +
                  number(start, 8) + number(quint64(at) * sector, 8);
    }
    cues += number(0x01aa0100, 4) + number(quint64(at), 4);
    return chunk("CUEX", cues) + chunk("DAOX", tracks) +
           chunk("SINF", number(quint64(lengths.size()), 4)) + chunk("MTYP", number(1, 4)) +
           chunk("END!", {}) + "NER5" + number(quint64(at) * sector, 8);
}

// Silence of so many frames, in a file with a hole.
QByteArray waveHeader(int frames)
{
    const auto size = quint32(frames * sector);
    return "RIFF" + little(size + 36) + "WAVEfmt " + little(16) + QByteArray("\1\0\2\0", 4) +
           little(44100) + little(176400) + QByteArray("\4\0\20\0", 4) + "data" + little(size);
}

} // namespace

/// Discs as the look-up opens them, and what stands there instead of one.
class tst_MMControl : public ScreenTest
{
    Q_OBJECT

    std::unique_ptr<QTemporaryDir> mFolder;
    QPointer<Form> mScreen;
    std::unique_ptr<MMControl> mControl;

    QString path(const QString &name) const { return mFolder->filePath(name); }

    // Front and end of a file, the bytes between them not written.
    QString write(const QString &name, qint64 size, const QByteArray &front,
                  const QByteArray &end = {}) const
    {
        QFile file(path(name));
        if (!file.open(QIODevice::WriteOnly) || !file.resize(size))
            qFatal("no file can be made");
        file.write(front);
        file.seek(size);
        file.write(end);
        return file.fileName();
    }
    void writeWave(const QString &name, int frames) const
    {
        write(name, frames * sector + 44, waveHeader(frames));
    }
    QString script(const QByteArray &lines) const
    {
        const QString name = write(u"reader"_s, 0, "#!/bin/sh\n" + lines + '\n');
        QFile::setPermissions(name, QFile::ReadOwner | QFile::ExeOwner);
        return name;
    }

    // "150 450 | 750" and what is known; or the problem.
    QString open(const QString &name) { return open(*mControl, name); }
    static QString open(MMControl &control, const QString &name)
    {
        control.DeviceType = u"CDAudio"_s;
        control.FileName = name;
        control.Command(u"Open"_s);
        if (control.Tracks() == 0)
            return u"none"_s;
        const TableOfContents toc = tocOfDevice(control.DeviceID()).toc;
        QString offsets;
        for (const TocTrack &track : toc.tracks)
            offsets += QString::number(track.offset) + u' ';
        return offsets + u"| "_s + QString::number(toc.leadOut);
    }
    DiscRecord known() const { return tocOfDevice(mControl->DeviceID()).known; }

private slots:
    void init()
    {
        ScreenTest::init();
        mFolder = std::make_unique<QTemporaryDir>();
        mScreen = new Form(u"screen"_s); // goes with all others
        mControl = std::make_unique<MMControl>(*mScreen);
    }

    void sheetWithItsImage()
    {
        write(u"Image.bin"_s, 600 * sector, {});
        const QString sheet = write(u"x.cue"_s, 0,
                                    "FILE \"C:\\discs\\IMAGE.BIN\" BINARY\nTRACK 01 AUDIO\n"
                                    "INDEX 01 0:0:0\nTRACK 02 AUDIO\nTITLE Two\nINDEX 01 0:4:0");
        QCOMPARE(open(sheet), u"150 450 | 750"_s);
        QCOMPARE(known().tracks[1].title, u"Two"_s);
        QVERIFY(!mScreen->isBusy());

        write(u"x.bin"_s, 0, {});
        QCOMPARE(open(path(u"x.bin"_s)), u"150 450 | 750"_s);
    }

    void sheetOfFilesThatWereRenamed()
    {
        const QByteArray one = "FILE a.wav WAVE\nTRACK 01 AUDIO\nINDEX 01 0:0:0\n";
        writeWave(u"x.wav"_s, 300);
        QCOMPARE(open(write(u"x.cue"_s, 0, one)), u"150 | 450"_s);
        const QByteArray two = one + "FILE b.wav WAVE\nTRACK 02 AUDIO\nINDEX 01 0:0:0\n";
        QCOMPARE(open(write(u"x.cue"_s, 0, two)), u"none"_s); // not the same one twice
        QVERIFY2(mControl->problem().endsWith(u": a.wav"_s), qPrintable(mControl->problem()));
    }

    void sheetAloneGivesItsWords()
    {
        const QByteArray table = "FILE gone.bin BINARY\nTRACK 01 AUDIO\nINDEX 01 0:0:0";
        QCOMPARE(open(write(u"a.cue"_s, 0, "TITLE Arrival\nPERFORMER Abba\n" + table)), u"| 0"_s);
        QCOMPARE(tocOfDevice(mControl->DeviceID()).words,
                 (SearchWords{u"Abba"_s, u"Arrival"_s, {}}));
        QCOMPARE(open(write(u"b.cue"_s, 0, table)), u"none"_s);
        QVERIFY2(mControl->problem().endsWith(u": gone.bin"_s), qPrintable(mControl->problem()));
    }

    void imageOfNero()
    {
        const QByteArray trailer = neroTrailer({300, 320, 340});
        const QString image = write(u"x.NRG"_s, 960 * sector, {}, trailer);
        QCOMPARE(open(image), u"150 450 770 | 1110"_s);

        QByteArray damaged = trailer;
        damaged[7] = 3; // the library ends its process
        QCOMPARE(open(write(u"y.nrg"_s, 960 * sector, {}, damaged)), u"none"_s);
        QVERIFY(mControl->problem().endsWith(path(u"y.nrg"_s)));
    }

    void deviceIsVoidAfterClose()
    {
        MMControl other(*mScreen);
        const QString image = write(u"x.nrg"_s, 300 * sector, {}, neroTrailer({300}));
        open(image);
        open(other, image);
        const int device = mControl->DeviceID();
        QVERIFY(device > 0 && device != other.DeviceID());
        mControl->Command(u"Close"_s);
        QCOMPARE(mControl->DeviceID(), 0);
        QCOMPARE(mControl->Tracks(), 0);
        QVERIFY(tocOfDevice(device).toc.tracks.empty());
        QVERIFY(!tocOfDevice(other.DeviceID()).toc.tracks.empty());
    }

    void folderOfSoundFiles()
    {
        writeWave(u"10 Tenth.wav"_s, 310);
        writeWave(u"2 Second.WAV"_s, 302);
        writeWave(u"1 - First.wav"_s, 301);
        write(u"cover.jpg"_s, 10, {});
        QCOMPARE(mkfifo(QFile::encodeName(path(u"pipe.wav"_s)), 0600), 0); // opening it would wait
        QCOMPARE(open(mFolder->path()), u"150 451 753 | 1063"_s);
        QCOMPARE(known().tracks[0].title + known().tracks[2].title, u"FirstTenth"_s);

        const QString broken = write(u"5.wav"_s, 10, {}); // without it, it would be another disc
        QCOMPARE(open(mFolder->path()), u"none"_s);
        QVERIFY2(mControl->problem().endsWith(broken), qPrintable(mControl->problem()));
    }

    void sheetOfFolderTellsMore()
    {
        writeWave(u"1.wav"_s, 301);
        write(u"disc.cue"_s, 0, "FILE 1.ape WAVE\nTRACK 01 AUDIO\nINDEX 00 0:0:0\nINDEX 01 0:1:0");
        QCOMPARE(open(mFolder->path()), u"225 | 451"_s);
    }

    void noDisc_data()
    {
        // problem: the key of its text; "*": a file of the folder
        const DataRows<QString, QString> row("name", "problem");
        row("no drive", "0", "");
        row("nothing chosen", "", "");
        row("no such drive", "/dev/nodrive", "");
        row("no drive but a device", "/dev/null", "");
        row("no such image", "*gone.nrg", "xDiscFileUnreadable");
        row("no such sheet", "*gone.cue", "xDiscFileUnreadable");
        row("image of data", "*data.iso", "xDiscNoTable");
        row("image without a sheet", "*alone.bin", "xDiscNoSheet");
        row("empty folder", "*", "xDiscNoSound");
    }
    void noDisc()
    {
        QFETCH(QString, name);
        QFETCH(QString, problem);
        for (const QString &image : {u"alone.bin"_s, u"data.iso"_s})
            write(image, sector, {});
        name.replace(u"*"_s, mFolder->path() + u'/');
        QCOMPARE(open(name), u"none"_s);
        if (!problem.isEmpty())
            problem = GetMessage(problem.toLatin1().constData()) + name;
        QCOMPARE(mControl->problem(), problem);
        QVERIFY(!mControl->wasCancelled());
    }

    void readerThatFails_data()
    {
        const DataRows<QByteArray, QString> row("lines", "table");
        row("crash", "echo track 1 150 audio; kill -SEGV $$", "none");
        row("crash behind the table",
            "printf 'track 1 150 audio\\nleadout 450\\nend\\ntext 1 title A\\n'; kill -SEGV $$",
            "150 | 450");
        row("silence", "echo track 1 150 audio; exec sleep 60", "none");
        row("no end", "printf 'track 1 150 audio\\nleadout 450\\n'", "none");
        row("nonsense", "printf 'track 1 150 audio\\nhello\\nleadout 450\\nend\\n'", "none");
        row("no table", "printf 'track 1 450 audio\\ntrack 2 150 audio\\nleadout 900\\nend\\n'",
            "none");
        row("numbers missing",
            "printf 'track 1 150 audio\\ntrack 3 450 audio\\nleadout 900\\nend\\n'", "none");
        row("lines without end", "while echo track 1 150 audio; do :; done", "none");
        row("gone", "", "none");
    }
    void readerThatFails()
    {
        QFETCH(QByteArray, lines);
        mControl->reader = lines.isEmpty() ? path(u"gone"_s) : script(lines);
        mControl->patience = 1;
        QTEST(open(u"/dev/sr0"_s), "table");
        QCOMPARE(mControl->problem().endsWith(mControl->reader), lines.isEmpty());
    }

    void userCancels()
    {
        mControl->reader = script("exec sleep 60");
        QTimer::singleShot(0, mScreen, [] { LongWork::cancelAll(); });
        QCOMPARE(open(u"/dev/sr0"_s), u"none"_s);
        QVERIFY(mControl->wasCancelled() && mControl->problem().isEmpty());
    }

    void drivesOfTheSystem()
    {
        QCOMPARE(
            drivesIn("CD-ROM information\n\ndrive name:\t\tsr1\tsr0\ndrive speed:\t\t48\t24\n"),
            texts("sr0", "sr1"));
        QCOMPARE(drivesIn("drive name:\n"), QStringList());
    }
};

QTEST_MAIN(tst_MMControl)
#include "tst_MMControl.moc"
