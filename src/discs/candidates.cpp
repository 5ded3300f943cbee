#include "discs/candidates.h"

#include <QSet>

using namespace Qt::StringLiterals;

namespace
{

// Blanks and line ends of all kinds become blanks; what cannot be shown goes.
bool isLineEnd(char16_t c)
{
    return c == u'\n' || c == u'\r' || c == u'\t' || c == 0x0B || c == 0x0C || c == 0x85 ||
           c == 0x2028 || c == 0x2029;
}

bool isControl(char16_t c)
{
    return c < 0x20 || (c >= 0x7F && c < 0xA0);
}

// Embeddings and overrides: one without its end turns round what is shown behind the text.
bool isDirection(char16_t c)
{
    return (c >= 0x202A && c <= 0x202E) || (c >= 0x2066 && c <= 0x2069);
}

bool isNoCharacter(char16_t c)
{
    return c == 0xFEFF || c >= 0xFFFE || (c >= 0xFDD0 && c <= 0xFDEF);
}

bool isLoneSurrogate(const QString &text, qsizetype at)
{
    const QChar c = text[at];
    if (c.isHighSurrogate())
        return at + 1 == text.size() || !text[at + 1].isLowSurrogate();
    return c.isLowSurrogate() && (at == 0 || !text[at - 1].isHighSurrogate());
}

bool isToClean(const QString &text, qsizetype at)
{
    const char16_t c = text[at].unicode();
    return isControl(c) || (c > 0x2027 && (isLineEnd(c) || isDirection(c) || isNoCharacter(c))) ||
           (text[at].isSurrogate() && isLoneSurrogate(text, at));
}

QString cleaned(const QString &text)
{
    QString clean;
    clean.reserve(text.size());
    for (qsizetype at = 0; at < text.size(); ++at) {
        const char16_t c = text[at].unicode();
        const bool isPair = c == u'\r' && at + 1 < text.size() && text[at + 1] == u'\n';
        if (!isToClean(text, at))
            clean += text[at];
        else if (isLineEnd(c) && !isPair)
            clean += u' ';
    }
    return clean;
}

QString plainSign(char16_t c)
{
    switch (c) {
    case 0x2018:
    case 0x2019:
    case 0x201B:
    case 0x02BC: // clang-format off
        return u"'"_s;
    case 0x201C: case 0x201D: case 0x201E: case 0x201F:
        return u"\""_s;
    case 0x2010: case 0x2011: case 0x2012: case 0x2013: case 0x2014: case 0x2212:
        return u"-"_s; // clang-format on
    case 0x2026:
        return u"..."_s;
    case 0x00A0:
    case 0x202F:
        return u" "_s;
    default:
        return QString(QChar(c));
    }
}

QStringList shown(const ArtistName &artist)
{
    return {artist.name, artist.first, artist.last};
}

// All that is shown of a candidate or stored of it, as one text.
QString faceOf(const DiscRecord &disc)
{
    QStringList all{disc.title, disc.year,    disc.genre,   disc.numberInSet, disc.totalInSet,
                    disc.label, disc.country, disc.barcode, disc.category};
    all << QString::number(disc.trackCount) << QString::number(int(disc.isCompilation))
        << shown(disc.artist);
    for (const TrackRecord &track : disc.tracks)
        all << track.title << track.year << track.genre << shown(track.artist);
    return plainSigns(all.join(u'\0'));
}

const QSet<QString> &variousNames()
{
    static const QSet<QString> names{
        u"various"_s,
        u"variousartist"_s,
        u"variousartists"_s,
        u"variousperformers"_s,
        u"va"_s,
        u"aavv"_s,
        u"multipleartists"_s,
        u"sampler"_s,
        u"compilation"_s,
        u"diverse"_s,
        u"diversen"_s,
        u"diverseartiesten"_s,
        u"diverseuitvoerenden"_s,
        u"divers"_s,
        u"verschillendeartiesten"_s,
        u"verschillendeuitvoerenden"_s,
        u"verzamel"_s,
        u"verzamelcd"_s,
        u"verzamelalbum"_s,
        u"verschiedene"_s,
        u"verschiedeneinterpreten"_s,
        u"verschiedenekünstler"_s,
        u"diverseinterpreten"_s,
        u"diversekünstler"_s,
        u"artistesdivers"_s,
        u"artistesvariés"_s,
        u"diversartistes"_s,
        u"varios"_s,
        u"variosartistas"_s,
        u"variosintérpretes"_s,
        u"variosinterpretes"_s,
        u"vari"_s,
        u"artistivari"_s,
        u"autorivari"_s,
        u"váriosartistas"_s,
        u"diverseartister"_s,
        u"diversekunstnere"_s,
        u"blandadeartister"_s,
    };
    return names;
}

} // namespace

QString cleanText(const QString &foreign)
{
    for (qsizetype at = 0; at < foreign.size(); ++at) {
        if (isToClean(foreign, at))
            return cleaned(foreign).trimmed();
    }
    return foreign.trimmed();
}

QString plainSigns(const QString &text)
{
    QString plain;
    plain.reserve(text.size());
    for (const QChar c : text) {
        if (c.unicode() < 0x80)
            plain += c;
        else
            plain += plainSign(c.unicode());
    }
    return plain;
}

QString yearOf(QStringView date)
{
    constexpr qsizetype digits = 4;
    const QStringView year = date.trimmed().left(digits);
    const bool isYear = year.size() == digits && year != u"0000" &&
                        std::ranges::all_of(year, [](QChar c) { return c >= u'0' && c <= u'9'; });
    const QStringView behind = date.trimmed().mid(digits, 1);
    return isYear && (behind.isEmpty() || !behind.front().isLetterOrNumber()) ? year.toString()
                                                                              : QString();
}

bool isVariousArtists(const QString &name)
{
    constexpr qsizetype longest = 60;
    if (name.size() > longest)
        return false;
    QString letters;
    for (const QChar c : name.toCaseFolded()) {
        if (c.isLetterOrNumber())
            letters += c;
    }
    return variousNames().contains(letters);
}

std::vector<DiscRecord> withoutRepeats(const std::vector<DiscRecord> &candidates)
{
    std::vector<DiscRecord> kept;
    QSet<QString> faces;
    for (const DiscRecord &disc : candidates) {
        const auto before = faces.size();
        faces.insert(faceOf(disc));
        if (faces.size() > before)
            kept.push_back(disc);
    }
    return kept;
}
