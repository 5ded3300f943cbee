#pragma once

#include "collection/searchstatement.h"
#include "platform/desktop/form.h"

#include <memory>

class ListColumns;
class ListItem;
class LongWork;
class QLineEdit;
namespace Ui
{
class frmSearchArtistsTitles;
}

/// Finds songs in the whole catalogue by artist, title, genre and hit year, shows on which disc
/// each stands, and writes what was found to a text file. It only reads the catalogue.
class frmSearchArtistsTitles : public Form
{
    Q_OBJECT

public:
    frmSearchArtistsTitles();
    ~frmSearchArtistsTitles() override;

protected:
    void Form_Load() override;
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void connectControls();
    void setCaptions();
    void cmdSearch_Click();
    void cmdExport_Click();
    void cmdCancel_Click();
    void ResultList_ColumnClick(int column);
    void ResultList_Enter();

    SearchKey key() const;
    bool checkYears(const SearchKey &key);
    void refuse(const char *message, QLineEdit *field);
    void show(const SearchKey &key);
    void showNothing();
    void showFound(qsizetype count);
    void openDisc(const ListItem &item);

    void exportTo(const QString &name);
    bool writeResult(const QString &name, LongWork &work);
    void setExporting(bool exporting);

    std::unique_ptr<Ui::frmSearchArtistsTitles> mUi;
    ListColumns *mColumns;
    LongWork *mExport = nullptr; // while it runs
};
