#include "controls/tracks/celledit.h"

#include "platform/desktop/sentkey.h"
#include "services/messages.h"

#include <QAction>
#include <QKeyEvent>
#include <QListWidget>
#include <QPainter>
#include <QStyleOption>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

constexpr int linesShown = 12;

bool isPlain(const QKeyEvent &event)
{
    return !(event.modifiers() & ~Qt::KeyboardModifiers(Qt::KeypadModifier));
}

bool isEnter(const QKeyEvent &event)
{
    return event.key() == Qt::Key_Return || event.key() == Qt::Key_Enter;
}

bool isTab(const QKeyEvent &event)
{
    const bool tab = event.key() == Qt::Key_Tab || event.key() == Qt::Key_Backtab;
    return tab && !(event.modifiers() & (Qt::ControlModifier | Qt::AltModifier));
}

bool isGridKey(const QKeyEvent &event)
{
    if (isEnter(event) || isTab(event))
        return true;
    switch (event.key()) {
    case Qt::Key_Insert:
        return isPlain(event) || event.modifiers() == Qt::ShiftModifier;
    case Qt::Key_End:
        return isPlain(event) && SentKey::is(event);
    case Qt::Key_Up:
    case Qt::Key_Down:
    case Qt::Key_PageUp:
    case Qt::Key_PageDown:
        return isPlain(event);
    default:
        return false;
    }
}

} // namespace

CellEdit::CellEdit(const QString &name, QWidget *parent) : QLineEdit(parent)
{
    setFrame(false);
    setAccessibleName(name);
    connect(this, &QLineEdit::textEdited, this, &CellEdit::suggest);
}

CellEdit::~CellEdit()
{
    delete mPopup;
}

void CellEdit::setList(const QStringList &list, const QString &arrowName)
{
    mList = list;
    QAction *arrow = addAction(arrowIcon(), TrailingPosition);
    arrow->setText(arrowName);
    arrow->setToolTip(arrowName);
    connect(arrow, &QAction::triggered, this, [this] { showSuggestions(mList); });
}

// The style's own arrow, in the colours of the palette.
QIcon CellEdit::arrowIcon() const
{
    const int side = fontMetrics().height();
    QPixmap picture(QSize(side, side) * devicePixelRatio());
    picture.setDevicePixelRatio(devicePixelRatio());
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    QStyleOption option;
    option.initFrom(this);
    option.state |= QStyle::State_Enabled;
    option.rect = QRect(side / 4, side / 4, side / 2, side / 2);
    style()->drawPrimitive(QStyle::PE_IndicatorArrowDown, &option, &painter, this);
    return picture;
}

// All keys come through here first, before Tab is taken for a change of the focus.
bool CellEdit::event(QEvent *event)
{
    if (event->type() == QEvent::ShortcutOverride || event->type() == QEvent::KeyPress) {
        auto *key = static_cast<QKeyEvent *>(event);
        const bool pressed = event->type() == QEvent::KeyPress;
        if (pressed ? takeKey(key) : isGridKey(*key)) {
            event->accept();
            return true;
        }
    }
    return QLineEdit::event(event);
}

bool CellEdit::takeKey(QKeyEvent *event)
{
    if (takeListKey(event))
        return true;
    if (event->key() == Qt::Key_Escape) {
        hidePopup();
        emit cancelled();
        return true;
    }
    if (!isGridKey(*event))
        return false;
    hidePopup();
    emit gridKey(event);
    return true;
}

// Of the keys that move in the list those that are typed, for a toolbar means the grid.
bool CellEdit::takeListKey(QKeyEvent *event)
{
    const bool down = event->key() == Qt::Key_Down;
    if (down && event->modifiers().testFlag(Qt::AltModifier)) {
        if (!mList.isEmpty())
            showSuggestions(mList);
        else
            suggest();
        return true;
    }
    if (!popupShown())
        return false;
    const int entry = mPopup->currentRow();
    if ((isEnter(*event) || isTab(*event)) && entry >= 0)
        choose(entry); // and the grid gets the key
    const bool moves = (down || event->key() == Qt::Key_Up) && isPlain(*event);
    if (!moves || SentKey::is(*event))
        return false;
    const int to = entry + (down ? 1 : -1);
    if (to < 0)
        mPopup->setCurrentRow(-1); // back to what was typed
    else if (to < mPopup->count())
        mPopup->setCurrentRow(to);
    return true;
}

void CellEdit::suggest()
{
    QStringList texts;
    if (mSuggestions && !text().trimmed().isEmpty())
        texts = mSuggestions(text());
    if (texts == QStringList(text()))
        texts.clear();
    showSuggestions(texts);
}

void CellEdit::showSuggestions(const QStringList &texts)
{
    if (texts.isEmpty()) {
        hidePopup();
        return;
    }
    if (!mPopup) {
        mPopup = new QListWidget(window());
        mPopup->setObjectName(u"Suggestions"_s);
        mPopup->setAccessibleName(GetMessage("xSuggestions"));
        mPopup->setFocusPolicy(Qt::NoFocus);
        mPopup->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
        mPopup->setAutoFillBackground(true);
        mPopup->setFont(font());
        connect(mPopup, &QListWidget::itemClicked, this,
                [this](QListWidgetItem *item) { choose(mPopup->row(item)); });
    }
    mPopup->clear();
    mPopup->addItems(texts);
    mPopup->setCurrentRow(-1);
    placePopup();
    mPopup->show();
    mPopup->raise();
}

// Below the field, or above it where the window ends too soon.
void CellEdit::placePopup()
{
    const int lines = std::min(mPopup->count(), linesShown);
    const int border = 2 * mPopup->frameWidth();
    const int wide = std::max(width(), mPopup->sizeHintForColumn(0) + border +
                                           style()->pixelMetric(QStyle::PM_ScrollBarExtent));
    QRect place(mapTo(window(), QPoint(0, height())),
                QSize(wide, lines * mPopup->sizeHintForRow(0) + border));
    const int above = mapTo(window(), QPoint(0, 0)).y();
    if (place.bottom() > window()->height() && above > place.height())
        place.moveBottom(above - 1);
    place.moveRight(std::min(place.right(), window()->width() - 1));
    place.moveLeft(std::max(place.left(), 0));
    mPopup->setGeometry(place);
}

void CellEdit::hidePopup()
{
    if (mPopup)
        mPopup->hide();
}

bool CellEdit::popupShown() const
{
    return mPopup && mPopup->isVisible();
}

void CellEdit::choose(int entry)
{
    setText(mPopup->item(entry)->text());
    hidePopup();
}

void CellEdit::hideEvent(QHideEvent *event)
{
    hidePopup();
    QLineEdit::hideEvent(event);
}
