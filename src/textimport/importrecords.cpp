#include "textimport/importrecords.h"

#include "platform/text/textrules.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr int fieldLength = 255;

} // namespace

ADODB::RecordsetPtr newImportRecords()
{
    auto records = std::make_shared<ADODB::Recordset>();
    records->appendField(u"ListIndex"_s, ADODB::adBigInt);
    for (const char *name : {"Artist", "TrackTitle", "Genre", "Hitjaar", "MainTitle",
                             "MainTitleIndex", "DiskIndex", "TrackIndex"})
        records->appendField(QString::fromLatin1(name), ADODB::adVarWChar, fieldLength);
    records->Open();
    return records;
}

// The cut comes first: a line may be far longer than what is kept of it.
QString treatedField(QStringView field)
{
    QString kept =
        text::cutTo(field.first(qMin(field.size(), fieldLength + 1)).toString(), fieldLength);
    if (kept.contains(u'"'))
        kept.replace(u'"', "''"_L1);
    return text::properCase(kept);
}

TrackRows::TrackRows(ADODB::Recordset &records, qint64 nextDiscRowId, qint64 cdRunningId)
    : mRecords(records), mNextDiscRowId(nextDiscRowId)
{
    setCdRunningId(cdRunningId);
}

void TrackRows::setCdRunningId(qint64 id)
{
    mCdRunningId = id;
    mMainTitleIndex = QString::number(id);
}

void TrackRows::add(QStringView title, QStringView genre, QStringView year, int disc, int track)
{
    mRecords.AddNew();
    const auto set = [this](importfield::Column column, const ADODB::Value &value) {
        mRecords.Fields(column).setValue(value);
    };
    set(importfield::ListIndex, mNextDiscRowId++);
    set(importfield::Artist, mArtist);
    set(importfield::TrackTitle, treatedField(title));
    set(importfield::Genre, treatedField(genre));
    set(importfield::Hitjaar, year.toString());
    set(importfield::MainTitle, mMainTitle);
    set(importfield::MainTitleIndex, mMainTitleIndex);
    set(importfield::DiskIndex, QString::number(disc));
    set(importfield::TrackIndex, QString::number(track));
    mRecords.Update();
}
