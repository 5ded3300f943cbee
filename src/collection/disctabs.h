#pragma once

#include <QTabBar>

/// The tabs of an editor's discs, "Disc 1" and so on. Tells which tab was left when another comes
/// up by the user's hand; what the program does here raises nothing.
class DiscTabs : public QTabBar
{
    Q_OBJECT

public:
    explicit DiscTabs(QWidget *parent = nullptr);

    void setCount(qint64 count); // from 1 to highestDisc; the first one shows
    void add();                  // behind the others; it does not show yet
    void showTab(int tab);

signals:
    void left(int tab);

protected:
    void wheelEvent(QWheelEvent *event) override;

private:
    void setOthersVisible(bool visible);

    int mShown = 0;
};
