#include "discs/genretable.h"

#include <array>

using namespace Qt::StringLiterals;

namespace
{

// The genres of ID3v1 (0 to 79) and those that players have added to them. A place is a number.
// clang-format off
constexpr std::array usual{
    "Blues", "Classic Rock", "Country", "Dance", "Disco", "Funk", "Grunge", "Hip-Hop", "Jazz", "Metal",
    "New Age", "Oldies", "Other", "Pop", "R&B", "Rap", "Reggae", "Rock", "Techno", "Industrial",
    "Alternative", "Ska", "Death Metal", "Pranks", "Soundtrack", "Euro-Techno", "Ambient", "Trip-Hop", "Vocal", "Jazz+Funk",
    "Fusion", "Trance", "Classical", "Instrumental", "Acid", "House", "Game", "Sound Clip", "Gospel", "Noise",
    "Alternative Rock", "Bass", "Soul", "Punk", "Space", "Meditative", "Instrumental Pop", "Instrumental Rock", "Ethnic", "Gothic",
    "Darkwave", "Techno-Industrial", "Electronic", "Pop-Folk", "Eurodance", "Dream", "Southern Rock", "Comedy", "Cult", "Gangsta",
    "Top 40", "Christian Rap", "Pop/Funk", "Jungle", "Native American", "Cabaret", "New Wave", "Psychedelic", "Rave", "Showtunes",
    "Trailer", "Lo-Fi", "Tribal", "Acid Punk", "Acid Jazz", "Polka", "Retro", "Musical", "Rock & Roll", "Hard Rock",
    "Folk", "Folk-Rock", "National Folk", "Swing", "Fast Fusion", "Bebop", "Latin", "Revival", "Celtic", "Bluegrass",
    "Avantgarde", "Gothic Rock", "Progressive Rock", "Psychedelic Rock", "Symphonic Rock", "Slow Rock", "Big Band", "Chorus", "Easy Listening", "Acoustic",
    "Humour", "Speech", "Chanson", "Opera", "Chamber Music", "Sonata", "Symphony", "Booty Bass", "Primus", "Porn Groove",
    "Satire", "Slow Jam", "Club", "Tango", "Samba", "Folklore", "Ballad", "Power Ballad", "Rhythmic Soul", "Freestyle",
    "Duet", "Punk Rock", "Drum Solo", "A Cappella", "Euro-House", "Dance Hall", "Goa", "Drum & Bass", "Club-House", "Hardcore",
    "Terror", "Indie", "BritPop", "Afro-Punk", "Polsk Punk", "Beat", "Christian Gangsta Rap", "Heavy Metal", "Black Metal", "Crossover",
    "Contemporary Christian", "Christian Rock", "Merengue", "Salsa", "Thrash Metal", "Anime", "JPop", "Synthpop",
};
// clang-format on

const QStringList &usualTable()
{
    static const QStringList table = [] {
        QStringList names;
        for (const char *name : usual)
            names << QString::fromLatin1(name);
        return names;
    }();
    return table;
}

// Letters and digits alone: "hip hop" is "Hip-Hop", "drum and bass" is "Drum & Bass".
QString bare(const QString &name)
{
    const QString folded = name.toCaseFolded().replace(u" and "_s, u" "_s);
    QString letters;
    for (const QChar c : folded) {
        if (c.isLetterOrNumber())
            letters += c;
    }
    return letters;
}

const QHash<QString, QString> &usualByBareName()
{
    static const QHash<QString, QString> names = [] {
        QHash<QString, QString> table;
        for (const QString &name : usualTable())
            table.insert(bare(name), name);
        return table;
    }();
    return names;
}

QString keyOf(const QString &name)
{
    return name.trimmed().toCaseFolded();
}

} // namespace

GenreTable::GenreTable() : mNames(usualTable())
{
    for (int number = 0; number < mNames.size(); ++number)
        mIds.insert(keyOf(mNames[number]), number);
}

QString GenreTable::idOf(const QString &name)
{
    const QString key = keyOf(name);
    if (key.isEmpty())
        return {};
    auto found = mIds.constFind(key);
    if (found == mIds.constEnd()) {
        found = mIds.insert(key, int(mNames.size()));
        mNames << name.trimmed();
    }
    return QString::number(*found);
}

QString GenreTable::nameOf(const QString &id) const
{
    bool isNumber = false;
    const int number = id.toInt(&isNumber);
    return isNumber ? mNames.value(number) : QString();
}

const QStringList &GenreTable::usualNames() const
{
    return usualTable();
}

QString id3GenreName(int number)
{
    return usualTable().value(number);
}

QString genreAsWritten(const QString &name)
{
    const QString trimmed = name.trimmed();
    QString known = usualByBareName().value(bare(trimmed));
    if (!known.isEmpty() || trimmed.isEmpty())
        return known;
    return trimmed.front().toUpper() + trimmed.sliced(1);
}
