#include "discdata/cddbtagmanager.h"

#include "discdata/cddbcontrol.h"
#include "discdata/changedfiles.h"
#include "discdata/filelookupid.h"
#include "platform/desktop/desktop.h"
#include "services/messages.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

FileChanges::About aboutTags(const QString &where)
{
    return {Desktop::current().now(), u"xTagsOfFiles"_s, where};
}

const QString &firstOf(const QString &own, const QString &ofDisc)
{
    return own.isEmpty() ? ofDisc : own;
}

} // namespace

CddbDiscPtr CddbTagManager::LookupByFile(const QString &path, int, int &track)
{
    return mControl.lookUpFile([&](FileLookup &lookup) { return lookup.byFile(path); }, track);
}

CddbID3Tag CddbTagManager::TagForTrack(const CddbDisc &disc, int track) const
{
    const DiscRecord &record = disc.record;
    const bool isThere = track >= 1 && track <= disc.TrackCount();
    const TrackRecord own = isThere ? record.tracks[size_t(track) - 1] : TrackRecord();
    CddbID3Tag tag;
    tag.setAlbum(record.title);
    tag.setTitle(own.title);
    tag.setComments(own.notes);
    tag.setLabel(record.label);
    tag.setLeadArtist(firstOf(own.artist.name, record.artist.name));
    tag.setPartOfSet(record.numberInSet + u'/' + record.totalInSet);
    tag.setTrackPosition(QString::number(track));
    tag.setYear(firstOf(own.year, record.year));
    tag.setGenre(firstOf(own.genre, record.genre));
    tag.setFileId(fileIdOf(record, track));
    return tag;
}

void CddbTagManager::SaveTagToFile(const CddbID3Tag &tag, const QString &path, int)
{
    if (mChanges)
        mChanges->saveTag(tag, path);
    else
        FileChanges(changedFiles(), aboutTags(QFileInfo(path).path())).saveTag(tag, path);
}

CddbTagManager::Batch::Batch(CddbTagManager &manager, const QString &where,
                             const std::vector<std::pair<QString, CddbID3Tag>> &tags)
    : mManager(manager)
{
    manager.mChanges.emplace(changedFiles(), aboutTags(where));
    manager.mChanges->announce(tags);
}
