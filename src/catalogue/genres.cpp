#include "catalogue/genres.h"

#include "services/messages.h"

namespace
{

// clang-format off
constexpr char dutchGenres[] =
    "Blues|Country|Dance & Disco|Easy Listening|Folk|Gesproken woord|Gospel|Hard Rock|Hip Hop/Rap|"
    "House|Industrial|Jazz|Kerstmuziek|Kindermuziek|Klassiek|Latin|Metal|New Age|New Wave/Punk|Pop|"
    "R&B|Reggae|Rock|Songfestival|Soundtrack|Wereldmuziek|Overig";

constexpr char englishGenres[] =
    "Books & Spoken|Blues|Children's Music|Classical|Country|Dance & Disco|Easy Listening|Folk|"
    "Gospel|Hard Rock|Hip Hop/Rap|Holiday (Christmas etc.)|House|Industrial|Jazz|Latin|Metal|"
    "New Age|New Wave/Punk|Pop|R&B|Reggae|Rock|Songcontest|Soundtrack|World|Other";
// clang-format on

QStringList parted(const char *words)
{
    return QString::fromLatin1(words).split(u'|');
}

} // namespace

const QStringList &genres(int language)
{
    static const QStringList dutch = parted(dutchGenres), english = parted(englishGenres);
    return language == languageDutch ? dutch : english;
}
