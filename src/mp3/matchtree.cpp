#include "mp3/matchtree.h"

#include "mp3/matchchoice.h"
#include "mp3/matchstatements.h"
#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "platform/error/error.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace
{

enum DiscField { Id, Naam, Titel, DiskNo, NumTracks };
enum TrackField { Artiest, TrackTitel, TrackNo };

} // namespace

void MatchTree::showText(const QString &text)
{
    beginResetModel();
    mDiscs.reset();
    mTracks.clear();
    mText = text;
    endResetModel();
}

void MatchTree::showDiscs(std::shared_ptr<const ADODB::Rows> discs, bool withTracks)
{
    beginResetModel();
    mDiscs = std::move(discs);
    mTracks.clear();
    mWithTracks = withTracks;
    endResetModel();
}

QModelIndex MatchTree::index(int row, int column, const QModelIndex &parent) const
{
    if (!hasIndex(row, column, parent))
        return {};
    return createIndex(row, column, parent.isValid() ? quintptr(parent.row()) + 1 : quintptr(0));
}

QModelIndex MatchTree::parent(const QModelIndex &child) const
{
    return !child.isValid() || isDisc(child) ? QModelIndex()
                                             : createIndex(discOf(child), 0, quintptr(0));
}

int MatchTree::rowCount(const QModelIndex &parent) const
{
    if (!parent.isValid())
        return mDiscs ? int(mDiscs->rowCount()) : 1;
    const auto tracks = isDisc(parent) ? mTracks.value(parent.row()) : nullptr;
    return tracks ? int(tracks->rowCount()) : 0;
}

bool MatchTree::hasChildren(const QModelIndex &parent) const
{
    return !parent.isValid() || (mDiscs && mWithTracks && isDisc(parent));
}

bool MatchTree::canFetchMore(const QModelIndex &parent) const
{
    return parent.isValid() && hasChildren(parent) && !mTracks.contains(parent.row());
}

void MatchTree::fetchMore(const QModelIndex &parent)
{
    if (!canFetchMore(parent))
        return;
    const int disc = parent.row();
    try {
        ADODB::Recordset tracks;
        tracks.Open(tracksOfDisc(mDiscs->id(disc, Id), mDiscs->id(disc, DiskNo)), *gConnection);
        const auto count = int(tracks.RecordCount());
        if (count > 0)
            beginInsertRows(parent, 0, count - 1);
        mTracks[disc] = tracks.rows();
        if (count > 0)
            endInsertRows();
    } catch (const Error &error) {
        emit failed(error.numbered());
    }
}

QString MatchTree::discKey(int disc) const
{
    return matchkey::ofDisc(mDiscs->id(disc, Id), mDiscs->id(disc, DiskNo));
}

QString MatchTree::discText(int disc) const
{
    const QString artist = mDiscs->text(disc, Naam);
    return (artist.isEmpty() ? artist : artist + u" - "_s) + mDiscs->text(disc, Titel) +
           u" Disc "_s + mDiscs->text(disc, DiskNo) + u" ("_s + mDiscs->text(disc, NumTracks) +
           u" tracks)"_s;
}

QString MatchTree::trackText(int disc, int track) const
{
    const auto &tracks = *mTracks.value(disc);
    return u"Track "_s + tracks.text(track, TrackNo) + u": "_s + tracks.text(track, Artiest) +
           u" - "_s + tracks.text(track, TrackTitel);
}

QString MatchTree::keyOf(const QModelIndex &index) const
{
    if (!mDiscs)
        return matchkey::root;
    if (isDisc(index))
        return discKey(index.row());
    const int disc = discOf(index);
    return matchkey::ofTrack(discKey(disc), mTracks.value(disc)->id(index.row(), TrackNo));
}

QVariant MatchTree::data(const QModelIndex &index, int role) const
{
    if (!index.isValid())
        return {};
    if (role == keyRole)
        return keyOf(index);
    if (role != Qt::DisplayRole)
        return {};
    if (!mDiscs)
        return mText;
    return isDisc(index) ? discText(index.row()) : trackText(discOf(index), index.row());
}
