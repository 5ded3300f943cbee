#include "collection/disctabs.h"

#include "services/messages.h"

#include <QSignalBlocker>
#include <QWheelEvent>

using namespace Qt::StringLiterals;

DiscTabs::DiscTabs(QWidget *parent) : QTabBar(parent)
{
    setExpanding(false);
    setAccessibleName(GetMessage("xDiscs"));
    connect(this, &QTabBar::currentChanged, this,
            [this](int tab) { emit left(std::exchange(mShown, tab)); });
}

void DiscTabs::setCount(int count)
{
    const QSignalBlocker quiet(this);
    while (QTabBar::count() > count)
        removeTab(QTabBar::count() - 1);
    while (QTabBar::count() < count)
        add();
    showTab(0);
}

void DiscTabs::add()
{
    const QSignalBlocker quiet(this);
    addTab(u"Disc &"_s + QString::number(count() + 1));
}

void DiscTabs::showTab(int tab)
{
    const QSignalBlocker quiet(this);
    setCurrentIndex(tab);
    mShown = tab;
}

// One that passes over the tabs must not save and change discs.
void DiscTabs::wheelEvent(QWheelEvent *event)
{
    event->ignore();
}
