#pragma once

#include "discdata/cddbobjects.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/form.h"
#include "tags/CddbID3Tag.h"

class CDDBControl;
class CddbTagManager;
class ListColumns;
class MatchedCells;
namespace Ui
{
class frmTagWizardPg1;
}

/// The Tags Processor: the files of a list are all the tracks of one disc, in their order. The disc
/// is found by a checked file at the services, or chosen from the catalogue; its data fill the
/// rows, and saving writes those into the files. Until then the rows alone hold them.
class frmTagWizardPg1 : public Form
{
    Q_OBJECT

public:
    frmTagWizardPg1();
    ~frmTagWizardPg1() override;

    // Set by the caller before the form is shown.
    QString Folder; // of the files, a separator behind it
    /// Nr, Filename, Album, Artist, Title, TrackPosition, PartOfSet, TrackYear, Genre,
    /// CopyrightHolder, Label, Comments, ID.
    ADODB::RecordsetPtr FileRecords;

protected:
    void Form_Load() override;
    void Form_Activate() override;
    void Form_Unload() override;

private:
    void setCaptions();
    void connectControls();
    void InitializeCDDBControl();
    void fillList();
    void followChecks();
    bool AnyFileChecked() const;
    bool AnyTagPresent() const;
    int rowCount() const;
    QString pathOf(int row) const; // from 1

    void OKButton_Click();
    bool match();
    bool matchChecked();
    bool MatchFileWithCDDB(const QString &path);
    CddbDiscPtr lookUp(const QString &path, CddbMatchListPtr &matches);
    CddbDiscPtr chosenOf(const CddbMatchListPtr &matches);
    bool takeDisc(const CddbDisc &disc);
    bool MatchFilesWithCatalogue(int count);
    bool chooseFromCatalogue(int count);
    void fillRows(const std::vector<CddbID3Tag> &tags);

    struct Saved;
    CddbID3Tag tagOfRow(int row) const;
    void cmdSaveTags_Click();
    void save(Saved &saved);
    void saveOne(const QString &path, const CddbID3Tag &tag, Saved &saved);
    bool tellSaved(const Saved &saved);

    std::unique_ptr<Ui::frmTagWizardPg1> mUi;
    std::unique_ptr<CDDBControl> mControl;
    std::unique_ptr<CddbTagManager> mTagManager;
    ListColumns *mColumns;
    MatchedCells *mCells;
    bool mIsSetUp = false, mSignUpAsked = false;
    bool mPassOver = false;  // the next activation only follows the end of a dialog of our own
    bool mCancelled = false; // the match, by the user
};
