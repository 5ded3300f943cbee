#pragma once

#include "discdata/cddbobjects.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/form.h"

class CDDBControl;
class ListColumns;
class MMControl;
namespace Ui
{
class frmDiscInfoCDDB;
}

/// Looks an audio disc up at the services and shows it: from here it is imported, edited in the
/// control's editor, and sent back. The fields only show; the editor alone changes the disc.
class frmDiscInfoCDDB : public Form
{
    Q_OBJECT

public:
    frmDiscInfoCDDB();
    ~frmDiscInfoCDDB() override;

protected:
    void Form_Load() override;
    void Form_Activate() override;
    void Form_Unload() override;

private:
    void connectControls();
    void keepReadable();
    void setCaptions();
    void setButtonsEnabled(bool enabled);
    void InitializeCDDBControl();
    void ClearDiscInfo();

    // Look-up.
    void cmdDownload_Click();
    void download();
    std::optional<QString> deviceName();
    bool openDevice(const QString &device);
    bool readToc();
    void LookupCurrentDisc();
    void lookUp();
    void takeOneOf(const CddbMatchListPtr &list);
    void newDisc();

    // The disc on show.
    void ShowDiscInfo(const CddbDiscPtr &disc);
    void showFields(const CddbDisc &disc);
    void makeTrackRows(const CddbDisc &disc);
    void showTracks(bool withArtist);
    QString genreName(const QString &id) const;

    // Import, edit, send.
    void cmdImport_Click();
    const char *importRefusal() const;
    bool isComplete() const;
    void ImportDisc();
    void cmdUpdateInfo_Click();
    void cmdSubmitDisc_Click();

    std::unique_ptr<Ui::frmDiscInfoCDDB> mUi;
    std::unique_ptr<CDDBControl> TheCDDB;
    std::unique_ptr<MMControl> MCICtl;
    CddbDiscPtr mDisc;              // on show
    QString mFolder;                // where the last image or folder was chosen
    QString mToc;                   // read last
    CddbGenreListPtr mGenres;       // fetched anew at each look-up
    ADODB::RecordsetPtr mTrackRows; // source of the list and of the import
    int mEditFlags = 0; // last flags of the editor; 2 as it begins, 1 after a submission
    ListColumns *mColumns = nullptr;
};
