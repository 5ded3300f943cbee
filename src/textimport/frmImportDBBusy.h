#pragma once

#include "platform/desktop/form.h"
#include "textimport/catalogueload.h"

#include <memory>

class QTimer;
namespace Ui
{
class frmImportDBBusy;
}

/// Loads gImportRecords into the catalogue as soon as it is on the screen and shows how far it has
/// come. All of them get there or none. It cannot be closed meanwhile.
class frmImportDBBusy : public Form
{
    Q_OBJECT

public:
    frmImportDBBusy();
    ~frmImportDBBusy() override;

protected:
    void Form_Load() override;
    void Form_Unload() override;

private:
    void StartImporting_Timer();
    void load();
    CatalogueLoad::Outcome run(CatalogueLoad &load);
    void tellImported(qsizetype count);
    void tellCancelled();
    void resetPointers();

    std::unique_ptr<Ui::frmImportDBBusy> mUi;
    QTimer *mStartImporting;
};
