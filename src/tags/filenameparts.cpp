#include "tags/filenameparts.h"

#include <QFileInfo>
#include <QRegularExpression>

using namespace Qt::StringLiterals;

namespace
{

// Underscores stand for blanks where there are none.
QString spaced(QString name)
{
    if (!name.contains(u' '))
        name.replace(u'_', u' ');
    name.replace(QChar(0x2013), u'-'); // the long stroke parts as the short one
    return name.simplified();
}

// At the first sign with blanks around it; a name without one is parted at the strokes inside, as
// far as these are all there is between the words: "A-ha - Take on me" holds both.
QStringList partsOf(const QString &name)
{
    QStringList parts = name.split(u" - "_s);
    if (parts.size() == 1)
        parts = name.split(u'-');
    for (QString &part : parts)
        part = part.trimmed();
    parts.removeAll(QString());
    return parts;
}

// Takes the number in front off the name: "03", "(03)", "03.", "1-03", "A3" is none.
int takeNumber(QString &name)
{
    static const QRegularExpression front(
        u"^\\s*(?:[0-9]{1,2}\\s?[-.]\\s?(?=[0-9]{2}\\b))?[(\\[]?([0-9]{1,3})[)\\]]?(?:\\s*[-._)]+\\s*|\\s+|$)"_s);
    const auto found = front.match(name);
    if (!found.hasMatch())
        return 0;
    const int number = found.captured(1).toInt();
    constexpr int mostTracks = 99;
    if (number < 1 || number > mostTracks)
        return 0;
    name.remove(0, found.capturedLength());
    return number;
}

QString takeYear(QString &name)
{
    static const QRegularExpression behind(
        u"\\s*[(\\[]\\s*((?:19|20)[0-9]{2})\\b[^)\\]]*[)\\]]\\s*$"_s);
    static const QRegularExpression before(
        u"^\\s*[(\\[]?((?:19|20)[0-9]{2})[)\\]]?(?:\\s+-?\\s*|-)(?=.)"_s);
    for (const auto &form : {behind, before}) {
        const auto found = form.match(name);
        if (found.hasMatch()) {
            name.remove(found.capturedStart(), found.capturedLength());
            return found.captured(1);
        }
    }
    return {};
}

// A part of a set in a folder of its own says nothing of the album.
bool isPartOfSet(const QString &folder)
{
    static const QRegularExpression form(u"^(?:cd|dis[ck]|schijf|deel|part)[ ._-]*[0-9]{1,2}$"_s,
                                         QRegularExpression::CaseInsensitiveOption);
    return form.match(folder).hasMatch();
}

// "Track 03", "AudioTrack 3": what programs call a track that they know nothing of.
bool saysNothing(const QString &title)
{
    static const QRegularExpression form(
        u"^(?:audio ?)?(?:track|spoor|piste|titel|nummer|nr\\.?)[ ._-]*[0-9]{0,3}$"_s,
        QRegularExpression::CaseInsensitiveOption);
    return form.match(title).hasMatch();
}

int lastNumber(const QString &title)
{
    static const QRegularExpression number(u"([0-9]{1,2})$"_s);
    return number.match(title).captured(1).toInt();
}

// A part that is a number alone: "Artist - Album - 03 - Title".
void readWords(FileNameParts &parts, QStringList words)
{
    static const QRegularExpression number(u"^[0-9]{1,2}$"_s);
    const qsizetype at = parts.track == 0 ? words.indexOf(number) : -1;
    const bool hasNumber = at > 0 && at + 1 < words.size();
    if (hasNumber) {
        parts.track = words.takeAt(at).toInt();
        if (at > 1)
            parts.album = words.takeAt(1);
    }
    if (words.size() > 1)
        parts.artist = words.takeFirst();
    parts.title = words.join(u" - "_s);
}

void readFolder(FileNameParts &parts, const QString &folder)
{
    QString name = spaced(QFileInfo(folder).fileName());
    if (isPartOfSet(name))
        name = spaced(QFileInfo(QFileInfo(folder).path()).fileName());
    parts.year = takeYear(name);
    const qsizetype sign = name.indexOf(" - "_L1);
    parts.albumArtist = sign > 0 ? name.left(sign).trimmed() : QString();
    parts.album = (sign > 0 ? name.mid(sign + 3) : name).trimmed();
    if (parts.year.isEmpty()) // "Artist - 1985 - Album"
        parts.year = takeYear(parts.album);
}

} // namespace

FileNameParts filenameParts(const QString &path)
{
    FileNameParts parts;
    const QFileInfo file(path);
    readFolder(parts, file.path());
    QString name = spaced(file.completeBaseName());
    parts.track = takeNumber(name);
    readWords(parts, partsOf(name));
    if (saysNothing(parts.title)) {
        parts.track = parts.track == 0 ? lastNumber(parts.title) : parts.track;
        parts.title.clear();
    }
    return parts;
}
