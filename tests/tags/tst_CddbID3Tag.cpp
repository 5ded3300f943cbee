// Label: unit
#include "platform/error/error.h"
#include "support/datarows.h"
#include "support/madetag.h"
#include "support/testcatalogue.h"
#include "tags/CddbID3Tag.h"

#include <QTemporaryDir>
#include <sys/stat.h>

namespace
{

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
        row("filled up", textFrame("TALB", "Best  \0\0"_ba), int(TagField::Album), "Best");
        row("zeros", textFrame("TRCK", "03/09"), int(TagField::TrackPosition), "3/9");
        row("a zero alone", textFrame("TPOS", "0/2"), int(TagField::PartOfSet), "0/2");
        row("date", textFrame("TYER", "1985-05-13"), int(TagField::Year), "1985");
        row("genre number", textFrame("TCON", "(17)"), genre, "Rock");
        row("bare number", textFrame("TCON", "17"), genre, "Rock");
        row("refined", textFrame("TCON", "(17)Hard rock"), genre, "Rock/Hard rock");
        row("words", textFrame("TCON", "Liedjes"), genre, "Liedjes");
        row("described last", commentFrame("iTunNORM", "00 1F") + commentFrame("", "mine"),
            comments, "mine");
        row("described alone", commentFrame("about", "this"), comments, "this");
        row("other's id", fileIdFrame("http://x", "ab"), int(TagField::FileId), "http://x=6162");
        row("of both versions", frame("TIT2", QByteArray("\1\xFF\xFE\xE9\0,\0\xAC\x20", 9)),
            int(TagField::Title), u"é,€"_s);
        row("own id first", fileIdFrame("http://x", "ab") + fileIdFrame(ownFileIdOwner, "\x01"),
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
        row("a size that lies", "ID3\x03\0\0\x7F\x7F\x7F\x7F"_ba + textFrame("TALB", "x").left(6));
        row("frame cut off", tagOf(textFrame("TALB", "Best").left(9)));
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
            QCOMPARE(numberOf([&] { tag.LoadFromFile(name, 1); }), int(errFileFailed));
    }
};

QTEST_APPLESS_MAIN(tst_CddbID3Tag)
#include "tst_CddbID3Tag.moc"
