#include "mp3/EditMP3Tags.h"

#include "catalogue/genres.h"
#include "discdata/cddbcontrol.h"
#include "discdata/cddbtagmanager.h"
#include "mp3/ui_EditMP3Tags.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/passingwheel.h"
#include "platform/work/longwork.h"
#include "services/captions.h"
#include "services/fileutilities.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "tags/soundfacts.h"
#include "tags/tagerrors.h"

#include <QCompleter>
#include <QDir>
#include <QKeyEvent>
#include <QLocale>

using namespace Qt::StringLiterals;

namespace
{

constexpr int longestText = 1 << 24; // a field cuts nothing off a tag

// The middle of a long one is left out.
QString shortened(const QString &path)
{
    constexpr qsizetype longest = 75, kept = 35;
    return path.size() > longest ? path.left(kept) + u"..."_s + path.right(kept) : path;
}

// "3:45, 192 kbit/s, ID3v2.3"
QString factsLine(const QString &path)
{
    const auto facts = soundFacts(path);
    if (!facts)
        return GetMessage("xNoSound");
    const int seconds = (facts->length + 500) / 1000;
    QStringList parts{QString::number(seconds / 60) + u':' +
                      QString::number(seconds % 60).rightJustified(2, u'0')};
    if (facts->bitRate > 0)
        parts.append(QString::number(facts->bitRate) + u" kbit/s"_s);
    parts.append(facts->tagVersion.isEmpty() ? GetMessage("xNoTagYet") : facts->tagVersion);
    return parts.join(u", "_s);
}

} // namespace

QString EditMP3Tags::Box::text() const
{
    return page ? page->toPlainText() : line->text();
}

// A long one shows from its beginning.
void EditMP3Tags::Box::setText(const QString &text) const
{
    if (page) {
        page->setPlainText(text);
    } else {
        line->setText(text);
        line->setCursorPosition(0);
    }
}

void EditMP3Tags::Box::selectAll() const
{
    if (page)
        page->selectAll();
    else
        line->selectAll();
}

// The list of genres belongs to its line.
QWidget *EditMP3Tags::Box::widget() const
{
    if (page)
        return page;
    auto *list = qobject_cast<QComboBox *>(line->parentWidget());
    return list ? static_cast<QWidget *>(list) : line;
}

EditMP3Tags::EditMP3Tags()
    : Form(u"EditMP3Tags"_s),
      mUi(std::make_unique<Ui::EditMP3Tags>()),
      mControl(std::make_unique<CDDBControl>()),
      TagManager(mControl->GetTagManager())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->cmdOK);
    offerGenres();
    makeBoxes();
    connectControls();
}

EditMP3Tags::~EditMP3Tags() = default;

void EditMP3Tags::edit(const QString &path)
{
    auto &editor = defaultInstance<EditMP3Tags>();
    editor.TagFilePath = path;
    try {
        editor.Load();
        editor.LoadTagInfo();
        editor.ShowTagItems();
        editor.EnableTagItems();
        editor.ShowModal();
    } catch (const Error &error) {
        errorBox(error.Description);
        editor.Unload();
    }
}

void EditMP3Tags::offerGenres()
{
    auto *exact = new QCompleter(this); // one blind to case would put "Folk" over a typed "folk"
    exact->setCaseSensitivity(Qt::CaseSensitive);
    mUi->txtGenre->setCompleter(exact);
    mUi->txtGenre->addItems(genres(gLanguage));
    mUi->txtGenre->setCurrentIndex(-1);
    ignorePassingWheel(mUi->txtGenre);
}

// The last one is always disabled.
void EditMP3Tags::makeBoxes()
{
    using enum TagField;
    mBoxes = {{LeadArtist, mUi->txtArtist, nullptr},
              {Album, mUi->txtTitle, nullptr},
              {Title, mUi->txtTrackTitle, nullptr},
              {TrackPosition, mUi->txtTrack, nullptr},
              {PartOfSet, mUi->txtPartOfSet, nullptr},
              {Year, mUi->txtYear, nullptr},
              {Genre, mUi->txtGenre->lineEdit(), nullptr},
              {CopyrightHolder, mUi->txtCopyRightHolder, nullptr},
              {Label, mUi->txtlabel, nullptr},
              {Comments, nullptr, mUi->txtcomments},
              {FileId, mUi->txtFileID, nullptr}};
    for (const Box &box : mBoxes) {
        if (box.line)
            box.line->setMaxLength(longestText);
        if (box.field == FileId)
            continue;
        if (box.page)
            connect(box.page, &QPlainTextEdit::textChanged, this, [=, this] { keepField(box); });
        else
            connect(box.line, &QLineEdit::textChanged, this, [=, this] { keepField(box); });
    }
}

void EditMP3Tags::connectControls()
{
    const auto on = [this](QPushButton *button, auto command) {
        connect(button, &QPushButton::clicked, this, command);
    };
    on(mUi->cmdMatchFileWithCDDB, &EditMP3Tags::cmdMatchFileWithCDDB_Click);
    on(mUi->cmdMatchFileWithSongCase, &EditMP3Tags::cmdMatchFileWithSongCase_Click);
    on(mUi->cmdSaveTag, &EditMP3Tags::cmdSaveTag_Click);
    on(mUi->cmdOK, &EditMP3Tags::cmdOK_Click);
    on(mUi->cmdCancel, &EditMP3Tags::cmdCancel_Click);
}

void EditMP3Tags::setCaptions()
{
    applyCaptions(this, {{"EditMP3Tags", "EditMP3TagCaption"},
                         {"lblFilename", "lblFilename"},
                         {"fraId3TagInfo", "fraId3TagInfo"},
                         {"lblTitle", "lblTitle"},
                         {"lblArtist", "lblArtist"},
                         {"lblTrackTitle", "lblTrackTitle"},
                         {"lblTrack", "lblTrack"},
                         {"lblPartOfSet", "lblPartOfSet"},
                         {"lblYear", "lblMP3Year"},
                         {"lblGenre", "lblMP3Genre"},
                         {"lblCopyRightHolder", "lblCopyRightHolder"},
                         {"lblLabel", "lblLabel"},
                         {"lblComments", "TagsProcComments"},
                         {"lblFileID", "xFileId"},
                         {"cmdMatchFileWithCDDB", "cmdMatchFileWithCDDB"},
                         {"cmdMatchFileWithSongCase", "cmdMatchFileWithSongCase"},
                         {"cmdSaveTag", "cmdSaveTag"},
                         {"cmdCancel", "cmdMP3Cancel"},
                         {"cmdOK", "cmdMP3OK"}});
}

void EditMP3Tags::Form_Load()
{
    TagObject = {};
    disableTagItems();
    ShowSaveMessages = true;
    SkipUnsavedCheck = false;
    setCaptions();
    placeInFrame(this, 0.25, 0.25);
    initialiseCddb();
}

void EditMP3Tags::initialiseCddb()
{
    try {
        setUpCddb(*mControl, this, false);
        if (mControl->IsUserRegistered(0) == 0)
            mControl->IsUserRegistered(1);
    } catch (const Error &error) {
        showCddbError(error);
    }
}

void EditMP3Tags::Form_Unload()
{
    mControl->ShutDown();
    TagObject = {};
}

void EditMP3Tags::LoadTagInfo()
{
    TagObject.LoadFromFile(TagFilePath, 1);
    mUi->lblSound->setText(factsLine(TagFilePath));
}

void EditMP3Tags::ShowTagItems()
{
    const QString shown = QDir::toNativeSeparators(TagFilePath);
    mUi->txtFileName->setText(shortened(shown));
    mUi->txtFileName->setToolTip(shown.toHtmlEscaped());
    showTag(TagObject);
}

void EditMP3Tags::showTag(const CddbID3Tag &tag)
{
    for (const Box &box : mBoxes)
        box.setText(tag.field(box.field));
}

void EditMP3Tags::EnableTagItems()
{
    for (const Box &box : mBoxes)
        box.widget()->setEnabled(box.field != TagField::FileId);
    for (QPushButton *button : {mUi->cmdMatchFileWithCDDB, mUi->cmdSaveTag, mUi->cmdOK})
        button->setEnabled(true);
    mUi->txtArtist->setFocus();
}

void EditMP3Tags::disableTagItems()
{
    for (const Box &box : mBoxes)
        box.widget()->setEnabled(false);
    for (QPushButton *button : {mUi->cmdMatchFileWithCDDB, mUi->cmdSaveTag, mUi->cmdOK})
        button->setEnabled(false);
}

// By design: what a file has cannot be made empty, only written over, by a blank at the least.
void EditMP3Tags::keepField(const Box &box)
{
    if (!box.text().isEmpty() || TagObject.field(box.field).isEmpty())
        return;
    box.setText(u" "_s);
    box.selectAll(); // what is typed next takes its place
}

// The larger box knows one kind of line end.
QString EditMP3Tags::shownAs(const Box &box, const CddbID3Tag &tag)
{
    QString text = tag.field(box.field);
    if (!box.page)
        return text;
    text.replace(u"\r\n"_s, u"\n"_s);
    for (const char16_t lineEnd :
         {u'\r', char16_t(QChar::ParagraphSeparator), char16_t(QChar::LineSeparator)})
        text.replace(QChar(lineEnd), u'\n');
    return text.replace(QChar(QChar::Nbsp), u' ');
}

bool EditMP3Tags::differsFrom(const CddbID3Tag &tag) const
{
    return std::ranges::any_of(mBoxes,
                               [&](const Box &box) { return box.text() != shownAs(box, tag); });
}

bool EditMP3Tags::TagInfoChanged() const
{
    return differsFrom(TagObject);
}

void EditMP3Tags::cmdSaveTag_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    if (!TagInfoChanged()) {
        if (ShowSaveMessages)
            informationBox(GetMessage("NoChangesToSave"));
        return;
    }
    try {
        if (!save())
            errorBox(GetMessage("CouldNotSaveMP3TagPart1") + TagFilePath +
                     GetMessage("CouldNotSaveMP3TagPart2"));
        else if (ShowSaveMessages)
            informationBox(GetMessage("AllMP3TagsSaved"));
    } catch (const Error &error) {
        errorBox(error.Number == errTagNotAccessible ? GetMessage("TagCannotBeSavedFileAccess")
                                                     : error.numbered());
    }
}

// False: there is no such file any more.
bool EditMP3Tags::save()
{
    const Hourglass hourglass(this);
    if (!FileExists(TagFilePath))
        return false;
    takeBoxes();
    TagManager->SaveTagToFile(TagObject, TagFilePath, 1);
    gTagsChanged = true;
    mUi->lblSound->setText(factsLine(TagFilePath));
    return true;
}

// By design: what was taken stays so if the file cannot be written.
void EditMP3Tags::takeBoxes()
{
    for (const Box &box : mBoxes) {
        if (box.text() != shownAs(box, TagObject))
            TagObject.setField(box.field, box.text());
    }
}

// By design: it closes whether the file could be written or not, and what could not be saved is not
// asked for once more.
void EditMP3Tags::cmdOK_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    ShowSaveMessages = false;
    if (TagInfoChanged())
        cmdSaveTag_Click();
    mSaveTried = true;
    Unload();
}

void EditMP3Tags::cmdCancel_Click()
{
    if (isBusy())
        return;
    SkipUnsavedCheck = true;
    ShowSaveMessages = false;
    Unload();
}

// Not the button: that drops the changes without a question.
void EditMP3Tags::keyPressEvent(QKeyEvent *event)
{
    if (event->key() == Qt::Key_Escape)
        Unload();
    else
        Form::keyPressEvent(event);
}

// By design: the user has no way to stay. It stays while nothing can be saved.
bool EditMP3Tags::QueryUnload()
{
    if (SkipUnsavedCheck || mSaveTried || !TagInfoChanged())
        return true;
    if (!LongWork::mayBegin(*this))
        return false;
    if (askYesNo(GetMessage("MP3UnsavedChanges")) == vbYes)
        cmdSaveTag_Click();
    return true;
}
