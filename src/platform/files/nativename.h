#pragma once

#include <QByteArray>
#include <QString>

/// Names of files between the system, which knows bytes, and the program, which knows texts. Bytes
/// that are no UTF-8 become characters from U+EF80 on, one each, so that every file has a name that
/// can be shown and stored, and that leads back to it byte for byte.
QString nameOfNative(const QByteArray &bytes);
QByteArray nativeName(const QString &name);
