#include "mp3/renaming.h"

#include "discdata/changedfiles.h"
#include "mp3/RenamePreview.h"
#include "mp3/renamingplan.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/messages.h"
#include "tags/filechanges.h"
#include "tags/tagerrors.h"

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
          mChanges(changedFiles(),
                   {Desktop::current().now(), GetMessage("xRenameFiles"), mPlan.folder()})
    {
    }

    void rename(const CollectionRow &row);
    bool isStopped() const { return mIsStopped || mScreen.isUnloaded(); }

private:
    bool mayTake(const CollectionRow &row, const NewName &name) const;
    bool move(const NewName &name);

    Form &mScreen;
    RenamingPlan mPlan;
    const Renamed &mRenamed;
    FileChanges mChanges; // one for the whole press
    bool mIsStopped = false;
};

void Renaming::rename(const CollectionRow &row)
{
    const NewName name = mPlan.nameFor(row);
    if (!mayTake(row, name) || mScreen.isUnloaded())
        return;
    const Hourglass hourglass(&mScreen);
    if (name.obstacle != NameObstacle::MovedAlready && !move(name))
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
                    GetMessage("xNameOfRowPart2"));
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
// that the move could not be taken back, which ends all.
bool Renaming::move(const NewName &name)
{
    try {
        mChanges.move(name.oldPath, name.newPath);
    } catch (const Error &error) {
        mIsStopped = error.Number == errChangeNotKept;
        if (mIsStopped)
            errorBox(error.Description);
        else if (error.Number == errNameRefused)
            errorBox(name.name + u": "_s + GetMessage("xNameLetterRefused"));
        return !mIsStopped && error.Number != errNameRefused;
    }
    return true;
}

} // namespace

void renameFiles(Form &screen, const QString &folder, const std::vector<CollectionRow> &rows,
                 const Renamed &renamed, const std::vector<CollectionRow> &collection)
{
    if (!LongWork::mayBegin(screen))
        return;
    LongWork work(screen, GetMessage("xRenaming"));
    Renaming renaming(screen, {folder, collection}, renamed);
    for (size_t done = 0; done < rows.size() && !renaming.isStopped();) {
        renaming.rename(rows[done]);
        if (!work.step(qint64(++done), qint64(rows.size())))
            return;
    }
}

void previewRenaming(Form &screen, const QString &folder, const std::vector<CollectionRow> &rows,
                     const std::vector<CollectionRow> &collection)
{
    if (!LongWork::mayBegin(screen))
        return;
    std::vector<PreviewedName> names;
    {
        LongWork work(screen, GetMessage("xLookingAtNames"));
        RenamingPlan plan(folder, collection);
        for (const CollectionRow &row : rows) {
            const NewName name = plan.nameFor(row);
            names.push_back({row.index, row[CollectionField::FileName], name});
            if (name.obstacle == NameObstacle::None || name.obstacle >= NameObstacle::IsThere)
                plan.pretend(row, name);
            if (!work.step(qint64(names.size()), qint64(rows.size())))
                return;
        }
    }
    (new RenamePreview(names))->ShowModal();
}
