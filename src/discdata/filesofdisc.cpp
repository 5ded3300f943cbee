#include "discdata/filesofdisc.h"

#include "discdata/rippedfiles.h"
#include "discs/candidates.h"
#include "discs/cuesheet.h"
#include "discs/tocsheet.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QRegularExpression>

using namespace Qt::StringLiterals;

namespace
{

constexpr qint64 largestSheet = 1 << 20; // bytes; an image with the ending of a sheet is larger
constexpr int longestName = 255;         // of a file, in what is shown

FoundDisc nothing(const char *problem, const QString &about)
{
    return {{}, 0, problem, QDir::toNativeSeparators(about), false};
}

FoundDisc found(const DiscSheet &sheet)
{
    FoundDisc disc;
    disc.toc.toc = sheet.toc;
    disc.toc.known = sheet.known;
    if (sheet.toc.tracks.empty())
        disc.toc.words = {sheet.known.artist.name, sheet.known.title, sheet.known.barcode};
    if (sheet.toc.tracks.empty() && disc.toc.words.isEmpty())
        return nothing("xDiscImageMissing", cleanText(sheet.missing.left(longestName)));
    disc.tracks = sheet.known.trackCount;
    return disc;
}

bool isFile(const QString &name)
{
    return QFileInfo(name).isFile(); // not so for pipes and devices
}

/// Finds the files that a sheet names. They have often been moved or converted since.
class SheetFolder
{
public:
    explicit SheetFolder(const QString &sheet)
        : mSheet(sheet), mFolder(mSheet.dir()), mNames(mFolder.entryList(QDir::Files, QDir::Name))
    {
    }
    std::optional<qint64> lengthOf(const QString &name, LengthIn unit);

    /// Whether one of several was taken to be the file of the sheet's own name: that can only be so
    /// where it is the only one.
    bool isWrongGuess() const { return mGuessed && mLengths.size() > 1; }
    void guessNoMore();

private:
    std::optional<qint64> measure(const QString &name, LengthIn unit);
    QString find(const QString &name, LengthIn unit);
    QString like(const QString &base, const QString &ending, LengthIn unit) const;

    QFileInfo mSheet;
    QDir mFolder;
    QStringList mNames;
    QHash<QString, std::optional<qint64>> mLengths; // a file may be named for each track
    bool mMayGuess = true, mGuessed = false;
};

void SheetFolder::guessNoMore()
{
    mLengths.clear();
    mMayGuess = mGuessed = false;
}

// In any case of letters, and with any ending of the kind if there is none with that one.
QString SheetFolder::like(const QString &base, const QString &ending, LengthIn unit) const
{
    QString other;
    for (const QString &name : mNames) {
        const QFileInfo file(name);
        if (file.completeBaseName().compare(base, Qt::CaseInsensitive) != 0)
            continue;
        if (file.suffix().compare(ending, Qt::CaseInsensitive) == 0)
            return mFolder.filePath(name);
        if (unit == LengthIn::Frames && isSoundFile(name))
            other = mFolder.filePath(name);
    }
    return other;
}

QString SheetFolder::find(const QString &name, LengthIn unit)
{
    if (QString exact = mFolder.filePath(name); isFile(exact))
        return exact;
    const QFileInfo plain(QString(name).replace(u'\\', u'/'));
    if (QString below = mFolder.filePath(plain.filePath()); isFile(below))
        return below;
    QString similar = like(plain.completeBaseName(), plain.suffix(), unit);
    if (!similar.isEmpty() || !mMayGuess)
        return similar;
    mGuessed = true;
    return like(mSheet.completeBaseName(), plain.suffix(), unit);
}

std::optional<qint64> SheetFolder::lengthOf(const QString &name, LengthIn unit)
{
    if (!mLengths.contains(name))
        mLengths[name] = measure(name, unit);
    return mLengths[name];
}

std::optional<qint64> SheetFolder::measure(const QString &name, LengthIn unit)
{
    const QString file = find(name, unit);
    if (file.isEmpty())
        return {};
    if (unit == LengthIn::Bytes)
        return QFileInfo(file).size();
    const auto sound = readSoundFile(file);
    return sound ? std::optional<qint64>(framesOfSound(sound->length)) : std::nullopt;
}

TrackRecord trackOf(const RippedFile &file)
{
    static const QRegularExpression number(u"^[0-9]{1,3}[ ._-]+"_s);
    TrackRecord track;
    track.title = cleanText(file.sound.title);
    if (track.title.isEmpty())
        track.title = cleanText(QFileInfo(file.name).completeBaseName().remove(number));
    track.artist.name = cleanText(file.sound.artist);
    return track;
}

// What all files say alike; else nothing.
template <typename Value>
Value common(const std::vector<RippedFile> &files, Value SoundFile::*value)
{
    const Value first = files.front().sound.*value;
    const bool same = std::ranges::all_of(
        files, [&](const RippedFile &file) { return file.sound.*value == first; });
    return same ? first : Value();
}

std::optional<DiscSheet> discOf(const std::vector<RippedFile> &files)
{
    DiscSheet sheet;
    for (const RippedFile &file : files)
        sheet.known.tracks.push_back(trackOf(file));
    const auto toc = tocOf(files);
    if (!toc)
        return {};
    sheet.toc = *toc;
    sheet.known.title = cleanText(common(files, &SoundFile::album));
    sheet.known.genre = cleanText(common(files, &SoundFile::genre));
    sheet.known.year = yearOf(QString::number(common(files, &SoundFile::year)));
    return discsheet::complete(sheet) ? std::optional(sheet) : std::nullopt;
}

// Empty if none lies beside the image.
QString sheetBeside(const QString &image)
{
    const QFileInfo file(image);
    for (const QString &ending : {u"cue"_s, u"toc"_s}) {
        for (const QString &base : {file.completeBaseName(), file.fileName()}) {
            const QStringList names = file.dir().entryList({base + u'.' + ending}, QDir::Files);
            if (!names.isEmpty())
                return file.dir().filePath(names.first());
        }
    }
    return {};
}

} // namespace

FoundDisc readSheetFile(const QString &name)
{
    QFile file(name);
    if (!isFile(name) || !file.open(QIODevice::ReadOnly))
        return nothing("xDiscFileUnreadable", name);
    const QByteArray bytes = file.read(largestSheet + 1);
    if (bytes.size() > largestSheet)
        return nothing("xDiscNoTable", name);
    SheetFolder folder(name);
    const LengthOfFile lengthOf = [&folder](const QString &named, LengthIn unit) {
        return folder.lengthOf(named, unit);
    };
    const bool isCue = QFileInfo(name).suffix().compare(u"cue", Qt::CaseInsensitive) == 0;
    const auto read = isCue ? readCueSheet : readTocSheet;
    auto sheet = read(bytes, lengthOf);
    if (folder.isWrongGuess()) {
        folder.guessNoMore();
        sheet = read(bytes, lengthOf);
    }
    return sheet ? found(*sheet) : nothing("xDiscNoTable", name);
}

FoundDisc readSoundFolder(const QString &name, const std::stop_token &stop)
{
    const QDir folder(name);
    const QStringList sheets = folder.entryList({u"*.cue"_s}, QDir::Files);
    if (sheets.size() == 1) {
        FoundDisc disc = readSheetFile(folder.filePath(sheets.first()));
        if (!disc.toc.toc.tracks.empty())
            return disc;
    }
    QString unreadable;
    std::vector<RippedFile> files = soundFilesIn(name, isSoundFile, stop, unreadable);
    if (!unreadable.isEmpty())
        return nothing("xDiscFileUnreadable", unreadable);
    if (files.empty())
        return nothing("xDiscNoSound", name);
    if (haveNumbers(files))
        sortByNumbers(files);
    const auto sheet = discOf(files);
    return sheet ? found(*sheet) : nothing("xDiscTooLong", name);
}

FoundDisc readSheetOfImage(const QString &image)
{
    if (const QString sheet = sheetBeside(image); !sheet.isEmpty())
        return readSheetFile(sheet);
    if (!isFile(image))
        return nothing("xDiscFileUnreadable", image);
    const bool isData = QFileInfo(image).suffix().compare(u"iso", Qt::CaseInsensitive) == 0;
    return nothing(isData ? "xDiscNoTable" : "xDiscNoSheet", image);
}
