#include "discdata/changedfiles.h"

#include "services/globals.h"
#include "tags/filejournal.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

FileJournal &changedFiles()
{
    static std::unique_ptr<FileJournal> journal;
    static QString folder;
    const QString now = QFileInfo(gDatabasePath).absolutePath() + u"/Changes"_s;
    if (!journal || folder != now) {
        journal = std::make_unique<FileJournal>(now);
        folder = now;
    }
    return *journal;
}
