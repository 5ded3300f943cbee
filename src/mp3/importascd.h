#pragma once

#include "mp3/collectionrow.h"

#include <vector>

class Form;
class QString;

/// Makes a record of the catalogue out of the selected rows of a collection, of what their tags
/// say: an album if one artist sings them all, else a compilation, as a box set if the tags tell of
/// several discs. Asks and tells, and writes in one transaction, over gConnection. The screen is
/// busy meanwhile; nothing happens if it or another one is so already.
void importAsCD(Form &screen, const QString &collectionTitle,
                const std::vector<CollectionRow> &rows);
