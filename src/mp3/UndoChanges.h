#pragma once

#include "platform/desktop/form.h"
#include "tags/filejournal.h"

#include <memory>

class FittedColumns;
class LongWork;
namespace Ui
{
class UndoChanges;
}

/// Lists what the program has changed in the files of the user, newest first, one line for each
/// command, and takes back those that are chosen.
class UndoChanges : public Form
{
    Q_OBJECT

public:
    UndoChanges();
    ~UndoChanges() override;

protected:
    void Form_Load() override;
    void Form_Activate() override;

private:
    using Batches = std::vector<FileJournal::Batch>;
    void setTexts();
    static Batches allBatches(); // newest first
    void showBatches();
    Batches chosenBatches() const;
    void handleButtons();
    void cmdUndo_Click();
    void cmdClose_Click();
    void undo(const Batches &batches);
    FileJournal::Undone undoAll(const Batches &batches, LongWork &work);
    void follow(const FileJournal::Undone &undone);
    void setRunning(bool running);
    void tell(const FileJournal::Undone &undone);

    std::unique_ptr<Ui::UndoChanges> mUi;
    FittedColumns *mColumns;
    LongWork *mUndo = nullptr; // that runs
};
