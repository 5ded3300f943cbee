#include "discdata/drives.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QRegularExpression>

using namespace Qt::StringLiterals;

QStringList drivesIn(const QByteArray &info)
{
    QStringList names;
    for (const QByteArray &line : info.split('\n')) {
        const QList<QByteArray> words = line.simplified().split(' ');
        if (words.size() > 2 && words[0] == "drive" && words[1] == "name:") {
            for (const QByteArray &name : words.mid(2))
                names.append(QString::fromLatin1(name));
        }
    }
    names.sort();
    return names;
}

QStringList opticalDrives()
{
    QFile info(u"/proc/sys/dev/cdrom/info"_s);
    QStringList names;
    if (info.open(QIODevice::ReadOnly))
        names = drivesIn(info.readAll());
    else
        names = QDir(u"/dev"_s).entryList({u"sr[0-9]*"_s}, QDir::System, QDir::Name);
    names.replaceInStrings(QRegularExpression(u"^"_s), u"/dev/"_s);
    return names;
}

bool isImage(const QString &name)
{
    static const QStringList endings{u"cue"_s, u"toc"_s, u"nrg"_s, u"bin"_s, u"img"_s, u"iso"_s};
    return endings.contains(QFileInfo(name).suffix().toLower());
}
