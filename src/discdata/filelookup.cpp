#include "discdata/filelookup.h"

#include "discdata/filelookupid.h"
#include "discs/candidates.h"
#include "discs/discid.h"
#include "platform/work/longwork.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

constexpr int mostTracks = 99;
constexpr int sameLength = 3000; // milliseconds that two issues of a recording may differ by

bool isMP3(const QString &name)
{
    return name.endsWith(".mp3"_L1, Qt::CaseInsensitive);
}

// Of a candidate the number may be known without its tracks; 0 where it is not.
int tracksOf(const DiscRecord &disc)
{
    if (!disc.tracks.empty())
        return int(disc.tracks.size());
    return disc.trackCount > 0 ? disc.trackCount : tracksOfCddbId(disc.keyB);
}

// Signs, case and what stands in brackets are told differently by everybody.
QString comparable(const QString &title)
{
    QString letters;
    const QString plain = plainSigns(title).section(u'(', 0, 0).section(u'[', 0, 0);
    for (const QChar c : (plain.trimmed().isEmpty() ? title : plain).toCaseFolded()) {
        if (c.isLetterOrNumber())
            letters += c;
    }
    return letters;
}

// From 1; 0 where none or more than one is so.
template <typename Is> int onlyTrack(const DiscRecord &disc, const Is &is)
{
    int only = 0;
    for (int number = 1; const TrackRecord &track : disc.tracks) {
        if (is(track) && only != 0)
            return 0;
        only = is(track) ? number : only;
        ++number;
    }
    return only;
}

[[noreturn]] void throwCancelled()
{
    throw Error(errLookupCancelled, u"CDDBControl"_s, errorText("xServiceCancelled", {}));
}

} // namespace

FileLookup::Folder FileLookup::readFolder(const QString &path, const std::stop_token &stop)
{
    Folder folder;
    const QFileInfo file(path);
    folder.path = path;
    folder.own = {file.fileName(), readSoundFile(path).value_or(SoundFile())};
    folder.count = int(std::ranges::count_if(filesIn(file.path()), isMP3));
    QString unreadable;
    if (folder.count <= mostTracks)
        folder.files = soundFilesIn(file.path(), isMP3, stop, unreadable);
    if (!unreadable.isEmpty())
        folder.files.clear();
    return folder;
}

// What cannot be asked now may not be needed; it is told where nothing else is found.
std::optional<Lookup::Found> FileLookup::ask(const std::function<Lookup::Found()> &ask)
{
    try {
        Lookup::Found found = ask();
        return found.candidates.empty() ? std::nullopt : std::optional(std::move(found));
    } catch (const Error &error) {
        if (error.Number == errLookupCancelled)
            throw;
        if (!mFailure && error.Number != errNothingFound)
            mFailure = error;
        return {};
    }
}

// One alone is sure if it has the file's track.
FileLookup::Found FileLookup::decided(Lookup::Found found,
                                      const std::function<int(const DiscRecord &disc)> &trackIn)
{
    Found all{{}, 0, std::move(found.candidates), found.keptOn};
    if (all.candidates.size() != 1)
        return all;
    Lookup::Whole whole = mServices.complete(all.candidates.front(), mWork);
    if (!all.keptOn)
        all.keptOn = whole.keptOn;
    all.candidates.front() = whole.disc;
    all.track = trackIn(whole.disc);
    if (all.track == 0)
        return all;
    all.disc = std::move(whole.disc);
    all.candidates.clear();
    return all;
}

std::optional<FileLookup::Found> FileLookup::byTable(std::vector<RippedFile> files)
{
    const auto toc = tocOf(files);
    auto found = toc ? ask([&] { return mServices.find(*toc, mWork); }) : std::nullopt;
    if (!found)
        return {};
    std::erase_if(found->candidates,
                  [&](const DiscRecord &disc) { return tracksOf(disc) != int(files.size()); });
    if (found->candidates.empty())
        return {};
    const auto own = std::ranges::find(files, mFolder.own.name, &RippedFile::name);
    return decided(std::move(*found),
                   [&](const DiscRecord &) { return int(own - files.begin()) + 1; });
}

std::optional<FileLookup::Found> FileLookup::byTables()
{
    const std::vector<RippedFile> &byNames = mFolder.files;
    if (byNames.empty())
        return {};
    if (auto found = byTable(byNames))
        return found;
    std::vector<RippedFile> byNumbers = byNames;
    if (!haveNumbers(byNumbers))
        return {};
    sortByNumbers(byNumbers);
    const bool other =
        !std::ranges::equal(byNumbers, byNames, {}, &RippedFile::name, &RippedFile::name);
    return other ? byTable(byNumbers) : std::nullopt;
}

int FileLookup::trackIn(const DiscRecord &disc, const Hints &hints)
{
    if (disc.soughtTrack >= 1 && disc.soughtTrack <= int(disc.tracks.size()))
        return disc.soughtTrack;
    const QString title = comparable(hints.title);
    const auto hasTitle = [&](const TrackRecord &track) {
        return !title.isEmpty() && comparable(track.title) == title;
    };
    const auto hasLength = [&](const TrackRecord &track) {
        return track.length > 0 && std::abs(track.length - hints.length) <= sameLength;
    };
    const bool isNumber = hints.number >= 1 && hints.number <= int(disc.tracks.size());
    const TrackRecord *numbered = isNumber ? &disc.tracks[size_t(hints.number) - 1] : nullptr;
    if (numbered && (hasTitle(*numbered) || title.isEmpty() || hasLength(*numbered)))
        return hints.number;
    const int titled = onlyTrack(disc, hasTitle);
    return titled != 0 || !title.isEmpty() ? titled : onlyTrack(disc, hasLength);
}

std::optional<FileLookup::Found> FileLookup::bySearch(const SearchWords &words, const Hints &hints)
{
    auto found = ask([&] { return mServices.find(words, mWork); });
    if (!found)
        return {};
    const auto fits = [this](const DiscRecord &disc) { return tracksOf(disc) == mFolder.count; };
    if (mFolder.count > 1 && std::ranges::any_of(found->candidates, fits))
        std::erase_if(found->candidates, std::not_fn(fits));
    return decided(std::move(*found), [&](const DiscRecord &disc) { return trackIn(disc, hints); });
}

// The tags' own words, with those of the name where they say nothing; then the name's alone. Each
// time the album first, then the track on whatever disc.
std::optional<FileLookup::Found> FileLookup::byWords()
{
    const FileNameParts name = filenameParts(mFolder.path);
    const SoundFile &tags = mFolder.own.sound;
    const auto first = [](const QString &a, const QString &b) { return a.isEmpty() ? b : a; };
    const QString nameArtist = first(name.artist, name.albumArtist);
    const Hints ofTags{first(tags.title, name.title), tags.track > 0 ? tags.track : name.track,
                       tags.length};
    const Hints ofName{name.title, name.track, tags.length};
    std::vector<std::pair<SearchWords, Hints>> searches;
    const auto add = [&](const QString &albumArtist, const QString &album, const QString &artist,
                         const Hints &hints) {
        if (!album.isEmpty() && !albumArtist.isEmpty() && !isVariousArtists(albumArtist))
            searches.push_back({{albumArtist, album, {}, {}}, hints});
        if (!hints.title.isEmpty() && !artist.isEmpty())
            searches.push_back({{artist, {}, {}, hints.title}, hints});
    };
    const QString tagArtist = first(tags.artist, nameArtist);
    add(tagArtist, first(tags.album, name.album), tagArtist, ofTags);
    add(first(name.albumArtist, name.artist), name.album, nameArtist, ofName);
    std::vector<SearchWords> asked;
    for (const auto &[words, hints] : searches) {
        if (std::ranges::find(asked, words) != asked.end())
            continue;
        asked.push_back(words);
        if (auto found = bySearch(words, hints))
            return found;
    }
    return {};
}

FileLookup::Found FileLookup::byFile(const QString &path)
{
    auto folder = mWork.valueOf<Folder>(
        [path](const std::stop_token &stop) { return readFolder(path, stop); });
    if (!folder || mWork.isCancelled())
        throwCancelled();
    mFolder = std::move(*folder);
    const bool isAlone = mFolder.count <= 1;
    auto found = isAlone ? byWords() : byTables();
    if (!found)
        found = isAlone ? byTables() : byWords();
    if (!found && mFailure)
        throw Error(*mFailure);
    return found.value_or(Found());
}

FileLookup::Found FileLookup::byId(const TrackOfFileId &id)
{
    if (!id.recording.isEmpty()) {
        auto found = ask([&] { return mServices.ofRecording(id.recording, mWork); });
        if (!found && mFailure)
            throw Error(*mFailure);
        return found ? decided(std::move(*found),
                               [](const DiscRecord &disc) { return trackIn(disc, {}); })
                     : Found();
    }
    Lookup::Whole whole;
    try {
        whole = mServices.again(id.record, mWork);
    } catch (const Error &error) {
        if (error.Number == errNothingFound)
            return {};
        throw;
    }
    if (id.track > int(whole.disc.tracks.size())) // another record has that id now
        return {};
    return {std::move(whole.disc), id.track, {}, whole.keptOn};
}
