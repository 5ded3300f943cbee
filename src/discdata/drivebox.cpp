#include "discdata/drivebox.h"

#include "discdata/drives.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr int pathRole = Qt::UserRole, entryRole = Qt::UserRole + 1;

} // namespace

DriveBox::DriveBox(QWidget *parent) : QComboBox(parent)
{
    refresh();
}

void DriveBox::refresh()
{
    const QString chosen = currentText();
    clear();
    for (const QString &drive : opticalDrives())
        add(drive, Device, drive);
    add(GetMessage("xImageEntry"), Image);
    add(GetMessage("xFolderEntry"), Folder);
    add(GetMessage("xWordsEntry"), Words);
    setCurrentIndex(std::max(findText(chosen), 0));
}

void DriveBox::add(const QString &text, Entry entry, const QString &path)
{
    addItem(text, path);
    setItemData(count() - 1, entry, entryRole);
}

QString DriveBox::Drive() const
{
    return currentData(pathRole).toString();
}

DriveBox::Entry DriveBox::entry() const
{
    return Entry(currentData(entryRole).toInt());
}

void DriveBox::showPopup()
{
    refresh();
    QComboBox::showPopup();
}
