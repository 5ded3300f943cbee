#include "mp3/UndoChanges.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/fittedcolumns.h"
#include "discdata/changedfiles.h"
#include "mp3/followednames.h"
#include "mp3/ui_UndoChanges.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QFileInfo>
#include <QLocale>
#include <QScopedValueRollback>
#include <QSet>

using namespace Qt::StringLiterals;

namespace
{

const std::vector<ListColumn> columns = {{ListColumn::Hidden},
                                         {ListColumn::Text, "xWhen"},
                                         {ListColumn::Text, "xWhat"},
                                         {ListColumn::Text, "xFolder", 1},
                                         {ListColumn::Text, "xFiles", 1},
                                         {ListColumn::Text, "xRemark"}};

QString shown(const QDateTime &when)
{
    const QLocale locale(gLanguage == languageDutch ? QLocale::Dutch : QLocale::English);
    return locale.toString(when, u"d MMM yyyy, HH:mm"_s);
}

QString filesShown(const FileJournal::Batch &batch)
{
    const QString first = QFileInfo(batch.first).fileName();
    return batch.files < 2 ? first : first + GetMessage("xAndMore").arg(batch.files - 1);
}

// Batches keep the keys of texts, and are told in the language of now.
constexpr QLatin1String undoKey("xUndoOf "), redoKey("xRedoOf ");

// What takes an undo back does it again.
QString undoOf(const QString &what)
{
    if (what.startsWith(undoKey))
        return redoKey + what.sliced(undoKey.size());
    return undoKey + (what.startsWith(redoKey) ? what.sliced(redoKey.size()) : what);
}

bool isKey(const QString &text)
{
    return text.size() > 1 && text[0] == u'x' && text[1].isUpper() &&
           std::all_of(text.begin(), text.end(), [](QChar c) { return c.isLetter(); });
}

QString told(const QString &what)
{
    for (const QLatin1String key : {undoKey, redoKey}) {
        if (what.startsWith(key))
            return GetMessage(key.chopped(1)) + told(what.sliced(key.size()));
    }
    return isKey(what) ? GetMessage(QLatin1String(what.toLatin1())) : what;
}

int filesOf(const std::vector<FileJournal::Batch> &batches)
{
    int files = 0;
    for (const FileJournal::Batch &batch : batches)
        files += batch.files;
    return files;
}

} // namespace

UndoChanges::UndoChanges() : Form(u"UndoChanges"_s), mUi(std::make_unique<Ui::UndoChanges>())
{
    mUi->setupUi(this);
    mColumns = new FittedColumns(mUi->ChangeList, columns);
    setDefaultButton(mUi->cmdUndo);
    setCancelButton(mUi->cmdClose);
    setTexts();
    setRunning(false);
    mUi->lblLeft->hide();
    mUi->txtLeft->hide();
    connect(mUi->ChangeList->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            &UndoChanges::handleButtons);
    connect(mUi->cmdUndo, &QPushButton::clicked, this, &UndoChanges::cmdUndo_Click);
    connect(mUi->cmdClose, &QPushButton::clicked, this, &UndoChanges::cmdClose_Click);
}

UndoChanges::~UndoChanges() = default;

void UndoChanges::setTexts()
{
    applyCaptions(
        this,
        {{"UndoChanges", "xUndoChangesCaption"}, {"lblLeft", "xUndoLeft"}, {"cmdUndo", "xUndo"}});
    mUi->ChangeList->setAccessibleName(GetMessage("xUndoChangesCaption"));
    mUi->Progress->setAccessibleName(GetMessage("xProgress"));
}

void UndoChanges::Form_Load()
{
    showBatches();
    mColumns->widen(this);
    placeInFrame(this, 0.15, 0.1);
}

void UndoChanges::Form_Activate()
{
    if (mUi->ChangeList->isEnabled())
        mUi->ChangeList->setFocus();
}

UndoChanges::Batches UndoChanges::allBatches()
{
    try {
        return changedFiles().batches();
    } catch (const Error &error) {
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
        return {};
    }
}

// Nothing is chosen then but the newest.
void UndoChanges::showBatches()
{
    const Batches batches = allBatches();
    const auto rows = std::make_shared<ADODB::Recordset>();
    for (const char *field : {"number", "when", "what", "where", "files", "remark"})
        rows->appendField(QLatin1String(field), ADODB::adVarWChar);
    rows->Open();
    for (const FileJournal::Batch &batch : batches) {
        const QString cells[] = {QString::number(batch.number),
                                 shown(batch.when),
                                 told(batch.what),
                                 batch.where,
                                 filesShown(batch),
                                 batch.isTakenBack ? GetMessage("xTakenBack") : QString()};
        rows->AddNew();
        for (int column = 0; const QString &cell : cells)
            rows->Fields(column++).setValue(cell);
    }
    mColumns->show(rows);
    mUi->lblWhich->setText(GetMessage(batches.empty() ? "xUndoNone" : "xUndoWhich"));
    handleButtons();
}

// Newest first: what was done last is taken back first.
UndoChanges::Batches UndoChanges::chosenBatches() const
{
    QSet<qint64> chosen;
    auto items = mUi->ChangeList->ListItems();
    for (int index = 1; index <= items.Count(); ++index) {
        if (items.Item(index).Selected())
            chosen.insert(items.Item(index).Text().toLongLong());
    }
    Batches batches = allBatches();
    std::erase_if(batches, [&](const auto &batch) { return !chosen.contains(batch.number); });
    return batches;
}

void UndoChanges::handleButtons()
{
    const bool any = mUi->ChangeList->selectionModel()->hasSelection();
    mUi->cmdUndo->setEnabled(any && !mUndo);
}

void UndoChanges::cmdUndo_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    const Batches batches = chosenBatches();
    const QString question = GetMessage("xUndoQuestion") + QString::number(filesOf(batches));
    if (!batches.empty() && askYesNo(question) == vbYes && !isUnloaded())
        undo(batches);
}

// What runs is ended by it, and the screen stays.
void UndoChanges::cmdClose_Click()
{
    if (mUndo)
        mUndo->cancel();
    else
        Unload();
}

void UndoChanges::undo(const Batches &batches)
{
    FileJournal::Undone undone;
    {
        LongWork work(*this);
        work.showPercent = [this](int percent) { mUi->Progress->setValue(percent); };
        const QScopedValueRollback<LongWork *> cancellable(mUndo, &work);
        setRunning(true);
        undone = undoAll(batches, work);
    }
    gTagsChanged = true; // lists that are open are read again
    follow(undone);
    setRunning(false);
    showBatches();
    tell(undone);
}

FileJournal::Undone UndoChanges::undoAll(const Batches &batches, LongWork &work)
{
    FileJournal::Undone all;
    const int files = filesOf(batches);
    int before = 0;
    for (const FileJournal::Batch &batch : batches) {
        if (work.isCancelled())
            break;
        try {
            const auto one = changedFiles().undo(
                batch.number, Desktop::current().now(), undoOf(batch.what),
                [&](int done, int /*all*/) { return work.step(before + done, files); });
            all.files += one.files;
            all.left += one.left;
            all.moved.insert(all.moved.end(), one.moved.begin(), one.moved.end());
        } catch (const Error &error) {
            all.left.append(told(batch.what) + u": "_s + error.Description);
        }
        before += batch.files;
    }
    return all;
}

// Collections find their files again under the names that these have now.
void UndoChanges::follow(const FileJournal::Undone &undone)
{
    try {
        followNames(renamedBy(undone.moved));
    } catch (const Error &error) {
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
    }
}

void UndoChanges::setRunning(bool running)
{
    if (running)
        mUi->cmdClose->setFocus(); // the list's and the other button's would go elsewhere
    mUi->ChangeList->setEnabled(!running);
    mUi->Progress->setVisible(running);
    mUi->Progress->setValue(0);
    mUi->cmdClose->setText(GetMessage(running ? "cmdCancelCaption" : "xClose"));
    Desktop::current().setPointer(this, running ? vbHourglass : vbDefault);
    handleButtons();
}

void UndoChanges::tell(const FileJournal::Undone &undone)
{
    const bool any = !undone.left.isEmpty();
    mUi->txtLeft->setPlainText(undone.left.join(u'\n'));
    mUi->lblLeft->setVisible(any);
    mUi->txtLeft->setVisible(any);
    QString outcome = GetMessage("xUndonePart1") + QString::number(undone.files);
    if (any)
        outcome += u'\r' + GetMessage("xUndonePart2") + QString::number(undone.left.size());
    informationBox(outcome);
    Form_Activate();
}
