#pragma once

#include <QString>
#include <QStringList>
#include <memory>
#include <stop_token>

class QWidget;

extern QStringList gFoundFiles;      // what the last walk of folders has found
extern QString gBrowseInitialFolder; // where the folder dialog starts

/// Whether a file may be written under this name: nothing has it, or the user lets it be replaced.
bool mayWrite(const QString &name);

/// Where a dialog for a file to save begins: where the last one was saved in this run.
QString saveFolder();
void rememberSaveFolder(const QString &fileName);

/// Whether a file, a folder or anything that a pattern with * and ? fits is there.
bool FileExists(const QString &path);

/// Whether a folder or a drive of this name is there. Blanks around and one separator at the end do
/// not count.
bool DirExists(QString path);
bool IsDriveRoot(const QString &text);

/// The text up to the first NUL, in place and as the result.
QString StripAtNull(QString &s);

/// All files below a folder whose names fit the pattern, the folder's own first, each folder's in
/// the order of their names. Folders with "Processed" in their path are not entered, files below
/// "SYSTEM FILES" not listed.
QStringList FindFilesInTree(const QString &path, const QString &pattern, int mode);

/// The same for a worker: nothing of the program is touched. Those found so far when it is stopped.
QStringList filesInTree(const QString &path, const QString &pattern, const std::stop_token &stop);

/// The same into gFoundFiles; gives the sum of the sizes of the files in bytes.
double ScanFolderTree(const QString &path, const QString &pattern, int fileCount, int folderCount);

/// True when the move failed, as between two disks. An existing file of the new name is replaced.
/// After false the new name is on the disk and outlives a power cut.
bool MoveFileReplace(const QString &from, const QString &to);

/// An empty text when the dialog was cancelled.
QString BrowseForFolderDialog(const QString &title, const QString &initialFolder);

/// The stored name of a file as this system writes it: as it is if such a file is there, else with
/// "\" taken as the separator, and with letters composed or decomposed as they are on the disk.
QString systemPath(const QString &stored);
