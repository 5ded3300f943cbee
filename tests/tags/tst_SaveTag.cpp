// Label: unit
#include "platform/files/nativename.h"
#include "support/datarows.h"
#include "support/madetag.h"
#include "support/testcatalogue.h"
#include "tags/filechanges.h"
#include "tags/tagerrors.h"
#include "tags/taglayout.h"

#include <QTemporaryDir>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace
{

// Something that a reader could take for the beginning of sound, and an ID3v1 tag.
const QByteArray sound = "\xFF\xFB\x90\x64"_ba + QByteArray(5000, '\xAA') +
                         QByteArray("TAGTitle").leftJustified(128, '\0');
const QByteArray picture = "\0image/png\0\3\0\xFF\xE0\xFF\0\xFF"_ba + QByteArray(300, '\x7E');

QByteArray unsynchronisedTag(const QByteArray &frames)
{
    return tagOf(unsynchronised(frames), 3, 20, char(0x80));
}

QByteArray withFooter(const QByteArray &frames)
{
    const QByteArray tag = tagOf(frames, 4, 0, 0x10);
    return tag + "3DI" + tag.mid(3, 7);
}

QByteArray extended(const QByteArray &header, const QByteArray &frames, int version)
{
    return tagOf(header + frames, version, 30, 0x40);
}

ino_t inodeOf(const QString &path)
{
    return ino_t(stampOf(path).inode);
}

} // namespace

/// What saving a tag leaves of a file.
class tst_SaveTag : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir mFolder;
    std::unique_ptr<FileJournal> mJournal;

    QString file(const QByteArray &bytes) { return writeFile(mFolder.filePath(u"a.mp3"_s), bytes); }
    QByteArray read(const QString &path) { return readFile(path); }

    void save(const QString &path, TagField field, const QString &text)
    {
        CddbID3Tag tag;
        tag.LoadFromFile(path, 1);
        tag.setField(field, text);
        FileChanges(*mJournal, {}).saveTag(tag, path);
    }

private slots:
    void init()
    {
        QDir(mFolder.filePath(u"Changes"_s)).removeRecursively();
        mJournal = std::make_unique<FileJournal>(mFolder.filePath(u"Changes"_s));
    }

    void frames_data()
    {
        // One field of a tag that holds `before` in version `version` becomes `text`: then it holds
        // `after`.
        const DataRows<int, QByteArray, int, QString, QByteArray> row("version", "before", "field",
                                                                      "text", "after");
        const int title = int(TagField::Title), year = int(TagField::Year),
                  comment = int(TagField::Comments), id = int(TagField::FileId),
                  genre = int(TagField::Genre);
        const QByteArray other = frame("APIC", picture) + frame("XYZW", "\1\2\3"_ba);
        row("in its place", 3, textFrame("TIT2", "Old") + other, title, u"New"_s,
            textFrame("TIT2", "New") + other);
        row("behind the others", 3, other, title, u"New"_s, other + textFrame("TIT2", "New"));
        row("taken away", 3, textFrame("TIT2", "Old") + other, title, u""_s, other);
        row("a blank", 3, textFrame("TIT2", "Old") + other, title, u" "_s,
            textFrame("TIT2", " ") + other);
        row("Latin-1", 3, textFrame("TIT2", "x"), title, u"é"_s, textFrame("TIT2", "\xE9"));
        row("UTF-16", 3, textFrame("TIT2", "x"), title, u"€"_s,
            frame("TIT2", "\1\xFF\xFE\xAC\x20"_ba));
        row("UTF-8", 4, textFrame("TIT2", "x", 4), title, u"é"_s,
            frame("TIT2", "\3\xC3\xA9"_ba, 4));
        row("three letters", 2, textFrame("TT2", "x", 2) + frame("PIC", picture, 2), title, u"y"_s,
            textFrame("TT2", "y", 2) + frame("PIC", picture, 2));
        row("year", 3, textFrame("TYER", "1984"), year, u"1985"_s, textFrame("TYER", "1985"));
        row("date", 4, textFrame("TDRC", "1984-05-01", 4) + textFrame("TYER", "1984", 4), year,
            u"1985"_s, textFrame("TDRC", "1985", 4));
        row("the same year of a date", 4, textFrame("TDRC", "1984-05-01", 4), year, u"1984"_s,
            textFrame("TDRC", "1984-05-01", 4));
        row("genre", 3, textFrame("TCON", "(17)"), genre, u"(18)Folk"_s,
            textFrame("TCON", "Techno/Folk"));
        row("described comment", 3, commentFrame("iTunNORM", "00"), comment, u"mine"_s,
            commentFrame("iTunNORM", "00") + commentFrame("", "mine"));
        row("no comment but a described one", 3, commentFrame("iTunNORM", "00"), comment, u""_s,
            commentFrame("iTunNORM", "00") + commentFrame("", ""));
        row("own id", 3, fileIdFrame("http://x", "ab"), id, u"songcase=0102"_s,
            fileIdFrame("http://x", "ab") + fileIdFrame("songcase", "\1\2"));
        row("foreign id", 3, fileIdFrame("http://x", "ab"), id, u"http://y=01"_s,
            fileIdFrame("http://x", "ab"));
        row("own id taken away", 3, fileIdFrame("songcase", "ab"), id, u""_s, "");
    }

    void frames()
    {
        QFETCH(int, version);
        QFETCH(QByteArray, before);
        QFETCH(QByteArray, after);
        QFETCH(int, field);
        QFETCH(QString, text);
        constexpr qsizetype room = 200;
        const QString path = file(tagOf(before, version, room) + sound);
        const ino_t inode = inodeOf(path);
        save(path, TagField(field), text);
        QCOMPARE(read(path), tagOf(after, version, room + before.size() - after.size()) + sound);
        QCOMPARE(inodeOf(path), inode);
    }

    void kindsOfTags_data()
    {
        const DataRows<QByteArray, QByteArray> row("before", "start");
        const QByteArray title = textFrame("TIT2", "Old"), other = frame("APIC", picture);
        row("none", "", "ID3\3\0\0"_ba);
        row("unsynchronised", unsynchronisedTag(title + other), "ID3\3\0\x80"_ba);
        row("footer", withFooter(textFrame("TIT2", "Old", 4) + frame("APIC", picture, 4)),
            "ID3\4\0\x10"_ba);
        row("extended header with a checksum",
            extended("\0\0\0\x0A\x80\0\0\0\0\x1E\1\2\3\4"_ba, title + other, 3), "ID3\3\0\0"_ba);
        row("extended header of 2.4",
            extended("\0\0\0\x0E\1\x30\5\1\1\1\1\1\1\x40"_ba,
                     textFrame("TIT2", "Old", 4) + frame("APIC", picture, 4), 4),
            "ID3\4\0\x40"_ba);
        row("sizes of another version",
            tagOf(frame("APIC", picture) + textFrame("TIT2", "Old"), 4, 30), "ID3\4\0\0"_ba);
    }

    // One byte more, and more than there is room for; the rest of the file stays, and undo brings
    // all of it back.
    void kindsOfTags()
    {
        QFETCH(QByteArray, before);
        QFETCH(QByteArray, start);
        for (const QString &text : {u"Older"_s, QString(6000, u'ÿ')}) {
            const QString path = file(before + sound);
            save(path, TagField::Title, text);
            const QByteArray after = read(path);
            QVERIFY(after.startsWith(start));
            QVERIFY(after.endsWith(sound));
            const QByteArray tag = after.chopped(sound.size());
            const TagLayout layout = layoutOf(tag);
            if (!before.isEmpty()) {
                QCOMPARE(layout.frames.size(), 2U);
                const bool isFirst = layout.frames[0].id == "APIC";
                QCOMPARE(layout.contentOf(tag, layout.frames[isFirst ? 0 : 1]), picture);
            }
            CddbID3Tag read;
            read.LoadFromFile(path, 1);
            QCOMPARE(read.Title(), text);
            mJournal->undo(mJournal->batches().front().number, {}, {},
                           [](int, int) { return true; });
            QCOMPARE(readFile(path), before + sound);
        }
    }

    void damaged_data()
    {
        const DataRows<QByteArray> row("tag");
        row("frame cut off", tagOf(textFrame("TIT2", "Long title").chopped(3)));
        row("no name of a frame", tagOf(textFrame("TIT2", "x") + "tit2\0\0\0\2\0\0\0x"_ba));
        row("frame without content", tagOf(frame("TIT2", "") + textFrame("TALB", "x")));
        row("something behind the frames", tagOf(textFrame("TIT2", "x") + "\0\0\0x"_ba));
        row("longer than the file", "ID3\3\0\0\0\x7F\x7F\x7F"_ba + textFrame("TIT2", "x"));
        row("not at the beginning", "RIFF"_ba + tagOf(textFrame("TIT2", "x"), 3, 10));
        row("compressed as a whole", tagOf(textFrame("TT2", "x", 2), 2, 10, 0x40));
    }

    void damaged()
    {
        QFETCH(QByteArray, tag);
        const QString path = file(tag + sound);
        QCOMPARE(numberOf([&] { save(path, TagField::Title, u"New"_s); }), int(errTagDamaged));
        QCOMPARE(read(path), tag + sound);
        QCOMPARE(QDir(mFolder.path()).entryList({u".song*"_s}, QDir::Files | QDir::Hidden),
                 QStringList());
    }

    // A title of this length; 0: it fits.
    void whatIsNotContent_data()
    {
        const DataRows<int> row("letters");
        row("in place", 5);
        row("beside", 5000);
    }

    void whatIsNotContent()
    {
        QFETCH(int, letters);
        const QString path = file(tagOf(textFrame("TIT2", "Old"), 3, 100) + sound);
        const QByteArray name = nativeName(path);
        QCOMPARE(chmod(name.constData(), 0640), 0);
        const timespec times[] = {{1000, 7}, {2000, 0}};
        QCOMPARE(utimensat(AT_FDCWD, name.constData(), times, 0), 0);
        const bool hasAttributes = setxattr(name.constData(), "user.note", "abc", 3, 0) == 0;
        const QString link = mFolder.filePath(u"link.mp3"_s);
        QFile::remove(link);
        QVERIFY(QFile::link(path, link));
        save(link, TagField::Title, QString(letters, u'x'));
        struct stat about = {};
        QCOMPARE(lstat(name.constData(), &about), 0);
        QVERIFY(QFileInfo(link).isSymLink() && S_ISREG(about.st_mode));
        QCOMPARE(about.st_mode & 07777, mode_t(0640));
        QCOMPARE(about.st_atim.tv_sec, 1000);
        QVERIFY(about.st_mtim.tv_sec > 2000);
        char value[3];
        if (hasAttributes)
            QCOMPARE(getxattr(name.constData(), "user.note", value, sizeof value), 3);
    }

    void severalNamesStayOneFile()
    {
        const QString path = file(tagOf(textFrame("TIT2", "Old")) + sound);
        const QString other = mFolder.filePath(u"other.mp3"_s);
        QFile::remove(other);
        QCOMPARE(::link(nativeName(path).constData(), nativeName(other).constData()), 0);
        save(path, TagField::Title, QString(5000, u'x'));
        QCOMPARE(inodeOf(other), inodeOf(path));
        QVERIFY(read(other).contains(QByteArray(5000, 'x')) && read(other).endsWith(sound));
        QCOMPARE(QDir(mFolder.filePath(u"Changes"_s)).entryList({u"copy*"_s}), QStringList());
    }

    void aNameThatIsNoUnicode()
    {
        const QByteArray name = nativeName(file(tagOf(textFrame("TIT2", "Old")) + sound)),
                         other = name + '\xE9';
        QCOMPARE(::rename(name.constData(), other.constData()), 0);
        save(nameOfNative(other), TagField::Title, QString(5000, u'x'));
        QCOMPARE(::rename(other.constData(), name.constData()), 0);
        QVERIFY(read(nameOfNative(name)).contains(QByteArray(5000, 'x')));
    }

    void notAccessible()
    {
        const QString path = file(sound);
        const auto number = [&](const QString &name) {
            return numberOf([&] { FileChanges(*mJournal, {}).saveTag(CddbID3Tag(), name); });
        };
        QVERIFY(QFile::setPermissions(path, QFile::ReadOwner));
        QCOMPARE(number(path), int(errTagNotAccessible)); // for root as well
        QFile::remove(path);
        QCOMPARE(number(path), int(errTagNotAccessible));
        QCOMPARE(number(mFolder.path()), int(errTagNotAccessible));
        QVERIFY(!QFile::exists(mFolder.filePath(u"Changes"_s)));
    }

    void aFolderThatLetsOthersIn()
    {
        // The owner, one of the others by name, the group, the mask, all others.
        const QByteArray list = "\2\0\0\0\1\0\7\0\xFF\xFF\xFF\xFF\2\0\7\0\xFE\xFF\0\0"
                                "\4\0\5\0\xFF\xFF\xFF\xFF\x10\0\7\0\xFF\xFF\xFF\xFF"
                                "\x20\0\5\0\xFF\xFF\xFF\xFF"_ba;
        const QByteArray name = nativeName(file(tagOf(textFrame("TIT2", "Old")) + sound));
        QCOMPARE(chmod(name.constData(), 0660), 0);
        if (setxattr(nativeName(mFolder.path()).constData(), "system.posix_acl_default",
                     list.constData(), size_t(list.size()), 0) != 0)
            QSKIP("no access lists here");
        save(nameOfNative(name), TagField::Title, QString(5000, u'x'));
        QCOMPARE(getxattr(name.constData(), "system.posix_acl_access", nullptr, 0), -1);
        removexattr(nativeName(mFolder.path()).constData(), "system.posix_acl_default");
    }
};

QTEST_APPLESS_MAIN(tst_SaveTag)
#include "tst_SaveTag.moc"
