// Label: unit
#include "platform/error/error.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"
#include "tags/CddbID3Tag.h"

#include <QTemporaryDir>
#include <sys/stat.h>

namespace
{

QByteArray bigEndian(qsizetype number, int bits)
{
    QByteArray bytes;
    for (int shift = 3 * bits; shift >= 0; shift -= bits)
        bytes.append(char((number >> shift) & ((1 << bits) - 1)));
    return bytes;
}

// A frame of version 2.3.
QByteArray frame(const char *id, const QByteArray &content)
{
    return id + bigEndian(content.size(), 8) + QByteArray(2, '\0') + content;
}

QByteArray text(const char *id, const QByteArray &latin1)
{
    return frame(id, '\0' + latin1);
}

QByteArray comment(const QByteArray &description, const QByteArray &content)
{
    return frame("COMM", "\0eng"_ba + description + '\0' + content);
}

QByteArray fileId(const QByteArray &owner, const QByteArray &data)
{
    return frame("UFID", owner + '\0' + data);
}

QByteArray tagOf(const QByteArray &frames, char version = 3)
{
    return "ID3"_ba + version + QByteArray(2, '\0') + bigEndian(frames.size(), 7) + frames;
}

const QByteArray sound = "\xFF\xFB\x90\x64"_ba + QByteArray(413, '\0');

} // namespace

/// The fields of a tag, read from files that are made byte by byte.
class tst_CddbID3Tag : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir mFolder;

    CddbID3Tag read(const QByteArray &bytes)
    {
        CddbID3Tag tag;
        tag.setAlbum(u"from before"_s);
        tag.LoadFromFile(writeFile(mFolder.filePath(u"a.mp3"_s), bytes), 1);
        return tag;
    }

private slots:
    void fields_data()
    {
        const DataRows<QByteArray, int, QString> row("frames", "field", "value");
        const int genre = int(TagField::Genre), comments = int(TagField::Comments);
        row("filled up", text("TALB", "Best  \0\0"_ba), int(TagField::Album), "Best");
        row("zeros", text("TRCK", "03/09"), int(TagField::TrackPosition), "3/9");
        row("a zero alone", text("TPOS", "0/2"), int(TagField::PartOfSet), "0/2");
        row("date", text("TYER", "1985-05-13"), int(TagField::Year), "1985");
        row("genre number", text("TCON", "(17)"), genre, "Rock");
        row("bare number", text("TCON", "17"), genre, "Rock");
        row("refined", text("TCON", "(17)Hard rock"), genre, "Rock/Hard rock");
        row("words", text("TCON", "Liedjes"), genre, "Liedjes");
        row("described last", comment("iTunNORM", "00 1F") + comment("", "mine"), comments, "mine");
        row("described alone", comment("about", "this"), comments, "this");
        row("other's id", fileId("http://x", "ab"), int(TagField::FileId), "http://x=6162");
        row("own id first", fileId("http://x", "ab") + fileId(ownFileIdOwner, "\x01"),
            int(TagField::FileId), "songcase=01");
    }

    void fields()
    {
        QFETCH(QByteArray, frames);
        QFETCH(int, field);
        QFETCH(QString, value);
        CddbID3Tag expected;
        expected.setField(TagField(field), value);
        const CddbID3Tag got = read(tagOf(frames) + sound);
        QCOMPARE(got.field(TagField(field)), value);
        QVERIFY(got == expected); // and nothing else
    }

    void noTag_data()
    {
        const DataRows<QByteArray> row("bytes");
        row("nothing", "");
        row("sound alone", sound);
        row("ID3v1 alone", sound + QByteArray("TAGTitle").leftJustified(128, '\0'));
        row("a size that lies", "ID3\x03\0\0\x7F\x7F\x7F\x7F"_ba + text("TALB", "x").left(6));
        row("frame cut off", tagOf(text("TALB", "Best").left(9)));
    }

    void noTag()
    {
        QFETCH(QByteArray, bytes);
        QVERIFY(read(bytes) == CddbID3Tag());
    }

    void whatIsNoFile()
    {
        CddbID3Tag tag;
        QVERIFY(QDir(mFolder.path()).mkdir(u"folder.mp3"_s));
        const QString pipe = mFolder.filePath(u"pipe.mp3"_s);
        QCOMPARE(mkfifo(pipe.toLocal8Bit().constData(), 0600), 0);
        for (const QString &name : {mFolder.filePath(u"none.mp3"_s),
                                    mFolder.filePath(u"folder.mp3"_s), pipe, u"/dev/zero"_s})
            QCOMPARE(numberOf([&] { tag.LoadFromFile(name, 1); }), int(errCannotUse));
    }
};

QTEST_APPLESS_MAIN(tst_CddbID3Tag)
#include "tst_CddbID3Tag.moc"
