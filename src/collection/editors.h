#pragma once

#include <QtGlobal>

/// How editors come up: a new one for each new record, and one per existing record.
namespace editors
{

void newCompilation();
void newAlbum();

// The editor of this record comes up if it is open already.
void editCompilation(qint64 id);
void editAlbum(qint64 id);

/// Brings up the editor of a record at one of its tracks, both counted from 1.
void editTrack(bool isCompilation, qint64 id, int disc, int track);

/// Deletes a record. An editor that is open on it keeps what it does not show, and knows that the
/// record is gone. Throws Error.
void deleteRecord(qint64 id);

/// Offers what earlier runs have not saved, one after the other. What is not wanted is gone then.
void offerUnsaved();

/// Saves what is open in editors, in the order in which they were opened.
void saveAll();

} // namespace editors
