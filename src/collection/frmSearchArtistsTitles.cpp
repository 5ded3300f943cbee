#include "collection/frmSearchArtistsTitles.h"

#include "collection/editors.h"
#include "collection/foundtrack.h"
#include "collection/resultlines.h"
#include "collection/ui_frmSearchArtistsTitles.h"
#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/options.h"
#include "platform/work/longwork.h"
#include "services/captions.h"
#include "services/fileutilities.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "services/textfiles.h"

#include <QKeyEvent>
#include <QScopedValueRollback>

using namespace Qt::StringLiterals;

namespace
{

/// The columns of the result, in the order of the statement's fields.
enum Column { Artist, Title, DiscNumber, TrackNumber, CdTitle, Genre, HitYear, Type, columnCount };

// Widths as thirteenths of the list's width, whatever was dragged before a search.
const std::vector<ListColumn> columns = {
    {ListColumn::Text, "Artiest", 3},   {ListColumn::Text, "Titel", 3},
    {ListColumn::Number, "Disc", 1},    {ListColumn::Number, "Track", 1},
    {ListColumn::Text, "CD-Titel", 2},  {ListColumn::Text, "Genre", 1},
    {ListColumn::Number, "HitYear", 1}, {ListColumn::Text, "Type", 1}};
constexpr int whole = 13;
constexpr int largeResult = 200'000; // rows

QStringList textsOf(const ListItem &item)
{
    QStringList texts;
    for (int column = 0; column < columnCount; ++column)
        texts.append(item.SubItems(column));
    return texts;
}

} // namespace

frmSearchArtistsTitles::frmSearchArtistsTitles()
    : Form(u"frmSearchArtistsTitles"_s), mUi(std::make_unique<Ui::frmSearchArtistsTitles>())
{
    mUi->setupUi(this);
    mColumns = new ListColumns(mUi->ResultList, columns, whole, ListColumns::Dragged::Lost);
    setCaptions();
    connectControls();
    setDefaultButton(mUi->cmdSearch);
    setCancelButton(mUi->cmdCancel);
}

frmSearchArtistsTitles::~frmSearchArtistsTitles() = default;

void frmSearchArtistsTitles::setCaptions()
{
    applyCaptions(this, {{"frmSearchArtistsTitles", "frmSearchArtistsTitlesCaption"},
                         {"lblAnd", "And"},
                         {"frmSearchKey", "frmSearchKeyCaption"},
                         {"optFullWord", "optFullWordCaption"},
                         {"optPartWord", "optPartWordCaption"},
                         {"optBeginWord", "optBeginWordCaption"},
                         {"optEndWord", "optEndWordCaption"},
                         {"cmdSearch", "cmdSearchCaption"},
                         {"cmdExport", "xExport"},
                         {"cmdCancel", "cmdCancelCaption"}});
    const std::pair<QLabel *, const char *> labels[] = {{mUi->lblArtist, "Artiest"},
                                                        {mUi->lblTitle, "Titel"},
                                                        {mUi->lblGenre, "Genre"},
                                                        {mUi->lblYears, "HitYearBetween"}};
    for (const auto &[label, key] : labels)
        label->setText(GetMessage(key) + u':');
    mUi->txtHitjaartm->setAccessibleName(GetMessage("xLastYear"));
    mUi->ResultList->setAccessibleName(GetMessage("xFoundTracks"));
}

void frmSearchArtistsTitles::connectControls()
{
    DBListViewCTL *list = mUi->ResultList;
    connect(mUi->cmdSearch, &QPushButton::clicked, this, &frmSearchArtistsTitles::cmdSearch_Click);
    connect(mUi->cmdExport, &QPushButton::clicked, this, &frmSearchArtistsTitles::cmdExport_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &frmSearchArtistsTitles::cmdCancel_Click);
    connect(list, &DBListViewCTL::ColumnClick, this,
            &frmSearchArtistsTitles::ResultList_ColumnClick);
    connect(list, &DBListViewCTL::DblClick, this, &frmSearchArtistsTitles::ResultList_Enter);
    list->installEventFilter(this);
}

// The columns are there from the start.
void frmSearchArtistsTitles::Form_Load()
{
    chooseOption(mUi->optPartWord);
    for (QLineEdit *year : {mUi->txtHitjaarvan, mUi->txtHitjaartm})
        year->setMinimumWidth(year->fontMetrics().horizontalAdvance(u'0') * 7);
    showNothing();
}

void frmSearchArtistsTitles::showNothing()
{
    mColumns->showNone();
    mUi->ResultList->setEnabled(false);
    mUi->cmdExport->setEnabled(false);
}

void frmSearchArtistsTitles::cmdSearch_Click()
{
    Desktop::current().setPointer(this, vbHourglass);
    mUi->StatusBar->showMessage(GetMessage("BusySearching"));
    mUi->StatusBar->repaint();
    const SearchKey wanted = key();
    if (!checkYears(wanted))
        return;
    try {
        freezeFrame();
        show(wanted);
    } catch (const Error &error) {
        // By design: the wait cursor stays.
        plainBox(error.numbered());
    }
}

SearchKey frmSearchArtistsTitles::key() const
{
    SearchKey key;
    if (mUi->optFullWord->isChecked())
        key.mode = SearchKey::FullWord;
    else if (mUi->optBeginWord->isChecked())
        key.mode = SearchKey::BeginWord;
    else if (mUi->optEndWord->isChecked())
        key.mode = SearchKey::EndWord;
    key.artist = mUi->txtArtistKey->text();
    key.title = mUi->txtTitleKey->text();
    key.genre = mUi->txtGenre->text();
    key.firstYear = mUi->txtHitjaarvan->text();
    key.lastYear = mUi->txtHitjaartm->text();
    return key;
}

bool frmSearchArtistsTitles::checkYears(const SearchKey &key)
{
    const bool first = !key.firstYear.isEmpty(), last = !key.lastYear.isEmpty();
    if (first && !isSearchYear(key.firstYear))
        refuse("MsgInvalidYearBetween", mUi->txtHitjaarvan);
    else if (last && !isSearchYear(key.lastYear))
        refuse("MsgInvalidYearBetween", mUi->txtHitjaartm);
    else if (first && last && key.firstYear.toDouble() > key.lastYear.toDouble())
        refuse("MsgFirstYearBeforeLastYear", mUi->txtHitjaarvan);
    else
        return true;
    return false;
}

// By design: the list and the words of the panel stay as they are.
void frmSearchArtistsTitles::refuse(const char *message, QLineEdit *field)
{
    errorBox(GetMessage(message));
    field->setFocus();
    field->selectAll();
    Desktop::current().setPointer(this, vbDefault);
}

void frmSearchArtistsTitles::show(const SearchKey &key)
{
    if (mUi->ResultList->ListItems().Count() > largeResult)
        showNothing(); // makes room for as many
    const auto found = std::make_shared<ADODB::Recordset>();
    found->Open(searchStatement(key), *gConnection);
    mColumns->show(found);
    showFound(found->RecordCount());
    found->Close();
    releaseFrame();
}

// Enter on a row is the row's: the list passes it on, and the form would search.
bool frmSearchArtistsTitles::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == mUi->ResultList && event->type() == QEvent::KeyPress) {
        const auto *key = static_cast<QKeyEvent *>(event);
        if (key->key() == Qt::Key_Return || key->key() == Qt::Key_Enter) {
            ResultList_Enter();
            return true;
        }
    }
    return Form::eventFilter(watched, event);
}

void frmSearchArtistsTitles::showFound(qsizetype count)
{
    mUi->StatusBar->showMessage(GetMessage("NumberFound") + QString::number(count));
    Desktop::current().setPointer(this, vbDefault);
    mUi->ResultList->setEnabled(count > 0);
    mUi->cmdExport->setEnabled(count > 0);
    if (count > 0)
        mUi->ResultList->setFocus();
    else
        mUi->txtArtistKey->setFocus();
}

void frmSearchArtistsTitles::ResultList_ColumnClick(int column)
{
    mUi->ResultList->sortBy(column - 1);
}

void frmSearchArtistsTitles::ResultList_Enter()
{
    openDisc(mUi->ResultList->SelectedItem());
}

void frmSearchArtistsTitles::openDisc(const ListItem &item)
{
    if (!item)
        return;
    const QStringList texts = textsOf(item);
    try {
        const FoundRecord record = findRecord({texts[Artist], texts[Title], texts[DiscNumber],
                                               texts[TrackNumber], texts[CdTitle], texts[Type]});
        if (record.id == 0)
            informationBox(GetMessage("xTrackGone"));
        else
            editors::editTrack(record.isCompilation, record.id, texts[DiscNumber].toInt(),
                               record.row);
    } catch (const Error &error) {
        plainBox(error.numbered());
    }
}

void frmSearchArtistsTitles::cmdExport_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    const QString name =
        Desktop::current().saveFileName({GetMessage("xExportTitle"), saveFolder(), {}, {}});
    if (name.isEmpty() || !mayWrite(name))
        return;
    rememberSaveFolder(name);
    exportTo(name);
}

void frmSearchArtistsTitles::exportTo(const QString &name)
{
    LongWork work(*this);
    work.showPercent = [this](int percent) {
        mUi->StatusBar->showMessage(GetMessage("xExporting") + QString::number(percent) + u'%');
    };
    const QScopedValueRollback<LongWork *> cancellable(mExport, &work);
    setExporting(true);
    const bool written = writeResult(name, work);
    setExporting(false);
    if (work.isCancelled())
        mUi->StatusBar->showMessage(GetMessage("xExportCancelled"));
    else if (written)
        mUi->StatusBar->showMessage(GetMessage("xExported") + name);
}

// A file that cannot be opened says no more than the panel does; what cannot be written to its end
// does: it would pass for done.
bool frmSearchArtistsTitles::writeResult(const QString &name, LongWork &work)
{
    const QString failure = GetMessage("xNotExported") + name;
    OutputTextFile file;
    if (!OpenOutputFile(name, file)) {
        mUi->StatusBar->showMessage(failure);
        return false;
    }
    auto items = mUi->ResultList->ListItems();
    const int count = items.Count();
    bool written = true;
    for (int index = 1; index <= count && written; ++index) {
        written = WriteTextLine(file, resultLine(textsOf(items.Item(index))));
        if (!work.step(index, count))
            return false;
    }
    written = written && CloseTextFile(file);
    if (!written) {
        mUi->StatusBar->showMessage(failure);
        errorBox(failure + u'\r' + file.reason(), GetMessage("FileError"));
    }
    return written;
}

// What is shown is what is written: nothing may change it meanwhile.
void frmSearchArtistsTitles::setExporting(bool exporting)
{
    if (exporting)
        mUi->txtArtistKey->setFocus(); // the button's would go to the one that cancels
    mUi->cmdSearch->setEnabled(!exporting);
    mUi->cmdExport->setEnabled(!exporting);
    mUi->ResultList->setEnabled(!exporting);
    Desktop::current().setPointer(this, exporting ? vbHourglass : vbDefault);
    if (!exporting)
        mUi->cmdExport->setFocus();
}

// An export is ended by it, and the form stays.
void frmSearchArtistsTitles::cmdCancel_Click()
{
    if (mExport)
        mExport->cancel();
    else
        Unload();
}
