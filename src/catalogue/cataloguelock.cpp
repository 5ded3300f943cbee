#include "catalogue/cataloguelock.h"

#include "platform/files/wholefile.h"

#include <QFile>
#include <QFileInfo>
#include <utility>

using namespace Qt::StringLiterals;

CatalogueLock::~CatalogueLock()
{
    if (!mMark.isEmpty())
        QFile::remove(mMark);
}

CatalogueLock::CatalogueLock(CatalogueLock &&other) noexcept
{
    *this = std::move(other);
}

CatalogueLock &CatalogueLock::operator=(CatalogueLock &&other) noexcept
{
    std::swap(mLock, other.mLock);
    std::swap(mMark, other.mMark);
    std::swap(mLastRunBroken, other.mLastRunBroken);
    return *this;
}

FileLock::Outcome CatalogueLock::take(const QString &catalogue)
{
    return mLock.take(catalogue);
}

// On the disk before a statement runs: a power cut is an end like any other.
void CatalogueLock::markRunning(const QString &catalogue)
{
    const QString mark = QFileInfo(catalogue).canonicalFilePath() + u".running"_s;
    mLastRunBroken = QFile::exists(mark);
    QFile file(mark);
    if (!file.open(QIODevice::WriteOnly))
        return; // nothing can be written here: the catalogue itself will tell
    mMark = mark;
    syncFolder(QFileInfo(mark).path());
}
