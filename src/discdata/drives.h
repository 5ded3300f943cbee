#pragma once

#include <QByteArray>
#include <QStringList>

/// The optical drives of this computer as paths of devices ("/dev/sr0"), in order. Asks the system
/// alone, no drive.
QStringList opticalDrives();

/// The names in what the system tells of its drives: /proc/sys/dev/cdrom/info of Linux.
QStringList drivesIn(const QByteArray &info);

/// Whether a name is that of the image of a disc, or of a sheet that describes one.
bool isImage(const QString &name);
