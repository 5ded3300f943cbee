#pragma once

#include <QtGlobal>

/// How the editors of MP3 collections come up: a new one for each new collection, and one per
/// collection that is stored.
namespace collections
{

void open();
void edit(qint64 collection);

/// The catalogue has this collection no longer: its editor says so.
void tellDeleted(qint64 collection);

} // namespace collections
