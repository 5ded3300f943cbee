#pragma once

#include <QStringList>

// What songcase-work can do: each command is what a screen does, with the program's own code, and
// prints what it did. Failures are Error or an error box.

void newCatalogue(const QStringList &arguments);     // CATALOGUE
void browse(const QStringList &arguments);           // CATALOGUE
void readText(const QStringList &arguments);         // FORMAT FILE
void loadText(const QStringList &arguments);         // CATALOGUE FORMAT FILE
void removeOrphans(const QStringList &arguments);    // CATALOGUE
void search(const QStringList &arguments);           // CATALOGUE MODE FIELD WORD
void exportAll(const QStringList &arguments);        // CATALOGUE FILE
void lookUpDisc(const QStringList &arguments);       // TOC SERVICE+ADDRESS
void importDisc(const QStringList &arguments);       // CATALOGUE FILE
void addCollection(const QStringList &arguments);    // CATALOGUE FOLDER TITLE
void readTags(const QStringList &arguments);         // FOLDER
void openCollection(const QStringList &arguments);   // CATALOGUE ID
void renameCollection(const QStringList &arguments); // CATALOGUE ID
void saveTag(const QStringList &arguments);          // FILE FIELD VALUE; a folder: all files in it
void convertOld(const QStringList &arguments);       // CATALOGUE OLDFILE
