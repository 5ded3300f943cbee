#pragma once

#include "controls/tracks/trackrow.h"
#include "discs/discrecord.h"
#include "discs/toc.h"
#include "platform/desktop/form.h"

#include <memory>

class TrackGrid;
namespace Ui
{
class DiscEditor;
}

/// The editor of a disc of a service: kind, part of the set, artist, title, year, genre and the
/// tracks, as many as the disc has. A disc that is new to the services has a box that says whether
/// it is sent.
class DiscEditor : public Form
{
    Q_OBJECT

public:
    /// `toc` is the disc that a new record describes; nothing for one that is not new.
    DiscEditor(const DiscRecord &disc, const std::optional<TableOfContents> &toc,
               const QStringList &genres);
    ~DiscEditor() override;

    bool isAccepted() const { return mAccepted; }
    const DiscRecord &disc() const { return mDisc; } // as accepted
    bool isChanged() const { return mChanged; }
    bool isToBeSent() const;

protected:
    void Form_Load() override;
    void Form_Activate() override;
    bool QueryUnload() override;

private:
    void setCaptions();
    void connectControls();
    void show();
    void showTracks();
    void showCategories();
    TrackGrid *grid() const;
    void OptCmp_Change();
    DiscRecord shown() const;
    ArtistName shownArtist() const;
    void takeTracks(DiscRecord &disc) const;
    bool refusesYears();
    bool refusesSending(const DiscRecord &disc);
    void OKButton_Click();

    std::unique_ptr<Ui::DiscEditor> mUi;
    DiscRecord mDisc, mBefore;  // before: as the fields showed it first
    QList<StoredTrack> mTracks; // as last shown: what one of the grids leaves out stays
    const std::optional<TableOfContents> mNewToc;
    const bool mIsNew;
    bool mChanged = false;
    bool mAccepted = false;
};
