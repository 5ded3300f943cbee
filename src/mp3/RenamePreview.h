#pragma once

#include "mp3/renamingplan.h"
#include "platform/desktop/form.h"

#include <memory>

class FittedColumns;
namespace Ui
{
class RenamePreview;
}

/// A row whose file is to be renamed.
struct PreviewedName {
    int row = 0;
    QString oldName;
    NewName newName;
    bool isFolderClosed = false; // the file cannot have another name
};

/// Shows which names files are to get, before anything is touched; what will not go by itself
/// stands bold, with a remark.
class RenamePreview : public Form
{
    Q_OBJECT

public:
    explicit RenamePreview(const std::vector<PreviewedName> &names);
    ~RenamePreview() override;

protected:
    void Form_Load() override;
    void Form_Activate() override;

private:
    void fillList(const std::vector<PreviewedName> &names);
    void countNames(const std::vector<PreviewedName> &names);

    std::unique_ptr<Ui::RenamePreview> mUi;
    FittedColumns *mColumns;
};
