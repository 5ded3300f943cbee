#pragma once

#include <QByteArray>
#include <QSet>
#include <QString>

/// Catalogues that a disk has damaged, and what the program makes of them.
namespace damage
{

/// The bytes of a catalogue with discs, and with some rows to which nothing points.
const QByteArray &wholeCatalogue();

/// The same with a damage, always the same for a number: a few bytes, or pages in wrong places.
/// Half of them lie in indexes.
QByteArray damagedCatalogue(unsigned number);

/// What the program is to think of the size of a file: below a limit, indexes are compared with
/// their tables when it is opened; above, only the pages are looked at.
enum class Size { Small, Large };

struct Outcome {
    bool opened = false;
    bool toldWhileCleaning = false; // by a box
    QSet<QString> lost; // rows that were there to be read before and that nobody wanted gone
};

/// Starts and ends with such a catalogue: opens it, cleans up, closes it.
Outcome startAndEnd(const QByteArray &catalogue, Size size);

} // namespace damage
