#include "tags/filechange.h"

#include <QCryptographicHash>

QByteArray headChecksum(const QByteArray &head)
{
    return QCryptographicHash::hash(head, QCryptographicHash::Sha1);
}

QDataStream &operator<<(QDataStream &out, const FileStamp &stamp)
{
    return out << stamp.device << stamp.inode << stamp.size << stamp.modified << stamp.changed;
}

QDataStream &operator>>(QDataStream &in, FileStamp &stamp)
{
    return in >> stamp.device >> stamp.inode >> stamp.size >> stamp.modified >> stamp.changed;
}

QDataStream &operator<<(QDataStream &out, const FileChange &change)
{
    return out << change.id << change.batch << quint8(change.way) << change.path << change.other
               << change.before << change.from << change.oldHead << change.newHead
               << change.newHeadIs;
}

QDataStream &operator>>(QDataStream &in, FileChange &change)
{
    quint8 way = 0;
    in >> change.id >> change.batch >> way >> change.path >> change.other >> change.before >>
        change.from >> change.oldHead >> change.newHead >> change.newHeadIs;
    change.way = FileChange::Way(way);
    return in;
}

QDataStream &operator<<(QDataStream &out, const ChangeBatch &batch)
{
    return out << batch.number << batch.when << batch.what << batch.where << batch.undoes;
}

QDataStream &operator>>(QDataStream &in, ChangeBatch &batch)
{
    return in >> batch.number >> batch.when >> batch.what >> batch.where >> batch.undoes;
}
