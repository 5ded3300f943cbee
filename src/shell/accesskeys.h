#pragma once

#include <QKeyCombination>
#include <QObject>
#include <QPointer>

class QMenuBar;
class QWidget;

/// Lets an access key of the screen that has the focus beat the same one of the menu bar: the
/// system would always open the menu.
class AccessKeys : public QObject
{
    Q_OBJECT

public:
    AccessKeys(const QMenuBar *menus, QObject *parent);

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    bool belongsToMenu(QKeyCombination key) const;
    static QWidget *ownerOf(QKeyCombination key);
    static void activate(QWidget *owner);

    const QMenuBar *mMenus;
    QPointer<QWidget> mOwner; // of the key that is being pressed
};
