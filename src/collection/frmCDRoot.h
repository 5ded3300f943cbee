#pragma once

#include "collection/cdeditor.h"

#include <memory>

namespace Ui
{
class frmCDRoot;
}

/// The editor of one compilation: title, genre and hit year for the whole record, any number of
/// discs, and tracks with an artist each.
class frmCDRoot : public CdEditor
{
    Q_OBJECT

public:
    frmCDRoot();
    ~frmCDRoot() override;

protected:
    const char *gapIn(const Header &header) const override;
    QString selectRecord(qint64 id) const override;
    QString insertTitle(qint64 id, const Header &header) const override;
    QString updateTitle(qint64 id, const Header &header) const override;
    QWidget *behindLastTrack() const override;
    void RestoreDiskPosition() override;

private:
    void setTexts();

    std::unique_ptr<Ui::frmCDRoot> mUi;
};
