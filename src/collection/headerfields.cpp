#include "collection/headerfields.h"

#include "catalogue/genres.h"
#include "catalogue/hityear.h"
#include "catalogue/typedtext.h"
#include "controls/list/keycodes.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/passingwheel.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QApplication>
#include <QComboBox>
#include <QCompleter>
#include <QKeyEvent>
#include <QLineEdit>
#include <QTimer>

using namespace Qt::StringLiterals;

namespace
{

constexpr int keyPageUp = 33, keyPageDown = 34, keyEnd = 35, keyInsert = 45;
constexpr int shiftAlone = 1;

// A text that is longer, from another program's hand, is shown whole and never cut unseen.
void showText(QLineEdit *field, const QString &text)
{
    field->setMaxLength(typedtext::room(text));
    if (field->text() == text)
        return;
    field->setText(text);
    field->setCursorPosition(0);
}

bool isFieldKey(int keyCode, int shift)
{
    return keyCode == keyPageUp || keyCode == keyPageDown ||
           ((keyCode == keyInsert || keyCode == keyEnd) && shift == shiftAlone);
}

QLineEdit *textOf(QObject *field)
{
    auto *list = qobject_cast<QComboBox *>(field);
    return list ? list->lineEdit() : qobject_cast<QLineEdit *>(field);
}

bool isByHand(Qt::FocusReason reason)
{
    return reason == Qt::TabFocusReason || reason == Qt::BacktabFocusReason ||
           reason == Qt::MouseFocusReason || reason == Qt::OtherFocusReason;
}

} // namespace

HeaderFields::HeaderFields(const Fields &fields, QWidget *screen)
    : QObject(screen), mFields(fields), mScreen(screen)
{
    if (mFields.artist)
        watch(mFields.artist, mFields.artist);
    watch(mFields.title, mFields.title);
    watch(mFields.genre, mFields.genre->lineEdit());
    watch(mFields.year, mFields.year);
    setUpGenre();
    ignorePassingWheel(mFields.genre);
    connect(qApp, &QApplication::focusChanged, this, &HeaderFields::focusMoved);
}

void HeaderFields::watch(QWidget *field, QLineEdit *text)
{
    field->installEventFilter(this);
    text->setMaxLength(typedtext::room({}));
    connect(text, &QLineEdit::inputRejected, this, &HeaderFields::tellCut, Qt::QueuedConnection);
}

// The text stays as it was typed: a completer blind to case would put the list's "Folk" over "folk"
// when the field is left.
void HeaderFields::setUpGenre()
{
    auto *exact = new QCompleter(this);
    exact->setCaseSensitivity(Qt::CaseSensitive);
    mFields.genre->setCompleter(exact);
    mFields.genre->setInsertPolicy(QComboBox::NoInsert);
    mFields.genre->addItems(genres(gLanguage));
    mFields.genre->setCurrentIndex(-1);
}

// What the fields say, by the rule for what is typed.
Header HeaderFields::shown() const
{
    const auto kept = [](const QString &typed, const QString &before) {
        return typedtext::keep(typed, before).text;
    };
    return {mFields.artist ? kept(mFields.artist->text(), mBefore.artist) : QString(),
            kept(mFields.title->text(), mBefore.title),
            kept(mFields.genre->currentText(), mBefore.genre),
            kept(mFields.year->text(), mBefore.year)};
}

void HeaderFields::show(const Header &header)
{
    mBefore = header;
    if (mFields.artist)
        showText(mFields.artist, header.artist);
    showText(mFields.title, header.title);
    if (mFields.genre->currentText() != header.genre)
        mFields.genre->setCurrentIndex(
            mFields.genre->findText(header.genre, Qt::MatchExactly | Qt::MatchCaseSensitive));
    showText(mFields.genre->lineEdit(), header.genre);
    showText(mFields.year, header.year);
}

bool HeaderFields::ValidateYear()
{
    const QString year = shown().year;
    if (year.isEmpty())
        return false;
    if (isHitYear(year))
        return true;
    errorBox(GetMessage("MsgInvalidYear"));
    return false;
}

bool HeaderFields::eventFilter(QObject *field, QEvent *event)
{
    switch (event->type()) {
    case QEvent::FocusIn:
        selectText(field, static_cast<QFocusEvent *>(event)->reason());
        break;
    case QEvent::FocusOut:
        left(field, static_cast<QFocusEvent *>(event)->reason());
        break;
    case QEvent::ShortcutOverride: // the menu has Shift+Insert too
    case QEvent::KeyPress:
        return HandleFieldKey(static_cast<QKeyEvent *>(event));
    default:
        break;
    }
    return QObject::eventFilter(field, event);
}

// True if the key is one of the editor's and goes no further.
bool HeaderFields::HandleFieldKey(QKeyEvent *event)
{
    const int keyCode = keyCodeOf(event->key());
    if (!isFieldKey(keyCode, shiftStateOf(event->modifiers())))
        return false;
    event->accept();
    if (event->type() == QEvent::ShortcutOverride)
        return true;
    if (keyCode == keyPageUp)
        emit firstTrackWanted();
    else if (keyCode == keyPageDown)
        emit lastTrackWanted();
    else if (keyCode == keyInsert)
        emit newDiscWanted();
    else
        emit discDeletionWanted();
    return true;
}

// The press of a mouse button sets the cursor after the focus has come.
void HeaderFields::selectText(QObject *field, Qt::FocusReason reason)
{
    QLineEdit *text = textOf(field);
    if (reason == Qt::MouseFocusReason)
        QTimer::singleShot(0, text, &QLineEdit::selectAll);
    else if (reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason)
        text->selectAll();
}

// What is kept of a text stands in its field once one has gone on.
void HeaderFields::left(QObject *field, Qt::FocusReason reason)
{
    if (field == mFields.year)
        mYearLeftByHand = isByHand(reason);
    if (reason == Qt::PopupFocusReason || reason == Qt::ActiveWindowFocusReason)
        return;
    const Header kept = shown();
    const auto put = [field](QWidget *own, const QString &text) {
        if (own == field && textOf(field)->text() != text)
            textOf(field)->setText(text);
    };
    put(mFields.artist, kept.artist);
    put(mFields.title, kept.title);
    put(mFields.genre, kept.genre);
    put(mFields.year, kept.year);
}

// Those that come while the box is there, from a key held down, are told with it.
void HeaderFields::tellCut()
{
    if (mTellsCut)
        return;
    const QPointer<HeaderFields> alive(this);
    mTellsCut = true;
    informationBox(GetMessage("xTextCut"));
    if (alive)
        mTellsCut = false;
}

void HeaderFields::focusMoved(QWidget *from, QWidget *to)
{
    if (from != mFields.year || !mYearLeftByHand)
        return;
    mYearLeftByHand = false;
    if (to && mScreen->isVisible() && mScreen->isAncestorOf(to))
        leaveYear();
}

// By design: an empty year is no year either, so Tab does not lead out of an empty field. The keys
// and buttons that go to the tracks do.
void HeaderFields::leaveYear()
{
    if (ValidateYear())
        return;
    mFields.year->clear();
    mFields.year->setFocus();
}
