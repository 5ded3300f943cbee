#pragma once

#include "mp3/collectionrow.h"

#include <functional>
#include <vector>

class Form;
class QString;

/// Gives the files of these rows, those selected of a collection, the names that their tags make,
/// one after the other: number-artist-title.mp3, in the sub-folder where they are. What stands in
/// the way is told and asked here; a name that a row of `collection` has already is never taken
/// from it. `renamed` puts the new name into a row. The screen is busy meanwhile; nothing
/// happens if it or another one is so already.
void renameFiles(
    Form &screen, const QString &folder, const std::vector<CollectionRow> &rows,
    const std::function<void(const CollectionRow &row, const QString &newName)> &renamed,
    const std::vector<CollectionRow> &collection);

/// Shows what renameFiles() would do, on a screen of its own. Nothing is touched.
void previewRenaming(Form &screen, const QString &folder, const std::vector<CollectionRow> &rows,
                     const std::vector<CollectionRow> &collection);
