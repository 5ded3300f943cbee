#include "collection/heldrecord.h"

#include "platform/ado/recordset.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace
{

QString selectContent(qint64 id)
{
    return u"select cd_type, titel, artiest_id, genre, hitjaar from CDTitels where id = "_s +
           QString::number(id);
}

QString selectDiscs(qint64 id)
{
    return u"select distinct diskno as DiskNo from CompactDiscs where cdtitels_id = "_s +
           QString::number(id) + u" order by 1"_s;
}

// Empty if there is no such row; NULL is told from an empty text.
QStringList contentOf(qint64 id)
{
    ADODB::Recordset row;
    row.Open(selectContent(id), *gConnection);
    QStringList content;
    for (int column = 0; !row.isEOF() && column < row.fieldCount(); ++column) {
        const ADODB::Value value = row.Fields(column).Value();
        content.append(value.isNull() ? u"null"_s : u'=' + value.toText());
    }
    return content;
}

} // namespace

void HeldRecord::know(qint64 id)
{
    mContent = contentOf(id);
    mDiscs.clear();
    mState = mContent.isEmpty() ? State::Swept : State::Stored;
}

void HeldRecord::beginAnew(const QMap<int, QList<StoredTrack>> &discs)
{
    begin();
    mDiscs = discs;
}

bool HeldRecord::isThere(qint64 id) const
{
    return isStored() && contentOf(id) == mContent;
}

void HeldRecord::keepDiscs(qint64 id, TrackStore::Artists artists)
{
    mDiscs.clear();
    ADODB::Recordset discs;
    for (discs.Open(selectDiscs(id), *gConnection); !discs.isEOF(); discs.MoveNext()) {
        const int disc = int(discs.Fields(0).Value().toLong());
        mDiscs[disc] = TrackStore(*gConnection, id, disc, artists).load();
    }
}

void HeldRecord::writeKeptDiscs(qint64 id, int shown, TrackStore::Artists artists) const
{
    for (auto disc = mDiscs.cbegin(); disc != mDiscs.cend(); ++disc) {
        if (disc.key() == shown)
            continue;
        QList<TrackToSave> tracks;
        for (const StoredTrack &track : *disc)
            tracks.append({0, true, track.texts, {}});
        TrackStore(*gConnection, id, disc.key(), artists).save(tracks, {});
    }
}
