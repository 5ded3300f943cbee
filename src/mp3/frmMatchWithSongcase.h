#pragma once

#include "mp3/matchstatements.h"
#include "platform/desktop/form.h"

#include <memory>

class MatchTree;
namespace Ui
{
class frmMatchWithSongcase;
}

/// Finds a disc of the catalogue, or a track of one, by artist and title, for the tags of files.
/// What was chosen stands in the globals of matchchoice.h.
class frmMatchWithSongcase : public Form
{
    Q_OBJECT

public:
    frmMatchWithSongcase();
    ~frmMatchWithSongcase() override;

    // Set by the caller before the form is shown.
    int NumberOfTracks = -99;  // discs must have this number of tracks; -99: any
    bool ChooseTracks = false; // the tree lists the tracks too, and one must be chosen
    QString Artist, Title;     // proposed
    int Track = 0;             // the one that is chosen first where a single disc is found; 0: any

protected:
    void Form_Load() override;
    void Form_Activate() override;
    void Form_Unload() override;
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void setCaptions();
    void connectControls();
    void followChecks();
    void FillTreeWithDefaultText();
    MatchQuestion question() const;
    void cmdSearch_Click();
    void search();
    void proposeTrack();
    void showNothing();
    void cmdChoose_Click();

    std::unique_ptr<Ui::frmMatchWithSongcase> mUi;
    MatchTree *mTree;
    bool mChosen = false;
    bool mShown = false; // once
};
