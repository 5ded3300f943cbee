// Label: unit
#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "support/datarows.h"
#include "support/diskfaults.h"
#include "support/madetag.h"
#include "support/testcatalogue.h"
#include "tags/filechanges.h"
#include "tags/movedfile.h"
#include "tags/tagerrors.h"

#include <QTemporaryDir>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

const QByteArray sound = "\xFF\xFB\x90\x64"_ba + QByteArray(9000, '\xAA');
const QByteArray before =
    tagOf(textFrame("TIT2", "Old") + textFrame("TALB", "Album"), 3, 900) + sound;

const auto always = [](int, int) { return true; };

} // namespace

/// The journal of changed files: what it takes back, and what it makes of a disk that fails and of
/// a process that ends at any call.
class tst_FileJournal : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<QTemporaryDir> mFolder;
    std::unique_ptr<FileJournal> mJournal;

    QString path(const QString &name) const { return mFolder->filePath(name); }
    void reopen(JournalSizes sizes = {})
    {
        mJournal = std::make_unique<FileJournal>(path(u"Changes"_s), sizes);
    }
    QString make(const QString &name) { return writeFile(path(name), before); }
    QString title(const QString &name) const
    {
        CddbID3Tag tag;
        tag.LoadFromFile(path(name), 1);
        return tag.Title();
    }
    static CddbID3Tag tagWith(const QString &title)
    {
        CddbID3Tag tag;
        tag.setAlbum(u"Album"_s);
        tag.setTitle(title);
        return tag;
    }
    void link(const QString &name, const QString &other) const
    {
        QCOMPARE(::link(path(name).toUtf8().constData(), path(other).toUtf8().constData()), 0);
    }
    void save(const QString &name, const QString &title)
    {
        FileChanges(*mJournal, {{}, title, {}}).saveTag(tagWith(title), path(name));
    }
    FileJournal::Undone undoLast()
    {
        return mJournal->undo(mJournal->batches().front().number, {}, u"undo"_s, always);
    }

private slots:
    void init()
    {
        mFolder = std::make_unique<QTemporaryDir>();
        qputenv("XDG_DATA_HOME", path(u"data"_s).toUtf8()); // wastebasket
        reopen();
    }

    void undoTakesBackABatch()
    {
        make(u"a"_s);
        make(u"b"_s);
        const QString longTitle(3000, u'x');
        {
            FileChanges changes(*mJournal,
                                {QDateTime(QDate(2026, 1, 2), QTime()), u"Tags"_s, u"W"_s});
            changes.announce({{path(u"a"_s), tagWith(u"1"_s)}, {path(u"b"_s), tagWith(longTitle)}});
            changes.saveTag(tagWith(u"1"_s), path(u"a"_s));
            changes.saveTag(tagWith(longTitle), path(u"b"_s));
            changes.move(path(u"b"_s), path(u"c"_s));
        }
        reopen(); // another run
        const auto all = mJournal->batches();
        QCOMPARE(all.size(), 1U);
        QCOMPARE(all[0].files, 3);
        QCOMPARE(all[0].what + all[0].where + all[0].when.toString(Qt::ISODate),
                 u"TagsW2026-01-02T00:00:00"_s);
        QCOMPARE(title(u"c"_s), longTitle);
        QCOMPARE(undoLast().left, QStringList());
        QCOMPARE(readFile(path(u"a"_s)), before);
        QCOMPARE(readFile(path(u"b"_s)), before);
        QVERIFY(!QFile::exists(path(u"c"_s)));
        QVERIFY(mJournal->batches()[1].isTakenBack);
        QCOMPARE(undoLast().left, QStringList()); // takes the undo back
        QCOMPARE(title(u"c"_s), longTitle);
        QVERIFY(!mJournal->batches()[2].isTakenBack);
    }

    void undoFindsAFileThatWasRenamedSince_data()
    {
        const DataRows<QString> row("folder");
        row("as it is", "");
        row("through a link", "linked/");
    }
    void undoFindsAFileThatWasRenamedSince()
    {
        QFETCH(QString, folder);
        QVERIFY(QFile::link(mFolder->path(), path(u"linked"_s)));
        make(u"a"_s);
        save(folder + u'a', u"New"_s);
        const qint64 batch = mJournal->batches().front().number;
        FileChanges(*mJournal, {}).move(path(folder + u'a'), path(folder + u'b'));
        save(folder + u'b', QString(3000, u'x'));
        QCOMPARE(undoLast().files, 1);
        QCOMPARE(mJournal->undo(batch, {}, {}, always).files, 1);
        QCOMPARE(readFile(path(u"b"_s)), before);
        QCOMPARE(mJournal->undo(batch + 1, {}, {}, always).files, 1);
        QCOMPARE(readFile(path(u"a"_s)), before);
    }

    // As it is to the system, when its medium was taken out and came back.
    void undoFindsAFileWithAnotherNumber()
    {
        make(u"a"_s);
        FileChanges(*mJournal, {}).move(path(u"a"_s), path(u"b"_s));
        QFile copy(path(u"c"_s));
        QVERIFY(QFile::copy(path(u"b"_s), copy.fileName()) && copy.open(QIODevice::ReadWrite));
        struct stat about = {};
        QCOMPARE(::stat(path(u"b"_s).toUtf8().constData(), &about), 0);
        const timespec times[] = {about.st_atim, about.st_mtim};
        QCOMPARE(::futimens(copy.handle(), times), 0);
        QVERIFY(QFile::remove(path(u"b"_s)) && copy.rename(path(u"b"_s)));
        QCOMPARE(undoLast().files, 1);
        QVERIFY(QFile::exists(path(u"a"_s)));
    }

    void whatChangedSinceIsLeft_data()
    {
        const DataRows<bool, QString> row("renamed", "since");
        row("gone", false, u"gone"_s);
        row("tag", false, u"tag"_s);
        row("longer", false, u"longer"_s);
        row("moved and gone", true, u"gone"_s);
        row("moved and another in its place", true, u"taken"_s);
    }

    void whatChangedSinceIsLeft()
    {
        QFETCH(bool, renamed);
        QFETCH(QString, since);
        make(u"a"_s);
        if (renamed)
            FileChanges(*mJournal, {}).move(path(u"a"_s), path(u"b"_s));
        else
            save(u"a"_s, u"New"_s);
        const QString now = path(renamed ? u"b"_s : u"a"_s);
        if (since == "gone"_L1)
            QVERIFY(QFile::remove(now));
        else if (since == "taken"_L1)
            make(u"a"_s);
        else
            writeFile(now, since == "tag"_L1 ? QByteArray(before).replace("Album", "ALBUM")
                                             : readFile(now) + "x"_ba);
        const QByteArray left = QFile::exists(now) ? readFile(now) : QByteArray();
        const auto undone = undoLast();
        QCOMPARE(undone.files, 0);
        QCOMPARE(undone.left.size(), 1);
        QVERIFY(undone.left.front().startsWith(now + u": "_s));
        QCOMPARE(QFile::exists(now) ? readFile(now) : QByteArray(), left);
    }

    void aFileWrittenSinceItWasAnnounced()
    {
        make(u"a"_s);
        make(u"b"_s);
        FileChanges changes(*mJournal, {});
        changes.announce({{path(u"a"_s), tagWith(u"New"_s)}, {path(u"b"_s), tagWith(u"New"_s)}});
        const QByteArray other =
            tagOf(textFrame("TALB", "Album") + frame("XYZW", "kept"), 3, 50) + sound;
        writeFile(path(u"a"_s), other);
        changes.saveTag(tagWith(u"New"_s), path(u"a"_s));
        QVERIFY(readFile(path(u"a"_s)).contains("kept"));
        QCOMPARE(title(u"a"_s), u"New"_s);
    }

    // So that no more than a hundred stand in memory.
    void theNextAreAnnouncedAtTheirTurn()
    {
        FileChanges::Tags tags;
        for (int i = 0; i < 102; ++i) {
            const QString name = QString::number(i);
            tags.emplace_back(make(name), tagWith(i == 0 ? u"Old"_s : u"New"_s));
        }
        FileChanges changes(*mJournal, {});
        changes.announce(tags);
        const auto journal = [&] { return QFileInfo(path(u"Changes/changes-1"_s)).size(); };
        const qint64 size = journal();
        changes.saveTag(tags[0].second, tags[0].first); // says so already
        changes.saveTag(tags[1].second, tags[1].first);
        QCOMPARE(journal(), size);
        changes.saveTag(tags[101].second, tags[101].first);
        QVERIFY(journal() > size);
    }

    // Of three that were announced one was not come to.
    void anEndWithinABatch()
    {
        const auto change = [&] {
            FileChanges changes(*mJournal, {});
            const QString longTitle(3000, u'x');
            changes.announce({{path(u"a"_s), tagWith(u"New"_s)},
                              {path(u"b"_s), tagWith(longTitle)},
                              {path(u"c"_s), tagWith(u"New"_s)}});
            changes.saveTag(tagWith(u"New"_s), path(u"a"_s));
            changes.saveTag(tagWith(longTitle), path(u"b"_s));
            _exit(diskfaults::killed);
        };
        for (const QString &name : {u"a"_s, u"b"_s, u"c"_s})
            make(name);
        QVERIFY(killedIn(change, std::numeric_limits<int>::max()));
        reopen();
        mJournal->mend();
        QCOMPARE(mJournal->batches().front().files, 2);
        QCOMPARE(undoLast().left, QStringList());
        for (const QString &name : {u"a"_s, u"b"_s, u"c"_s})
            QCOMPARE(readFile(path(name)), before);
    }

    // One program ends in the middle of a batch, another one corrects what it has written.
    void whatOthersWroteAfterACrash_data()
    {
        const DataRows<bool> row("through");
        row("in place", false);
        row("through", true);
    }
    void whatOthersWroteAfterACrash()
    {
        QFETCH(bool, through);
        const QString wanted(through ? 2000 : 5, u'n');
        for (int call = 1; call < 40; ++call) {
            init();
            make(u"a"_s);
            make(u"b"_s);
            if (through)
                link(u"a"_s, u"link"_s);
            killedIn(
                [&] {
                    FileChanges changes(*mJournal, {});
                    changes.announce({{path(u"a"_s), tagWith(wanted)}, {path(u"b"_s), {}}});
                    changes.saveTag(tagWith(wanted), path(u"a"_s));
                    _exit(0);
                },
                call);
            QByteArray now = readFile(path(u"a"_s));
            if (through && now != before)
                continue;
            now.replace("Album", "Other").replace("nnnnn", "nnnnx");
            QFile file(path(u"a"_s));
            QVERIFY(file.open(QIODevice::ReadWrite) && file.write(now) == now.size());
            file.close();
            reopen();
            mJournal->mend();
            QCOMPARE(readFile(path(u"a"_s)), now);
        }
    }

    // The copy that a file goes through is then all that is left of the sound.
    void aFileThatIsHalfWritten_data()
    {
        const DataRows<QString, bool> row("since", "isMended");
        row("as it was left", "", true);
        row("the folder of the journal was moved", "moved", true);
        row("the journal was damaged", "flip", false);
        row("another program wrote a byte", "byte", false);
        row("another program made it longer", "longer", false);
        row("another name", "named", false);
    }
    void aFileThatIsHalfWritten()
    {
        QFETCH(QString, since);
        QFETCH(bool, isMended);
        const QByteArray rest = QByteArray::number(rand()).repeated(50000);
        const QString text(2000, u'n');
        const auto half = [&] { return readFile(path(u"a"_s)).endsWith(rest) ? 0 : 1; };
        for (int call = 1; call == 1 || !half(); ++call) {
            QVERIFY(call < 60);
            init();
            writeFile(path(u"a"_s), before + rest);
            link(u"a"_s, u"link"_s);
            killedIn([&] { save(u"a"_s, text); }, call);
        }
        QString changes = path(u"Changes"_s);
        if (since == "moved"_L1) {
            QVERIFY(QFile::rename(changes, path(u"Moved"_s)));
            changes = path(u"Moved"_s);
        } else if (since == "flip"_L1) {
            QByteArray bytes = readFile(changes + u"/changes-1"_s);
            bytes[bytes.lastIndexOf("SCJ1") + 40] ^= 1; // of what was begun
            writeFile(changes + u"/changes-1"_s, bytes);
        } else if (since == "named"_L1) {
            QVERIFY(QFile::rename(path(u"a"_s), path(u"b"_s)));
        } else if (!since.isEmpty()) {
            QFile file(path(u"a"_s));
            QVERIFY(file.open(QIODevice::ReadWrite));
            file.seek(since == "byte"_L1 ? 20 : file.size());
            file.write("x");
        }
        mJournal = std::make_unique<FileJournal>(changes);
        mJournal->mend();
        const auto copies = QDir(changes).entryList({u"copy*"_s});
        QCOMPARE(copies.size(), isMended ? 0 : 1);
        QCOMPARE(half() == 0 && title(u"a"_s) == text, isMended);
        if (!isMended && since != "flip"_L1 && since != "named"_L1)
            QCOMPARE(numberOf([&] { save(u"a"_s, u"Other"_s); }), int(errTagNotAccessible));
    }

    void oneFileTwiceInABatch()
    {
        make(u"a"_s);
        link(u"a"_s, u"link"_s);
        const auto change = [&] {
            FileChanges changes(*mJournal, {});
            changes.saveTag(tagWith(u"One"_s), path(u"a"_s));
            changes.saveTag(tagWith(u"Two"_s), path(u"link"_s));
            _exit(diskfaults::killed);
        };
        QVERIFY(killedIn(change, std::numeric_limits<int>::max()));
        reopen();
        mJournal->mend();
        QCOMPARE(title(u"a"_s), u"Two"_s);
        QCOMPARE(undoLast().files, 2);
        QCOMPARE(readFile(path(u"a"_s)), before);
    }

    void twoCommandsAtOnce()
    {
        FileChanges::Tags tags;
        for (const QString &name : {u"a"_s, u"b"_s, u"c"_s})
            tags.emplace_back(make(name), tagWith(QString(2000, u'n')));
        {
            FileChanges first(*mJournal, {{}, u"first"_s, {}});
            first.announce({tags[0], tags[1]});
            first.saveTag(tags[0].second, tags[0].first);
            save(u"c"_s, u"second"_s);
            first.saveTag(tags[1].second, tags[1].first);
        }
        const auto all = mJournal->batches();
        QCOMPARE(all.size(), 2U);
        QCOMPARE(all[0].what + QString::number(all[0].files), u"second1"_s);
        QCOMPARE(all[1].what + QString::number(all[1].files), u"first2"_s);
        QCOMPARE(mJournal->undo(all[1].number, {}, {}, always).left, QStringList());
        QCOMPARE(readFile(path(u"a"_s)) + readFile(path(u"b"_s)), before + before);
        // Another program's own changes are its own to mend.
        FileJournal other(path(u"Changes"_s));
        QCOMPARE(numberOf([&] { FileChanges(other, {}).saveTag(tagWith(u"x"_s), path(u"a"_s)); }),
                 int(errTagNotWritten));
    }

    // It takes the room of its own tags, and takes away no other batch.
    void aBatchThatIsLargerThanAPart()
    {
        reopen({3000, 60000});
        make(u"a"_s);
        save(u"a"_s, u"New"_s);
        FileChanges::Tags tags;
        for (int i = 0; i < 20; ++i)
            tags.emplace_back(make(QString::number(i)), tagWith(QString(2000, u'n')));
        {
            FileChanges changes(*mJournal, {});
            changes.announce(tags);
            for (const auto &[name, tag] : tags)
                changes.saveTag(tag, name);
        }
        qint64 size = 0;
        for (const QFileInfo &part : QDir(path(u"Changes"_s)).entryInfoList({u"changes*"_s}))
            size += part.size();
        QVERIFY2(size < 20 * 1500, qPrintable(QString::number(size)));
        QCOMPARE(undoLast().files, 20);
        QCOMPARE(mJournal->batches().back().files, 1);
    }

    void damageOfTheJournal_data()
    {
        const DataRows<QString, int> row("damage", "batches");
        row("flipped byte", "flip", 3);
        row("a part that cannot be read", "folder", 1);
        row("removed while in use", "gone", 1);
    }
    void damageOfTheJournal()
    {
        QFETCH(QString, damage);
        QFETCH(int, batches);
        make(u"a"_s);
        for (const QString &text : {u"One"_s, u"Two"_s, u"Three"_s})
            save(u"a"_s, text);
        const QString part = path(u"Changes/changes-1"_s);
        if (damage == "flip"_L1) {
            QByteArray bytes = readFile(part);
            bytes[85] = char(~bytes[85]); // of the first batch
            writeFile(part, bytes);
            reopen();
        } else {
            QVERIFY(QDir(path(u"Changes"_s)).removeRecursively());
        }
        if (damage == "folder"_L1) {
            QVERIFY(QDir().mkpath(part));
            reopen();
        }
        save(u"a"_s, u"Four"_s);
        QCOMPARE(mJournal->batches().size(), size_t(batches));
        QCOMPARE(undoLast().files, 1);
        QCOMPARE(title(u"a"_s), u"Three"_s);
    }

    void theOldestGo()
    {
        reopen({2000, 8000});
        make(u"a"_s);
        for (int i = 0; i < 40; ++i)
            save(u"a"_s, u"Title "_s + QString::number(i));
        qint64 size = 0;
        for (const QFileInfo &file : QDir(path(u"Changes"_s)).entryInfoList(QDir::Files))
            size += file.size();
        QVERIFY2(size < 12000, qPrintable(QString::number(size)));
        const auto all = mJournal->batches();
        QVERIFY(all.size() > 3 && all.size() < 30);
        QCOMPARE(all.front().what, u"Title 39"_s);
        reopen();
        QCOMPARE(undoLast().files, 1);
        QCOMPARE(title(u"a"_s), u"Title 38"_s);
        QVERIFY(mJournal->batches().front().number > all.front().number);
    }

    // As a process leaves it that ends between making a file of the journal and writing to it.
    void aPartThatWasJustBegun()
    {
        make(u"a"_s);
        save(u"a"_s, u"One"_s);
        writeFile(path(u"Changes/changes-2"_s), "");
        reopen();
        save(u"a"_s, u"Two"_s);
        QCOMPARE(mJournal->batches().size(), 2U);
        QCOMPARE(undoLast().files, 1);
        QCOMPARE(title(u"a"_s), u"One"_s);
        QCOMPARE(mJournal->undo(1, {}, {}, always).files, 1);
        QCOMPARE(readFile(path(u"a"_s)), before);
    }

    void aMoveThatFails()
    {
        make(u"a"_s);
        // A second name of the same file is no other file.
        link(u"a"_s, u"c"_s);
        FileChanges(*mJournal, {}).move(path(u"a"_s), path(u"c"_s));
        QCOMPARE(readFile(path(u"c"_s)), before);
        const QString tooLong = path(QString(300, u'x'));
        QCOMPARE(numberOf([&] { FileChanges(*mJournal, {}).move(path(u"c"_s), tooLong); }),
                 int(errNameRefused));
        QCOMPARE(readFile(path(u"c"_s)), before);
    }

    // What is done, and how the disk fails.
    void everyCallThatFails_data()
    {
        const DataRows<QString, int> row("what", "kind");
        for (const QString &what :
             {u"in place"_s, u"beside"_s, u"through"_s, u"move"_s, u"move over"_s}) {
            row(qPrintable(what + u", full"_s), what, int(diskfaults::Kind::Full));
            row(qPrintable(what + u", broken"_s), what, int(diskfaults::Kind::Broken));
            row(qPrintable(what + u", killed"_s), what, int(diskfaults::Kind::Killed));
        }
    }

    void everyCallThatFails()
    {
        QFETCH(QString, what);
        QFETCH(int, kind);
        const bool isOver = what == "move over"_L1, isMove = isOver || what == "move"_L1;
        const QString text(what == "in place"_L1 ? 800 : 2000, u'n');
        const auto change = [&] {
            if (isMove)
                FileChanges(*mJournal, {}).move(path(u"a"_s), path(u"b"_s), findName(path(u"b"_s)));
            else
                save(u"a"_s, text);
        };
        bool came = true;
        int calls = 0;
        for (; came; ++calls) {
            init();
            make(u"a"_s);
            if (what == "through"_L1)
                link(u"a"_s, u"link"_s);
            if (isOver)
                writeFile(path(u"b"_s), "other");
            bool failed = false;
            if (diskfaults::Kind(kind) == diskfaults::Kind::Killed) {
                came = killedIn(change, calls + 1);
            } else {
                const diskfaults::Fault fault(mFolder->path(), diskfaults::Kind(kind), calls + 1);
                try {
                    change();
                } catch (const Error &) {
                    failed = true;
                }
                came = fault.came();
            }
            // As the next start finds it.
            reopen();
            mJournal->mend();
            const bool isOld = isMove ? QFile::exists(path(u"a"_s)) : title(u"a"_s) == "Old"_L1;
            const QString name = isMove && !isOld ? u"b"_s : u"a"_s;
            // What was begun through a copy is completed.
            QVERIFY2(!failed || isOld || what == "through"_L1, qPrintable(QString::number(calls)));
            QVERIFY2(came || !isOld, "nothing failed");
            QVERIFY2(!isOver || readFile(path(u"b"_s)) == "other" ||
                         (!failed && isInWastebasket(path(u"b"_s))),
                     qPrintable(QString::number(calls)));
            if (isOld || isMove)
                QCOMPARE(readFile(path(name)), before);
            else
                QVERIFY(title(name) == text && readFile(path(name)).endsWith(sound));
            QCOMPARE(QDir(mFolder->path()).entryList({u".songcase*"_s}, QDir::Files | QDir::Hidden),
                     QStringList());
            QCOMPARE(QDir(path(u"Changes"_s)).entryList({u"copy*"_s}), QStringList());
            if (!isOld) {
                QCOMPARE(undoLast().files, 1);
                QCOMPARE(readFile(path(u"a"_s)), before);
            }
        }
        QVERIFY2(calls > 5, qPrintable(QString::number(calls)));
    }

    // The other file ends in the wastebasket, if there is one, or stays.
    void whatAMoveReplaces_data()
    {
        const DataRows<QByteArray, QString, bool, int> row("folder", "inTheWay", "isLink",
                                                           "number");
        row("wastebasket", "Muse", "", false, 0);
        row("a folder that is no UTF-8", "Mus\xE9 %", "", false, 0);
        row("thirty times the same name", "Muse", "data/Trash/files/b", false, 0);
        row("a wastebasket that takes nothing", "Muse", "data/Trash/info", false,
            int(errNotReplaced));
        row("a wastebasket that is away", "Muse", "data/Trash", true, int(errNotReplaced));
        row("data that is away", "Muse", "data", true, int(errNotReplaced));
        row("no wastebasket", "Muse", "data", false, 0);
        row("not what was looked at", "Muse", "b", false, int(errNotReplaced));
    }

    void whatAMoveReplaces()
    {
        QFETCH(QByteArray, folder);
        QFETCH(QString, inTheWay);
        QFETCH(bool, isLink);
        QFETCH(int, number);
        const QString in = path(nameOfNative(folder)), a = in + u"/a"_s, b = in + u"/b"_s;
        const auto isIn = [](const QString &name, const QByteArray &content) {
            return SystemFile(name, SystemFile::Mode::Read).read(0, before.size() + 1) == content;
        };
        QCOMPARE(::mkdir(nativeName(in).constData(), 0700), 0);
        SystemFile(a, SystemFile::Mode::Create).write(0, before);
        SystemFile(b, SystemFile::Mode::Create).write(0, "other");
        if (inTheWay.startsWith("data"_L1) && QDir().mkpath(QFileInfo(path(inTheWay)).path()))
            QVERIFY(isLink ? QFile::link(u"away"_s, path(inTheWay))
                           : !writeFile(path(inTheWay), "x").isEmpty());
        for (int n = 2; inTheWay.endsWith("files/b"_L1) && n <= 30; ++n)
            writeFile(path(u"data/Trash/files/%1-b"_s.arg(n)), "x");
        const auto over = findName(inTheWay == "b"_L1 ? a : b);
        QCOMPARE(numberOf([&] { FileChanges(*mJournal, {}).move(a, b, over); }), number);
        QVERIFY(isIn(number == 0 ? b : a, before));
        QVERIFY((inTheWay == "data"_L1 && !isLink) ||
                (number == 0 ? isInWastebasket(b) : isIn(b, "other")));
    }

    // Between the look and the move.
    void aFileThatAppears()
    {
        const auto appears = [&](const QString &name) {
            diskfaults::gAtRename = [=, this] { writeFile(path(name), "other"); };
        };
        make(u"a"_s);
        appears(u"b"_s);
        QCOMPARE(numberOf([&] { FileChanges(*mJournal, {}).move(path(u"a"_s), path(u"b"_s)); }),
                 int(errNotReplaced));
        QCOMPARE(readFile(path(u"b"_s)), "other");
        QVERIFY(QFile::remove(path(u"b"_s)));
        FileChanges(*mJournal, {}).move(path(u"a"_s), path(u"b"_s));
        appears(u"a"_s);
        QCOMPARE(undoLast().left.size(), 1);
        QCOMPARE(readFile(path(u"a"_s)), "other");
        QCOMPARE(readFile(path(u"b"_s)), before);
    }

private:
    // The file of this name that held "other".
    bool isInWastebasket(const QString &was) const
    {
        const QString trash = path(u"data/Trash/"_s);
        const QByteArray origin = "\nPath=" + nativeName(was) + '\n';
        const auto files = QDir(trash + u"files"_s).entryList(QDir::Files);
        return std::ranges::any_of(files, [&](const QString &name) {
            const QByteArray info = readFile(trash + u"info/"_s + name + u".trashinfo"_s);
            return readFile(trash + u"files/"_s + name) == "other" &&
                   QByteArray::fromPercentEncoding(info).contains(origin);
        });
    }

    // In a process of its own, which ends at that call; false: it came through.
    bool killedIn(const std::function<void()> &change, int call)
    {
        const pid_t child = fork();
        if (child == 0) {
            const diskfaults::Fault fault(mFolder->path(), diskfaults::Kind::Killed, call);
            try {
                change();
            } catch (const Error &) {
            }
            _exit(0);
        }
        int status = 0;
        waitpid(child, &status, 0);
        return WEXITSTATUS(status) == diskfaults::killed;
    }
};

QTEST_APPLESS_MAIN(tst_FileJournal)
#include "tst_FileJournal.moc"
