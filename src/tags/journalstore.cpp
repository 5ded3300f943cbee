#include "tags/journalstore.h"

#include "platform/error/error.h"
#include "platform/files/wholefile.h"

#include <QCryptographicHash>
#include <QDataStream>
#include <QDir>
#include <QFileInfo>

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
        if (const int part = file.fileName().section(u'-', 1).toInt(); part > 0)
            all[part] = file.size();
    }
    return all;
}

// Gives where the last whole entry ends.
qint64 JournalStore::readPart(int part, const Reader &reader) const
{
    const SystemFile file(nameOf(part), SystemFile::Mode::Read);
    const qint64 size = file.size();
    Ahead ahead(file);
    qint64 at = 0;
    while (const auto head = headIn(ahead.read(at, headSize))) {
        const qint64 bytesAt = at + headSize + head->words;
        if (bytesAt > size || qint64(head->bytes) > size - bytesAt)
            break;
        const QByteArray words = ahead.read(at + headSize, head->words);
        if (checksumOfWords(head->words, head->bytes, words) != head->ofWords)
            break;
        reader(words, {part, at, qint64(head->bytes)});
        at = bytesAt + qint64(head->bytes);
    }
    return at;
}

void JournalStore::readAll(const Reader &reader) const
{
    for (const auto &[part, size] : parts())
        readPart(part, reader);
}

void JournalStore::openLast(const Reader &reader)
{
    const auto all = parts();
    if (all.empty())
        return;
    mPart = all.rbegin()->first;
    mEnd = readPart(mPart, reader);
}

// What was cut off at the end is written over.
void JournalStore::openForWriting()
{
    mFile.emplace(nameOf(mPart), SystemFile::Mode::Write);
    mFile->resize(mEnd);
}

void JournalStore::beginPart()
{
    const bool isNew = !QFileInfo::exists(mFolder);
    if (isNew && !QDir().mkpath(mFolder))
        throw makeError(errFileFailed, mFolder);
    auto all = parts();
    const int last = all.empty() ? 0 : all.rbegin()->first;
    mFile.reset();
    mFile.emplace(nameOf(last + 1), SystemFile::Mode::Create);
    mPart = last + 1;
    mEnd = 0;
    mIsDoubtful = false;
    syncFolder(mFolder);
    if (isNew)
        syncFolder(QFileInfo(mFolder).path());
    qint64 sum = 0;
    for (const auto &[part, size] : all)
        sum += size;
    for (auto oldest = all.begin(); oldest != all.end() && sum > mSizes.all; ++oldest) {
        QFile::remove(nameOf(oldest->first));
        sum -= oldest->second;
    }
}

void JournalStore::write(const QByteArray &entries)
{
    if (!mFile)
        openForWriting();
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

bool JournalStore::isPartFull() const
{
    return mEnd == 0 || mIsDoubtful || mEnd >= mSizes.part;
}
