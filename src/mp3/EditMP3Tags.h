#pragma once

#include "discdata/cddbobjects.h"
#include "platform/desktop/form.h"
#include "tags/CddbID3Tag.h"

#include <memory>

class CDDBControl;
class CddbTagManager;
class QLineEdit;
class QPlainTextEdit;
namespace Ui
{
class EditMP3Tags;
}

/// Shows the ID3v2 tag of one MP3 file and changes it: by hand, from the services, from the
/// catalogue. Filling only changes the boxes; the file is written by saving alone.
class EditMP3Tags : public Form
{
    Q_OBJECT

public:
    EditMP3Tags();
    ~EditMP3Tags() override;

    /// The whole of it for one file, as a modal screen. Says so where the file cannot be read.
    static void edit(const QString &path);

    QString TagFilePath; // full name of the file; to be set before the load

    // To be called in this order before the form is shown. The first throws Error.
    void LoadTagInfo();
    void ShowTagItems();
    void EnableTagItems();

protected:
    void Form_Load() override;
    bool QueryUnload() override;
    void Form_Unload() override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    // A field is a line, or the larger box of the comments.
    struct Box {
        TagField field;
        QLineEdit *line;
        QPlainTextEdit *page;
        QString text() const;
        void setText(const QString &text) const;
        void selectAll() const;
        QWidget *widget() const;
    };
    void makeBoxes();
    void connectControls();
    void setCaptions();
    void offerGenres();
    void initialiseCddb();
    void disableTagItems();
    void keepField(const Box &box);
    static QString shownAs(const Box &box, const CddbID3Tag &tag);
    bool differsFrom(const CddbID3Tag &tag) const;
    bool TagInfoChanged() const;
    void showTag(const CddbID3Tag &tag);

    void cmdSaveTag_Click();
    bool save();
    void takeBoxes();
    void cmdOK_Click();
    void cmdCancel_Click();

    void cmdMatchFileWithCDDB_Click();
    void matchWithCddb();
    CddbDiscPtr lookUp();
    CddbDiscPtr chosenOf(const CddbMatchListPtr &matches);
    void substitute(const CddbDisc &disc);
    void cmdMatchFileWithSongCase_Click();
    void matchWithCatalogue();

    std::unique_ptr<Ui::EditMP3Tags> mUi;
    std::vector<Box> mBoxes;
    std::unique_ptr<CDDBControl> mControl;
    std::unique_ptr<CddbTagManager> TagManager;
    CddbID3Tag TagObject; // as it is in the file
    int MatchedTrack = 0; // found by a look-up or chosen
    bool ShowSaveMessages = true;
    bool SkipUnsavedCheck = false;
    bool mSaveTried = false; // by cmdOK
};
