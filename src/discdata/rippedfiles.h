#pragma once

#include "discs/toc.h"
#include "tags/playingtime.h"

#include <QStringList>
#include <functional>
#include <stop_token>

/// A file of sound in a folder, as a track of a disc.
struct RippedFile {
    QString name;
    SoundFile sound;
};

/// The names of all files in a folder, also of those that are no UTF-8, which the toolkit leaves
/// out: "2 Second" stands before "10 Tenth".
QStringList filesIn(const QString &folder);

/// Those of a folder whose names are wanted, in this order. Of the first that cannot be read
/// `unreadable` is the full name: without it the others would be another disc. More than a thousand
/// are no disc either and are left out.
std::vector<RippedFile> soundFilesIn(const QString &folder,
                                     const std::function<bool(const QString &name)> &isWanted,
                                     const std::stop_token &stop, QString &unreadable);

/// Whether the tags of all have a number, and each another one.
bool haveNumbers(const std::vector<RippedFile> &files);
void sortByNumbers(std::vector<RippedFile> &files);

/// The disc that they would make, one behind the other; nothing where no disc can have it.
std::optional<TableOfContents> tocOf(const std::vector<RippedFile> &files);
