#include "collection/headerfields.h"

#include "catalogue/genres.h"
#include "catalogue/hityear.h"
#include "controls/list/keycodes.h"
#include "platform/desktop/desktop.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QApplication>
#include <QComboBox>
#include <QCompleter>
#include <QKeyEvent>
#include <QLineEdit>
#include <QRegularExpression>
#include <QTimer>

using namespace Qt::StringLiterals;

namespace
{

constexpr int longestText = 255; // characters, as everywhere in the catalogue
constexpr int keyPageUp = 33, keyPageDown = 34, keyEnd = 35, keyInsert = 45;
constexpr int shiftAlone = 1;

// A pasted text may have line ends, and the limit may have parted a pair of surrogates.
void keepOneLine(QLineEdit *field)
{
    static const QRegularExpression lineEnds(u"\\s*[\\r\\n\\x{2028}\\x{2029}]+\\s*"_s);
    QString clean = field->text();
    clean.replace(lineEnds, u" "_s);
    if (clean.size() == field->maxLength() && clean.back().isHighSurrogate())
        clean.chop(1);
    if (clean == field->text())
        return;
    const int cursor = field->cursorPosition();
    field->setText(clean);
    field->setCursorPosition(std::min<int>(cursor, int(clean.size())));
}

// A text that is longer, from another program's hand, is shown whole and never cut unseen.
void showText(QLineEdit *field, const QString &text)
{
    field->setMaxLength(std::max<int>(longestText, int(text.size())));
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
    connect(qApp, &QApplication::focusChanged, this, &HeaderFields::focusMoved);
}

void HeaderFields::watch(QWidget *field, QLineEdit *text)
{
    field->installEventFilter(this);
    text->setMaxLength(longestText);
    connect(text, &QLineEdit::textEdited, this, [text] { keepOneLine(text); });
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

Header HeaderFields::shown() const
{
    return {mFields.artist ? mFields.artist->text() : QString(), mFields.title->text(),
            mFields.genre->currentText(), mFields.year->text()};
}

void HeaderFields::show(const Header &header)
{
    if (mFields.artist)
        showText(mFields.artist, header.artist);
    showText(mFields.title, header.title);
    mFields.genre->setCurrentIndex(
        mFields.genre->findText(header.genre, Qt::MatchExactly | Qt::MatchCaseSensitive));
    showText(mFields.genre->lineEdit(), header.genre);
    showText(mFields.year, header.year);
}

bool HeaderFields::ValidateYear()
{
    const QString year = mFields.year->text();
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
        if (field == mFields.year)
            mYearLeftByHand = isByHand(static_cast<QFocusEvent *>(event)->reason());
        break;
    case QEvent::ShortcutOverride: // the menu has Shift+Insert too
    case QEvent::KeyPress:
        return HandleFieldKey(static_cast<QKeyEvent *>(event));
    case QEvent::Wheel: // a wheel that passes over the list must not change the record
        event->ignore();
        return field == mFields.genre && !mFields.genre->hasFocus();
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
