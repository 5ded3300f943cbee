#include "collection/disctabs.h"

#include "catalogue/discnumber.h"
#include "services/messages.h"

#include <QSignalBlocker>
#include <QWheelEvent>
#include <algorithm>

using namespace Qt::StringLiterals;

DiscTabs::DiscTabs(QWidget *parent) : QTabBar(parent)
{
    setExpanding(false);
    setAccessibleName(GetMessage("xDiscs"));
    connect(this, &QTabBar::currentChanged, this,
            [this](int tab) { emit left(std::exchange(mShown, tab)); });
}

// Bar and tabs are hidden while their number changes: the bar lays out all that can be seen for
// each one that comes or goes, and with thousands of discs that took ten seconds.
void DiscTabs::setCount(qint64 count)
{
    const QSignalBlocker quiet(this);
    const int wanted = int(std::clamp<qint64>(count, 1, highestDisc));
    const bool shown = !isHidden();
    hide();
    showTab(0);
    setOthersVisible(false);
    while (QTabBar::count() > wanted)
        removeTab(QTabBar::count() - 1);
    while (QTabBar::count() < wanted) {
        add();
        setTabVisible(QTabBar::count() - 1, QTabBar::count() == 1);
    }
    setOthersVisible(true);
    setVisible(shown);
    showTab(0);
}

void DiscTabs::setOthersVisible(bool visible)
{
    for (int tab = 1; tab < count(); ++tab)
        setTabVisible(tab, visible);
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
