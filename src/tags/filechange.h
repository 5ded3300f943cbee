#pragma once

#include "platform/files/systemfile.h"

#include <QDataStream>
#include <QDateTime>

/// One change of one file of the user, as the journal tells it before it happens.
struct FileChange {
    enum class Way : quint8 {
        InPlace, // some bytes for others, as many
        Beside,  // a new file that takes the name of the old one
        Through, // all of the file written anew, from a copy in the folder of the journal
        Move     // another name
    };

    qint64 id = 0, batch = 0;
    Way way = Way::InPlace;
    QString path;         // without links; of a move the old name
    QString other;        // Beside: the new file; Through: the copy; Move: the new name
    FileStamp before;     // of the file
    qint64 from = 0;      // InPlace: where the bytes stand
    qint64 oldHead = 0;   // bytes at the beginning that others
    qint64 newHead = 0;   // take the place of
    QByteArray newHeadIs; // a checksum of those

    qint64 newSize() const { return before.size - oldHead + newHead; }
};

/// One command of the user.
struct ChangeBatch {
    qint64 number = 0;
    QDateTime when;
    QString what, where; // the key of a text; a folder or the name of a collection
    qint64 undoes = 0;   // the batch that this one took back
};

QByteArray headChecksum(const QByteArray &head);

QDataStream &operator<<(QDataStream &out, const FileStamp &stamp);
QDataStream &operator>>(QDataStream &in, FileStamp &stamp);
QDataStream &operator<<(QDataStream &out, const FileChange &change);
QDataStream &operator>>(QDataStream &in, FileChange &change);
QDataStream &operator<<(QDataStream &out, const ChangeBatch &batch);
QDataStream &operator>>(QDataStream &in, ChangeBatch &batch);
