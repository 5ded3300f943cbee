#pragma once

#include "mp3/collectionrow.h"
#include "mp3/followednames.h"
#include "mp3/tagreading.h"
#include "platform/ado/recordset.h"

#include <QSet>

class LongWork;

/// The rows of a collection in memory: as they are now and as they were loaded. Nothing here writes
/// to a catalogue. Rows count from 0; Volgnummer runs from 1 without a gap.
class CollectionRows
{
public:
    ADODB::RecordsetPtr WorkingRecords;  // what the list shows
    ADODB::RecordsetPtr BaselineRecords; // never changed

    void load(qint64 collection); // throws Error

    qsizetype count() const { return WorkingRecords->RecordCount(); }
    QString fileName(qsizetype row) const;
    QSet<QString> fileNames() const; // those with "\" as the separator both ways
    bool isMissing(qsizetype row) const;

    /// Whether rows were added, deleted, moved or given another name since the load.
    bool haveChanged() const;

    void append(const QStringList &fileNames);

    /// By design: for each name the first row that has it goes. Of two rows with one name a person
    /// sees the same.
    void remove(const QStringList &fileNames);
    void removeAll();

    /// The row ends at this place; all others keep their order.
    void move(qsizetype from, qsizetype to);

    /// By Volgnummer, in all rows with it.
    void setFileNames(const QHash<QString, QString> &names);

    /// Files were renamed from outside, in the catalogue too.
    void followNames(const RenamedFiles &renamed, const QString &folder);

    /// What a reading has found besides the tags.
    struct Reading {
        bool folderExists = false;
        bool allExist = true;
        bool cancelled = false;
        QStringList unreadable; // newly found so
    };

    /// Brings the rows up to date with the files, which are read by workers. Of a reading that is
    /// cancelled the rows that it has not come to are empty until readAnew().
    Reading read(const QString &folder, LongWork &work);
    void readAnew();

private:
    void arrange(const std::vector<std::uint32_t> &order);
    void take(qsizetype row, FileFound &&found, Reading &reading);
    void writeTexts(qsizetype row, const FileFound &found);
    void write(CollectionField field, const QString &text);

    std::vector<FileMemory> mFiles; // of the rows
};
