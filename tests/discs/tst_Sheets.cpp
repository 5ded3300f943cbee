// Label: unit
#include "discs/cuesheet.h"
#include "discs/opaquetoc.h"
#include "discs/tocsheet.h"
#include "support/datarows.h"

namespace
{

// "150 450D 750 | 1050": offsets, data tracks marked, and the lead-out; "-" for no disc.
QString tableOf(const std::optional<DiscSheet> &sheet)
{
    if (!sheet || sheet->toc.tracks.empty())
        return sheet ? u"missing "_s + sheet->missing : u"-"_s;
    QStringList words;
    for (const TocTrack &track : sheet->toc.tracks)
        words.append(QString::number(track.offset) + (track.isData ? u"D"_s : QString()));
    return words.join(u' ') + u" | "_s + QString::number(sheet->toc.leadOut);
}

// "long.bin" holds 1000 frames, "odd.bin" as many sectors of 2048 bytes, the sound files 300
// frames.
std::optional<qint64> lengthOf(const QString &name, LengthIn unit)
{
    if (unit == LengthIn::Frames)
        return name.endsWith(u".wav") ? std::optional<qint64>(300) : std::nullopt;
    if (name == u"long.bin")
        return 1000 * 2352;
    return name == u"odd.bin" ? std::optional<qint64>(1000 * 2048) : std::nullopt;
}

const QByteArray image = "FILE \"long.bin\" BINARY\n";
const QByteArray first = "TRACK 01 AUDIO\nINDEX 01 00:00:00\n";

QByteArray toc(const QByteArray &tracks)
{
    return "CD_DA\n" + tracks;
}

} // namespace

/// The sheets of disc images: the table of contents, and what they say of the disc.
class tst_Sheets : public QObject
{
    Q_OBJECT

private slots:
    void cueTable_data()
    {
        const DataRows<QByteArray, QString> row("sheet", "table");
        row("one image", image + first + "TRACK 02 AUDIO\nINDEX 00 00:03:00\nINDEX 01 00:04:00",
            "150 450 | 1150");
        row("hidden sound", image + "TRACK 01 AUDIO\nINDEX 00 0:0:0\nINDEX 01 00:02:25",
            "325 | 1150");
        row("old line ends, tabs, small letters",
            "file long.bin binary\r\ttrack 1 audio\r\n\tindex 01\t00:00:00\r", "150 | 1150");
        row("no type, a blank in the name", "FILE \"a b.bin\"\n" + first, "missing a b.bin");
        row("files of sound",
            "FILE \"a.wav\" WAVE\n" + first + "FILE \"b.wav\" WAVE\nTRACK 02 AUDIO\nINDEX 01 0:0:0",
            "150 450 | 750");
        row("gap in the file before",
            "FILE a.wav WAVE\n" + first +
                "TRACK 02 AUDIO\nINDEX 00 0:3:0\nFILE b.wav WAVE\nINDEX 01 0:0:0",
            "150 450 | 750");
        row("silence that stands in no file",
            image + "TRACK 01 AUDIO\nPREGAP 00:00:32\nINDEX 01 0:0:0\nPOSTGAP 0:1:0\n"
                    "TRACK 02 AUDIO\nPREGAP 0:2:0\nINDEX 01 0:4:0\n",
            "182 707 | 1407");
        row("data of 2048 bytes before sound",
            "FILE odd.bin BINARY\nTRACK 01 MODE1/2048\nINDEX 01 0:0:0\n"
            "TRACK 02 AUDIO\nINDEX 00 0:2:0\nINDEX 01 0:4:0",
            "150D 450 | 1040");
        row("second session",
            "FILE a.wav WAVE\n" + first + "REM SESSION 02\n" + image +
                "TRACK 02 MODE2/2352\nINDEX 01 0:0:0",
            "150 11850D | 12850");
        row("first track has another number", image + "TRACK 05 AUDIO\nINDEX 01 0:0:0\n",
            "150 | 1150");
        row("image shorter than the tracks", image + first + "TRACK 02 AUDIO\nINDEX 01 00:20:00",
            "-");
        row("no sound", image + "TRACK 01 MODE1/2352\nINDEX 01 0:0:0", "-");
        row("track left out", image + first + "TRACK 03 AUDIO\nINDEX 01 0:4:0", "-");
        row("track without a start", image + first + "TRACK 02 AUDIO\nINDEX 00 0:4:0", "-");
        row("no such time", image + "TRACK 01 AUDIO\nINDEX 01 00:60:00", "-");
        row("sectors of no size", image + "TRACK 01 MODE1/0000\nINDEX 01 0:0:0\n" + first, "-");
        row("backwards", image + "TRACK 01 AUDIO\nINDEX 01 0:5:0\nTRACK 02 AUDIO\nINDEX 01 0:4:0",
            "-");
        row("empty", "", "-");
    }
    void cueTable()
    {
        QFETCH(QByteArray, sheet);
        QTEST(tableOf(readCueSheet(sheet, lengthOf)), "table");
    }

    void cueTexts()
    {
        const QByteArray sheet =
            "REM GENRE \"Alternative Rock\"\nREM DATE 1999-05-31\nREM DISCNUMBER 2\n"
            "CATALOG 0724384260958\nPERFORMER \"Björk\"\nTITLE \"12\" Mixes\"\n" +
            image + "TRACK 01 AUDIO\nTITLE Jóga\nPERFORMER \"Björk\tfeat. X\"\n" + "INDEX 01 0:0:0";
        const auto known = readCueSheet(sheet, lengthOf).value().known;
        QCOMPARE(QStringList({known.genre, known.year, known.numberInSet, known.barcode}),
                 texts("Alternative Rock", "1999", "2", "0724384260958"));
        QCOMPARE(QStringList({known.artist.name, known.title}), texts("Björk", "12\" Mixes"));
        QCOMPARE(QStringList({known.tracks[0].title, known.tracks[0].artist.name}),
                 texts("Jóga", "Björk feat. X"));
        QCOMPARE(known.tracks[0].length, 13333);
        QVERIFY(!known.isCompilation);
    }

    void cueEncodings()
    {
        const QString sheet = u"\uFEFFTITLE \"Café\"\n"_s + QString::fromLatin1(image + first);
        for (const auto encoding :
             {QStringEncoder::Utf8, QStringEncoder::Latin1, QStringEncoder::Utf16LE}) {
            const QByteArray bytes =
                QStringEncoder(encoding).encode(sheet.mid(encoding == QStringEncoder::Latin1));
            QCOMPARE(readCueSheet(bytes, lengthOf).value().known.title, u"Café"_s);
        }
    }

    void compilations_data()
    {
        const DataRows<QString, bool> row("artist", "isCompilation"); // of the disc
        row("nobody", "", true);
        row("Various Artists", true);
        row("Abba", false);
    }
    void compilations()
    {
        QFETCH(QString, artist);
        const QByteArray sheet = "PERFORMER \"" + artist.toUtf8() + "\"\n" + image +
                                 "TRACK 01 AUDIO\nPERFORMER Abba\nINDEX 01 0:0:0\n"
                                 "TRACK 02 AUDIO\nPERFORMER Blur\nINDEX 01 0:4:0";
        const DiscRecord known = readCueSheet(sheet, lengthOf).value().known;
        QTEST(known.isCompilation, "isCompilation");
        QCOMPARE(known.tracks[1].artist.name, u"Blur"_s);
    }

    void tocTable_data()
    {
        const DataRows<QByteArray, QString> row("sheet", "table");
        row("times",
            "TRACK AUDIO\nNO COPY\nFILE \"x\" 0 00:04:00\n// Track 2\nTRACK AUDIO\n"
            "FILE \"x\" 00:04:00 00:04:00 // TRACK AUDIO",
            "150 450 | 750");
        row("samples, rounded up", "TRACK AUDIO FILE \"x\" 0 58801", "150 | 251");
        row("to the end of an image", "TRACK AUDIO AUDIOFILE \"long.bin\" SWAP #2352 00:01:00",
            "150 | 1074");
        row("to the end of a sound file", "TRACK AUDIO FILE \"a.wav\" 588 0", "150 | 449");
        row("gaps",
            "TRACK AUDIO SILENCE 00:00:10 START FILE \"x\" 0 00:04:00 TRACK AUDIO FILE "
            "\"x\" 0 00:04:00 START 00:01:00 TRACK AUDIO PREGAP 0:2:0 FILE \"x\" 0 0:4:0",
            "160 535 910 | 1210");
        row("data",
            "TRACK MODE1 ZERO MODE1 0:2:0 START 0:2:0 DATAFILE \"odd.bin\" TRACK AUDIO "
            "ZERO AUDIO RW_RAW 588 FILE \"x\" 0 0:4:0",
            "300D 1300 | 1601");
        row("file that is not there", "TRACK AUDIO FILE \"gone.bin\" 0", "missing gone.bin");
        row("start behind the end", "TRACK AUDIO FILE \"x\" 0 0:4:0 START 0:5:0", "-");
        row("a number too large", "TRACK AUDIO FILE \"x\" 0 99999999999999999999", "-");
        row("a kind that is none", "TRACK PICTURE DATAFILE \"odd.bin\"", "-");
        row("empty", "", "-");
    }
    void tocTable()
    {
        QFETCH(QByteArray, sheet);
        QTEST(tableOf(readTocSheet(toc(sheet), lengthOf)), "table");
    }

    void tocTexts()
    {
        const auto known =
            readTocSheet(toc("CATALOG \"0724384260958\" CD_TEXT { LANGUAGE_MAP { 0 : EN 1:NL }\n"
                             "LANGUAGE 0 { TITLE \"Caf\\351 \\\"12\\\"\" PERFORMER \"Nobody\" "
                             "SIZE_INFO { 1, 2, 3 } }\nLANGUAGE 1 { TITLE \"Niet\" } }\n"
                             "TRACK AUDIO CD_TEXT { LANGUAGE 0 { TITLE \"One\" } }\n"
                             "FILE \"x\" 0 00:04:00"),
                         lengthOf)
                .value()
                .known;
        QCOMPARE(
            QStringList({known.title, known.artist.name, known.tracks[0].title, known.barcode}),
            texts("Café \"12\"", "Nobody", "One", "0724384260958"));
    }
};

QTEST_APPLESS_MAIN(tst_Sheets)
#include "tst_Sheets.moc"
