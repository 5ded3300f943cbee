#include "tags/journalstore.h"

#include "platform/error/error.h"
#include "platform/files/wholefile.h"

#include <QCryptographicHash>
#include <QDataStream>
#include <QDir>
#include <QFileInfo>
#include <algorithm>
#include <sys/stat.h>

using namespace Qt::StringLiterals;

namespace
{

// Before each entry: what it is, how long its words and its bytes are, a checksum of those two
// numbers and the words, one of the bytes.
constexpr quint32 mark = 0x53434A31; // "SCJ1"
constexpr qsizetype checksumSize = 8;
constexpr qint64 headSize = 4 + 4 + 8 + 2 * checksumSize;
constexpr quint32 longestWords = 1 << 20;

struct Head {
    quint32 words = 0;
    quint64 bytes = 0;
    QByteArray ofWords, ofBytes;
};

QByteArray checksum(const QByteArray &bytes)
{
    return QCryptographicHash::hash(bytes, QCryptographicHash::Sha1).first(checksumSize);
}

QByteArray checksumOfWords(quint32 words, quint64 bytes, const QByteArray &text)
{
    return checksum(QByteArray::number(words) + ' ' + QByteArray::number(bytes) + ' ' + text);
}

QByteArray written(const QByteArray &words, const QByteArray &bytes)
{
    QByteArray entry;
    QDataStream out(&entry, QIODevice::WriteOnly);
    out << mark << quint32(words.size()) << quint64(bytes.size());
    return entry + checksumOfWords(quint32(words.size()), quint64(bytes.size()), words) +
           checksum(bytes) + words + bytes;
}

std::optional<Head> headIn(const QByteArray &bytes)
{
    if (bytes.size() < headSize)
        return {};
    QDataStream in(bytes);
    quint32 found = 0;
    Head head;
    in >> found >> head.words >> head.bytes;
    head.ofWords = bytes.sliced(headSize - 2 * checksumSize, checksumSize);
    head.ofBytes = bytes.sliced(headSize - checksumSize, checksumSize);
    return found == mark && head.words <= longestWords ? std::optional(head) : std::nullopt;
}

// Reads small pieces one behind the other with few calls.
class Ahead
{
public:
    explicit Ahead(const SystemFile &file) : mFile(file) {}

    QByteArray read(qint64 from, qint64 count)
    {
        constexpr qint64 atOnce = qint64(256) << 10;
        if (from < mFrom || from + count > mFrom + mBytes.size()) {
            mBytes = mFile.read(from, std::max(atOnce, count));
            mFrom = from;
        }
        return mBytes.mid(from - mFrom, count);
    }

private:
    const SystemFile &mFile;
    QByteArray mBytes;
    qint64 mFrom = 0;
};

struct Entry {
    QByteArray words;
    qint64 bytes = 0, end = 0;
};

std::optional<Entry> entryAt(Ahead &ahead, qint64 at, qint64 size)
{
    const auto head = headIn(ahead.read(at, headSize));
    if (!head)
        return {};
    const qint64 bytesAt = at + headSize + head->words;
    if (bytesAt > size || head->bytes > quint64(size - bytesAt))
        return {};
    const QByteArray words = ahead.read(at + headSize, head->words);
    if (checksumOfWords(head->words, head->bytes, words) != head->ofWords)
        return {};
    return Entry{words, qint64(head->bytes), bytesAt + qint64(head->bytes)};
}

// An entry that the end of the program or a full disk has cut off was never synced: nothing stands
// on it.
bool isCutOff(Ahead &ahead, qint64 at, qint64 size)
{
    const auto head = headIn(ahead.read(at, headSize));
    const qint64 rest = size - at - headSize;
    return rest < 0 || (head && (head->words > rest || head->bytes > quint64(rest - head->words)));
}

// Where the next entry may begin; the end where there is none.
qint64 nextMark(Ahead &ahead, qint64 from, qint64 size)
{
    constexpr qint64 piece = qint64(64) << 10;
    QByteArray wanted;
    QDataStream(&wanted, QIODevice::WriteOnly) << mark;
    for (qint64 at = from; at < size; at += piece) {
        const auto found = ahead.read(at, piece + wanted.size() - 1).indexOf(wanted);
        if (found >= 0)
            return at + found;
    }
    return size;
}

int numberOf(const QString &name)
{
    return name.section(u'-', 1).toInt();
}

} // namespace

JournalStore::JournalStore(QString folder, JournalSizes sizes)
    : mFolder(std::move(folder)), mSizes(sizes)
{
}

QString JournalStore::nameOf(int part) const
{
    return mFolder + "/changes-"_L1 + QString::number(part);
}

std::map<int, qint64> JournalStore::parts() const
{
    std::map<int, qint64> all;
    for (const QFileInfo &file : QDir(mFolder).entryInfoList({u"changes-*"_s}, QDir::Files)) {
        if (const int part = numberOf(file.fileName()); part > 0)
            all[part] = file.size();
    }
    return all;
}

// Of all that has such a name, even if it is no file.
int JournalStore::lastNumber() const
{
    int last = 0;
    for (const QString &name :
         QDir(mFolder).entryList({u"changes-*"_s}, QDir::AllEntries | QDir::Hidden | QDir::System))
        last = std::max(last, numberOf(name));
    return last;
}

JournalStore::Condition JournalStore::readPart(int part, const Reader &reader) const
{
    const SystemFile file(nameOf(part), SystemFile::Mode::Read);
    const qint64 size = file.size();
    Ahead ahead(file);
    auto condition = Condition::Whole;
    for (qint64 at = 0; at < size;) {
        const auto entry = entryAt(ahead, at, size);
        if (entry)
            reader(entry->words, {part, at, entry->bytes});
        const qint64 next = entry ? entry->end : nextMark(ahead, at + 1, size);
        if (!entry && next == size && condition == Condition::Whole && isCutOff(ahead, at, size))
            condition = Condition::CutOff;
        else if (!entry)
            condition = Condition::Damaged;
        at = next;
    }
    return condition;
}

bool JournalStore::readAll(const Reader &reader) const
{
    bool isWhole = true;
    for (const auto &[part, size] : parts()) {
        try {
            isWhole = readPart(part, reader) != Condition::Damaged && isWhole;
        } catch (const Error &) { // the others are there
            isWhole = false;
        }
    }
    return isWhole;
}

// Into a file that was not read whole nothing is written: what stands behind the damage is kept.
bool JournalStore::openLast(const Reader &reader)
{
    const auto all = parts();
    if (all.empty())
        return true;
    mPart = all.rbegin()->first;
    mEnd = all.rbegin()->second;
    auto condition = Condition::Damaged;
    try {
        condition = readPart(mPart, reader);
    } catch (const Error &) { // so it is
    }
    mIsDoubtful = condition != Condition::Whole;
    return condition != Condition::Damaged;
}

void JournalStore::beginPart()
{
    const bool isNew = !QFileInfo::exists(mFolder);
    if (isNew && !QDir().mkpath(mFolder))
        throw makeError(errFileFailed, mFolder);
    const int part = lastNumber() + 1;
    mFile.reset();
    mFile.emplace(nameOf(part), SystemFile::Mode::Create);
    mPart = part;
    mEnd = mBeginning = 0;
    mIsDoubtful = false;
    syncFolder(mFolder);
    if (isNew)
        syncFolder(QFileInfo(mFolder).path());
}

void JournalStore::begun()
{
    mBeginning = mEnd;
    const auto all = parts();
    qint64 sum = 0;
    for (const auto &[part, size] : all)
        sum += size;
    for (auto oldest = all.begin(); oldest != all.end() && sum > mSizes.all; ++oldest) {
        if (oldest->first >= mKeptFrom.value_or(mPart))
            break;
        QFile::remove(nameOf(oldest->first));
        sum -= oldest->second;
    }
}

void JournalStore::write(const QByteArray &entries)
{
    if (!mFile)
        mFile.emplace(nameOf(mPart), SystemFile::Mode::Write);
    mFile->write(mEnd, entries);
    mEnd += entries.size();
}

JournalStore::Place JournalStore::append(const QByteArray &words, const QByteArray &bytes)
{
    const Place place{mPart, mEnd, bytes.size()};
    write(written(words, bytes));
    return place;
}

void JournalStore::append(const std::vector<QByteArray> &words)
{
    QByteArray entries;
    for (const QByteArray &each : words)
        entries += written(each, {});
    write(entries);
}

void JournalStore::sync()
{
    if (!mFile)
        return;
    try {
        mFile->sync();
    } catch (const Error &) {
        // Whether what was written is there nobody knows any more, even if the next one succeeds.
        mFile.reset();
        mIsDoubtful = true;
        throw;
    }
}

std::optional<QByteArray> JournalStore::bytes(const Place &place) const
{
    try {
        const SystemFile file(nameOf(place.part), SystemFile::Mode::Read);
        const auto head = headIn(file.read(place.at, headSize));
        if (!head || qint64(head->bytes) != place.size)
            return {};
        QByteArray bytes = file.read(place.at + headSize + head->words, place.size);
        return checksum(bytes) == head->ofBytes ? std::optional(bytes) : std::nullopt;
    } catch (const Error &) {
        return {};
    }
}

bool JournalStore::mustBegin() const
{
    struct stat about = {};
    const bool isThere = mFile ? ::fstat(mFile->handle(), &about) == 0 && about.st_nlink > 0
                               : mEnd > 0 && QFileInfo::exists(nameOf(mPart));
    return mEnd == 0 || mIsDoubtful || !isThere;
}

bool JournalStore::isFull() const
{
    return mEnd - mBeginning >= mSizes.part;
}
