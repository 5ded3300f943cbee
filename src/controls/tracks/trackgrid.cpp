#include "controls/tracks/trackgrid.h"

#include "catalogue/genres.h"
#include "catalogue/hityear.h"
#include "controls/list/columnshares.h"
#include "controls/tracks/trackcompletion.h"
#include "controls/tracks/trackmessages.h"
#include "controls/tracks/trackmodel.h"
#include "platform/ado/connection.h"
#include "platform/desktop/desktop.h"
#include "services/messages.h"

#include <QApplication>
#include <QClipboard>
#include <QHeaderView>
#include <QKeyEvent>
#include <QRegularExpression>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

constexpr int numberColumn = 0;
constexpr int widestNumber = 5; // digits of numbers and years

bool isEnter(int key)
{
    return key == Qt::Key_Return || key == Qt::Key_Enter;
}

Qt::KeyboardModifiers modifiersOf(const QKeyEvent &event)
{
    return event.modifiers() & ~Qt::KeyboardModifiers(Qt::KeypadModifier);
}

/// Shift+Insert is a request here, and not the paste or the menu entry that it is elsewhere.
bool isAddDisc(const QKeyEvent &event)
{
    return event.key() == Qt::Key_Insert && modifiersOf(event) == Qt::ShiftModifier;
}

bool typesText(const QKeyEvent &event)
{
    const bool command =
        event.modifiers() & (Qt::AltModifier | Qt::ControlModifier | Qt::MetaModifier);
    return !event.text().isEmpty() && event.text().front().isPrint() && !command;
}

} // namespace

TrackGrid::TrackGrid(Columns columns, QWidget *parent)
    : QTableView(parent),
      mWithArtist(columns == Columns::WithArtist),
      mModel(new TrackModel(mWithArtist, this)),
      mDelegate(
          new TrackDelegate([this](const QModelIndex &index) { return describe(index); }, this)),
      mShares(nullptr)
{
    setModel(mModel);
    setItemDelegate(mDelegate);
    mShares = new ColumnShares(
        this, mWithArtist ? QList<int>{0, 3, 4, 2, 0} : QList<int>{0, 5, 2, 0}, widestNumber);
    setUpView();
    setLanguage(languageEnglish);
    go(0, 1);
    connect(mDelegate, &TrackDelegate::cancelled, this, &TrackGrid::cancelEdit);
    connect(mDelegate, &TrackDelegate::gridKey, this, &TrackGrid::actOnEditKey);
    connect(mDelegate, &TrackDelegate::cutOff, this, &TrackGrid::tellCut, Qt::QueuedConnection);
    connect(qApp, &QApplication::focusChanged, this,
            [this](QWidget *, QWidget *now) { followFocus(now); });
}

void TrackGrid::setUpView()
{
    setEditTriggers(DoubleClicked | AnyKeyPressed);
    setSelectionMode(ContiguousSelection);
    setSelectionBehavior(SelectItems);
    setWordWrap(false);
    setHorizontalScrollMode(ScrollPerPixel);
    verticalHeader()->hide();
    verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    horizontalHeader()->setHighlightSections(false);
    horizontalHeader()->setSectionsClickable(false);
    horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    layOut();
}

void TrackGrid::setLanguage(int language)
{
    mLanguage = language;
    QStringList heads;
    for (const char *key : {"Track", "Artiest", "Titel", "Genre", "HitYear"}) {
        if (mWithArtist || QLatin1String(key) != "Artiest"_L1)
            heads.append(message(key));
    }
    mModel->setHeads(heads);
    setAccessibleName(message("xTracks"));
    layOut();
}

QString TrackGrid::message(const char *key) const
{
    return GetMessage(QLatin1String(key), mLanguage);
}

void TrackGrid::layOut()
{
    verticalHeader()->setDefaultSectionSize(fontMetrics().height() * 3 / 2);
    mShares->layOut();
}

void TrackGrid::resizeEvent(QResizeEvent *event)
{
    QTableView::resizeEvent(event);
    layOut();
}

void TrackGrid::changeEvent(QEvent *event)
{
    QTableView::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange)
        layOut();
}

// The focus is the grid's as long as no other control of the window has it: a message box or
// another program does not take it away.
void TrackGrid::followFocus(QWidget *now)
{
    const bool inside = now && (now == this || isAncestorOf(now));
    const bool elsewhere = now ? now->window() == window() && !inside : !isVisible();
    if (inside && !mFocused) {
        mFocused = true;
        emit GotFocus();
    } else if (elsewhere && mFocused) {
        mFocused = false;
        emit LostFocus();
    }
}

int TrackGrid::CurrentColumn() const
{
    return std::max(currentIndex().column(), 0) + 1;
}

int TrackGrid::CurrentRow() const
{
    return std::max(currentIndex().row(), 0) + 1;
}

void TrackGrid::setCurrentColumn(int column)
{
    go(currentIndex().row(), column - 1);
}

void TrackGrid::setCurrentRow(int row)
{
    go(row - 1, currentIndex().column());
}

int TrackGrid::lastColumn() const
{
    return mModel->columnCount() - 1;
}

void TrackGrid::go(int row, int column)
{
    const QModelIndex cell = mModel->index(std::clamp(row, 0, std::max(mModel->rowCount() - 1, 0)),
                                           std::clamp(column, 0, lastColumn()));
    // Told outright, for the view would go by the Shift of a Shift+Tab.
    selectionModel()->setCurrentIndex(cell, QItemSelectionModel::ClearAndSelect);
}

TrackDelegate::Cell TrackGrid::describe(const QModelIndex &index) const
{
    TrackDelegate::Cell cell;
    cell.name = mModel->headerData(index.column(), Qt::Horizontal, Qt::DisplayRole).toString();
    cell.suggestions = [this, index = QPersistentModelIndex(index)](const QString &start) {
        return suggestionsFor(index, start);
    };
    if (mModel->fieldOf(index.column()) == GenreField) {
        cell.list = genres(mLanguage);
        cell.listName = message("xShowList");
    }
    return cell;
}

QStringList TrackGrid::suggestionsFor(const QModelIndex &index, const QString &start) const
{
    const TrackField field = mModel->fieldOf(index.column());
    if (field == GenreField) {
        const QString begins = u'^' + QRegularExpression::escape(start);
        return genres(mLanguage).filter(
            QRegularExpression(begins, QRegularExpression::CaseInsensitiveOption));
    }
    if (!mConnection || field == YearField)
        return {};
    try {
        if (field == ArtistField)
            return trackcompletion::artists(*mConnection, start);
        if (mWithArtist)
            return trackcompletion::titles(*mConnection, mModel->text(index.row(), ArtistField),
                                           start);
        return trackcompletion::titles(*mConnection, mCdId, start);
    } catch (const Error &) {
        return {}; // a help that is not there must not keep anybody from typing
    }
}

void TrackGrid::editCurrent()
{
    if (currentIndex().column() == numberColumn)
        go(currentIndex().row(), 1);
    edit(currentIndex());
    if (cellEdit())
        cellEdit()->end(false);
}

void TrackGrid::mouseDoubleClickEvent(QMouseEvent *event)
{
    QTableView::mouseDoubleClickEvent(event);
    if (cellEdit())
        cellEdit()->end(false);
}

void TrackGrid::cancelEdit()
{
    if (cellEdit())
        closeEditor(cellEdit(), QAbstractItemDelegate::RevertModelCache);
}

void TrackGrid::CommitEdit()
{
    CellEdit *edit = cellEdit();
    if (!edit)
        return;
    commitData(edit);
    closeEditor(edit, QAbstractItemDelegate::NoHint);
}

// The end of an edit by a key: false if it has to go on.
bool TrackGrid::leaveEdit()
{
    const QModelIndex index = currentIndex();
    const TrackField field = mModel->fieldOf(index.column());
    const QString text = mModel->keep(index.row(), field, cellEdit()->text());
    const bool refused = field == YearField && !text.isEmpty() && !isHitYear(text) &&
                         text != mModel->text(index.row(), field);
    if (refused)
        refuseYear(index, text);
    else
        CommitEdit();
    return !refused;
}

void TrackGrid::refuseYear(const QModelIndex &index, const QString &text)
{
    cancelEdit(); // the box takes the focus, which would end the edit with this text
    errorBox(message("MsgInvalidYear"));
    edit(index);
    if (cellEdit()) {
        cellEdit()->setText(text);
        cellEdit()->selectAll();
    }
}

void TrackGrid::actOnEditKey(QKeyEvent *event)
{
    if (!cellEdit() || !leaveEdit())
        return;
    if (isEnter(event->key()) && modifiersOf(*event) == Qt::NoModifier)
        go(currentIndex().row() + 1, currentIndex().column());
    else
        actOnKey(event);
}

bool TrackGrid::event(QEvent *event)
{
    if (event->type() == QEvent::ShortcutOverride) {
        auto *key = static_cast<QKeyEvent *>(event);
        if (isAddDisc(*key) || key->matches(QKeySequence::Copy)) {
            key->accept();
            return true;
        }
    }
    return QTableView::event(event);
}

void TrackGrid::keyPressEvent(QKeyEvent *event)
{
    if (actOnKey(event)) {
        event->accept();
        return;
    }
    if (typesText(*event) && currentIndex().column() == numberColumn)
        go(currentIndex().row(), 1);
    QTableView::keyPressEvent(event);
}

bool TrackGrid::actOnKey(QKeyEvent *event)
{
    const int key = event->key();
    const auto modifiers = modifiersOf(*event);
    if (isAddDisc(*event))
        emit RequestAddDisc();
    else if (key == Qt::Key_End && modifiers == Qt::ShiftModifier)
        emit RequestDeleteDisc();
    else if (isEnter(key) && modifiers == Qt::ControlModifier)
        emit RequestSave();
    else if (key == Qt::Key_Backtab || (key == Qt::Key_Tab && modifiers == Qt::ShiftModifier))
        walk(-1);
    else if (modifiers != Qt::NoModifier)
        return actOnClipboardKey(event);
    else
        return actOnPlainKey(key);
    return true;
}

bool TrackGrid::actOnClipboardKey(QKeyEvent *event)
{
    const auto undone = [this](const QModelIndex &cell) {
        if (cell.isValid())
            go(cell.row(), cell.column());
    };
    if (event->matches(QKeySequence::Undo))
        undone(mModel->undo());
    else if (event->matches(QKeySequence::Redo))
        undone(mModel->redo());
    else if (event->matches(QKeySequence::Copy) || event->matches(QKeySequence::Cut))
        copy();
    else if (event->matches(QKeySequence::Paste))
        paste();
    else
        return false;
    if (event->matches(QKeySequence::Cut))
        clearSelected();
    return true;
}

bool TrackGrid::actOnPlainKey(int key)
{
    const int row = currentIndex().row(), column = currentIndex().column();
    switch (key) {
    case Qt::Key_Return:
    case Qt::Key_Enter:
        editCurrent();
        return true;
    case Qt::Key_Escape:
        return true; // by design: it would close the screen otherwise
    case Qt::Key_Tab:
        walk(+1);
        return true;
    case Qt::Key_Insert:
        mModel->insertTrack(row);
        go(row, 1);
        return true;
    case Qt::Key_End:
        mModel->removeTrack(row);
        go(row, column);
        return true;
    case Qt::Key_Delete:
    case Qt::Key_Backspace:
        clearSelected();
        return true;
    case Qt::Key_PageUp:
        go(0, column);
        return true;
    case Qt::Key_PageDown:
        go(mModel->waitingRow() - 1, column);
        return true;
    case Qt::Key_Up:
        go(row - 1, column);
        return true;
    case Qt::Key_Down:
        go(row + 1, column);
        return true;
    default:
        return false;
    }
}

// From field to field, row by row; the track number is none.
void TrackGrid::walk(int step)
{
    const int fields = lastColumn();
    const int from = std::max(currentIndex().column(), step > 0 ? 0 : 1) - 1;
    const int to = currentIndex().row() * fields + from + step;
    if (to < 0)
        emit LeaveBackward();
    else if (to >= mModel->rowCount() * fields)
        emit LeaveForward();
    else
        go(to / fields, to % fields + 1);
}

void TrackGrid::copy() const
{
    if (selectionModel()->selection().isEmpty())
        return;
    const QItemSelectionRange range = selectionModel()->selection().first();
    QList<QStringList> lines;
    for (int row = range.top(); row <= std::min(range.bottom(), mModel->waitingRow() - 1); ++row) {
        QStringList cells;
        for (int column = range.left(); column <= range.right(); ++column)
            cells.append(mModel->index(row, column).data().toString());
        lines.append(cells);
    }
    if (!lines.isEmpty())
        QApplication::clipboard()->setText(TrackModel::joined(lines));
}

void TrackGrid::paste()
{
    const QString text = QApplication::clipboard()->text();
    if (text.isEmpty())
        return;
    const QModelIndex from = currentIndex();
    emit LockScreen();
    const auto pasted = mModel->paste(from.row(), from.column(), TrackModel::parted(text));
    selectionModel()->select({from, pasted.last}, QItemSelectionModel::ClearAndSelect);
    emit UnlockScreen();
    if (pasted.cut)
        tellCut();
}

// Those that come while the box is there, from a key held down, are told with it.
void TrackGrid::tellCut()
{
    if (mTellsCut)
        return;
    const QPointer<TrackGrid> alive(this);
    mTellsCut = true;
    informationBox(message("xTextCut"));
    if (alive)
        mTellsCut = false;
}

void TrackGrid::clearSelected()
{
    mModel->clear(selectionModel()->selectedIndexes());
}

TrackStore TrackGrid::store() const
{
    if (!mConnection)
        throw makeError(errObjectClosed);
    return {*mConnection, mCdId, mDiscNo,
            mWithArtist ? TrackStore::Artists::OfTracks : TrackStore::Artists::OfTitle};
}

void TrackGrid::LoadDisc()
{
    cancelEdit();
    mModel->load(store().load());
    mSaveFate.reset();
    mHasError = false;
    go(0, 1);
}

void TrackGrid::RemoveDisc()
{
    cancelEdit();
    store().remove();
    mModel->load({});
    mSaveFate.reset();
    go(0, 1);
}

QList<StoredTrack> TrackGrid::Tracks() const
{
    QList<StoredTrack> tracks;
    for (const TrackToSave &track : mModel->toSave())
        tracks.append({track.linkId, track.texts});
    if (const CellEdit *edit = cellEdit()) {
        const int row = mModel->trackNumber(currentIndex().row()) - 1;
        const TrackField field = mModel->fieldOf(currentIndex().column());
        if (row < 0)
            tracks.append(StoredTrack());
        (row < 0 ? tracks.last() : tracks[row]).texts[field] =
            mModel->keep(currentIndex().row(), field, edit->text());
    }
    return tracks;
}

void TrackGrid::ShowUnsaved(const QList<StoredTrack> &tracks)
{
    mModel->showUnsaved(tracks);
}

void TrackGrid::ShowTracks(const QList<StoredTrack> &tracks)
{
    cancelEdit();
    mModel->setFixed();
    mModel->load(tracks);
    go(0, 1);
}

void TrackGrid::goToCell(int row, TrackField field)
{
    setFocus();
    go(row, mModel->columnOf(field));
}

void TrackGrid::ForgetSaved()
{
    mModel->forgetSaved();
    mSaveFate.reset();
}

// What was saved in a transaction that was rolled back afterwards is still to be saved.
void TrackGrid::settleSave() const
{
    if (mSaveFate && mSaveFate->undone())
        mModel->unmarkSaved();
    else
        return;
    mSaveFate.reset();
}

bool TrackGrid::IsChanged() const
{
    settleSave();
    const CellEdit *edit = cellEdit();
    const QModelIndex index = currentIndex();
    const TrackField field = mModel->fieldOf(index.column());
    const bool typed =
        edit && mModel->keep(index.row(), field, edit->text()) != mModel->text(index.row(), field);
    return typed || mModel->isChanged();
}

void TrackGrid::SaveDisc()
{
    mHasError = false;
    CommitEdit();
    settleSave();
    const QList<TrackToSave> tracks = mModel->toSave();
    const TrackMessages messages(mWithArtist, mLanguage);
    if (const auto refusal = messages.refusal(tracks)) {
        setFocus();
        go(mModel->rowOfTrack(refusal->track), mModel->columnOf(refusal->field));
        refuse(refusal->text);
        return;
    }
    const TrackStore::Outcome outcome = store().save(tracks, mModel->savedLinks());
    if (outcome.refused) {
        refuse(message("xTitleGone"));
        return;
    }
    mModel->markSaved(outcome.linkIds);
    mSaveFate = mConnection->fate();
    if (const QString kept = messages.kept(tracks, outcome); !kept.isEmpty()) {
        emit UnlockScreen();
        informationBox(kept);
    }
}

// The screen behind the box shows the row.
void TrackGrid::refuse(const QString &why)
{
    mHasError = true;
    emit UnlockScreen();
    errorBox(why);
}
