#pragma once

#include "collection/cdeditor.h"

#include <memory>

namespace Ui
{
class frmCDRootE;
}

/// The editor of one album: as that of a compilation, with one artist for the whole record. A
/// change of the artist never renames one: it picks or makes another, and the tracks of the album
/// move to it.
class frmCDRootE : public CdEditor
{
    Q_OBJECT

public:
    frmCDRootE();
    ~frmCDRootE() override;

protected:
    const char *gapIn(const Header &header) const override;
    QString selectRecord(qint64 id) const override;
    QString insertTitle(qint64 id, const Header &header) const override;
    QString updateTitle(qint64 id, const Header &header) const override;
    void beforeTitle(const Header &header) override;
    void afterTitle(const Header &header, const Header &saved) override;
    Header asStored(const Header &header) override;
    QWidget *behindLastTrack() const override;

private:
    void setTexts();

    std::unique_ptr<Ui::frmCDRootE> mUi;
    qint64 mArtistId = 0; // during a save
};
