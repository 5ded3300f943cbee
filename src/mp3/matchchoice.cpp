#include "mp3/matchchoice.h"

using namespace Qt::StringLiterals;

qint64 gMatchCDId = 0;
qint64 gMatchDiscNo = 0;
qint64 gMatchTrackNo = 0;
bool gMatchChosen = false;

namespace matchkey
{

const QString root = u"DefaultRoot"_s;

QString ofDisc(qint64 cdId, qint64 discNo)
{
    return u"CD"_s + QString::number(cdId) + u"Discno"_s + QString::number(discNo);
}

QString ofTrack(const QString &discKey, qint64 trackNo)
{
    return discKey + u"Trackno"_s + QString::number(trackNo);
}

qint64 takeNumber(QString &key, const QString &mark)
{
    const qsizetype at = key.lastIndexOf(mark);
    if (at < 0)
        return 0;
    const qint64 number = key.mid(at + mark.size()).toLongLong();
    key.truncate(at);
    return number;
}

} // namespace matchkey
