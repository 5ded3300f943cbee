#include "mp3/renaming.h"

#include "discdata/changedfiles.h"
#include "mp3/RenamePreview.h"
#include "mp3/renamingplan.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/messages.h"
#include "tags/filechanges.h"
#include "tags/movedfile.h"
#include "tags/tagerrors.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

using Renamed = std::function<void(const CollectionRow &row, const QString &newName)>;

/// One press of the command.
class Renaming
{
public:
    Renaming(Form &screen, RenamingPlan plan, const Renamed &renamed)
        : mScreen(screen),
          mPlan(std::move(plan)),
          mRenamed(renamed),
          mChanges(changedFiles(), {Desktop::current().now(), u"xRenameFiles"_s, mPlan.folder()})
    {
    }

    bool rename(const CollectionRow &row); // false: another row has its name
    void tell(const CollectionRow &row) const { mayTake(row, mPlan.nameFor(row)); }
    bool isStopped() const { return mIsStopped || mScreen.isUnloaded(); }

private:
    bool mayTake(const CollectionRow &row, const NewName &name) const;
    using Over = std::optional<FileStamp>; // a file that the user has been asked about
    void take(const CollectionRow &row, const NewName &name, const Over &over);
    bool move(const NewName &name, const Over &over);

    Form &mScreen;
    RenamingPlan mPlan;
    const Renamed &mRenamed;
    FileChanges mChanges; // one for the whole press
    bool mIsStopped = false;
};

bool Renaming::rename(const CollectionRow &row)
{
    const NewName name = mPlan.nameFor(row);
    if (name.obstacle == NameObstacle::OfAnotherRow)
        return false;
    const Over over = name.obstacle == NameObstacle::IsThere ? findName(name.newPath) : Over();
    if (mayTake(row, name) && !mScreen.isUnloaded())
        take(row, name, over);
    return true;
}

void Renaming::take(const CollectionRow &row, const NewName &name, const Over &over)
{
    const Hourglass hourglass(&mScreen);
    if (name.obstacle != NameObstacle::MovedAlready && !move(name, over))
        return;
    mPlan.take(row, name);
    mRenamed(row, name.name);
}

// Whether the file may have its name; what is in the way is told, or asked.
bool Renaming::mayTake(const CollectionRow &row, const NewName &name) const
{
    const auto tell = [&](const QString &why) {
        errorBox(name.name + u": "_s + why);
        return false;
    };
    switch (name.obstacle) {
    case NameObstacle::TagMissing:
        errorBox(GetMessage("UnableToRenamePart1") + row[CollectionField::FileName] +
                 GetMessage("UnableToRenamePart2"));
        return false;
    case NameObstacle::ForbiddenSymbols:
        return tell(GetMessage("UnableToRenameForbiddenSymbols"));
    case NameObstacle::LetterRefused:
        return tell(GetMessage("xNameLetterRefused"));
    case NameObstacle::TooLong:
        return tell(GetMessage("xNameTooLong"));
    case NameObstacle::OfAnotherRow:
        return tell(GetMessage("xNameOfRowPart1") + QString::number(name.otherRow) +
                    GetMessage("xNameOfRowPart2") + row[CollectionField::FileName]);
    case NameObstacle::OfAFolder:
        return tell(GetMessage("xNameOfFolder"));
    case NameObstacle::IsThere: // its own name counts too
        return askYesNo(name.name + u": "_s + GetMessage("FileAlreadyExists")) == vbYes;
    case NameObstacle::None:
    case NameObstacle::FileGone:
    case NameObstacle::MovedAlready:
        break;
    }
    return true;
}

// By design: a move that fails says nothing, and the row takes the new name; it shows as missing
// when the list is read again. A name that the disk cannot have is told, and leaves the row; so is
// one that another file keeps, a file that a crash has left and that could not be put right yet,
// and that the move could not be taken back, which ends all.
bool Renaming::move(const NewName &name, const Over &over)
{
    try {
        mChanges.move(name.oldPath, name.newPath, over);
    } catch (const Error &error) {
        mIsStopped = error.Number == errChangeNotKept;
        const bool isRefused = error.Number == errNameRefused;
        const bool isKept = error.Number == errNotReplaced || error.Number == errTagNotAccessible;
        if (mIsStopped)
            errorBox(error.Description);
        else if (isRefused || isKept)
            errorBox(name.name + u": "_s +
                     (isRefused ? GetMessage("xNameLetterRefused") : error.Description));
        else
            return true;
        return false;
    }
    return true;
}

// Tries one row after the other. Those that are refused, since another row has their name, are
// tried again, the last first, for as long as that helps: the other one may get another name later.
// Gives what is left.
std::vector<size_t> tryInTurn(size_t rows, const std::function<bool(size_t row)> &attempt)
{
    std::vector<size_t> left;
    for (size_t row = 0; row < rows; ++row) {
        if (!attempt(row))
            left.insert(left.begin(), row);
    }
    while (std::erase_if(left, attempt) > 0) {
    }
    return {left.rbegin(), left.rend()};
}

// Every question is taken to be answered with Yes.
PreviewedName previewOf(const CollectionRow &row, RenamingPlan &plan)
{
    const NewName name = plan.nameFor(row);
    const bool goes = name.obstacle == NameObstacle::None || name.obstacle >= NameObstacle::IsThere;
    const bool isClosed = goes && plan.isFolderClosed(name);
    if (isClosed)
        plan.take(row, name); // as the row does, whatever becomes of the file
    else if (goes)
        plan.pretend(row, name);
    return {row.index, row[CollectionField::FileName], name, isClosed};
}

} // namespace

void renameFiles(Form &screen, const QString &folder, const std::vector<CollectionRow> &rows,
                 const Renamed &renamed, const std::vector<CollectionRow> &collection)
{
    if (!LongWork::mayBegin(screen))
        return;
    LongWork work(screen, GetMessage("xRenaming"));
    Renaming renaming(screen, {folder, collection}, renamed);
    const auto isOver = [&] { return renaming.isStopped() || work.isCancelled(); };
    const qint64 all = qint64(rows.size());
    qint64 done = 0;
    const auto left = tryInTurn(rows.size(), [&](size_t row) {
        const bool settled = isOver() || renaming.rename(rows[row]);
        if (!isOver())
            work.step(std::min(++done, all), all);
        return settled;
    });
    for (size_t row = 0; row < left.size() && !isOver(); ++row)
        renaming.tell(rows[left[row]]);
}

void previewRenaming(Form &screen, const QString &folder, const std::vector<CollectionRow> &rows,
                     const std::vector<CollectionRow> &collection)
{
    if (!LongWork::mayBegin(screen))
        return;
    std::vector<PreviewedName> names(rows.size());
    {
        LongWork work(screen, GetMessage("xLookingAtNames"));
        RenamingPlan plan(folder, collection);
        const qint64 all = qint64(rows.size());
        qint64 done = 0;
        tryInTurn(rows.size(), [&](size_t row) {
            if (work.isCancelled())
                return true;
            names[row] = previewOf(rows[row], plan);
            work.step(std::min(++done, all), all);
            return names[row].newName.obstacle != NameObstacle::OfAnotherRow;
        });
        if (work.isCancelled())
            return;
    }
    (new RenamePreview(names))->ShowModal();
}
