#pragma once

#include <QComboBox>

/// The places that a disc is looked for in: the drives of the machine and, since many have none,
/// entries that ask for a file, a folder or words.
class DriveBox : public QComboBox
{
    Q_OBJECT

public:
    enum Entry { Device, Image, Folder, Words };

    explicit DriveBox(QWidget *parent = nullptr);

    /// Fills the list anew: a drive may have been plugged in. The choice stays where it can.
    void refresh();

    /// The path of the selected drive; empty for the other entries.
    QString Drive() const;
    Entry entry() const;

protected:
    void showPopup() override;

private:
    void add(const QString &text, Entry entry, const QString &path = {});
};
