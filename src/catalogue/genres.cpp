#include "catalogue/genres.h"

#include "shell/services/messages.h"

const QStringList &genres(int language)
{
    static const QStringList dutch =
        QStringLiteral(
            "Blues|Country|Dance & Disco|Easy Listening|Folk|Gesproken woord|Gospel|Hard Rock|"
            "Hip Hop/Rap|House|Industrial|Jazz|Kerstmuziek|Kindermuziek|Klassiek|Latin|Metal|New "
            "Age|"
            "New Wave/Punk|Pop|R&B|Reggae|Rock|Songfestival|Soundtrack|Wereldmuziek|Overig")
            .split(QLatin1Char('|'));
    static const QStringList english =
        QStringLiteral(
            "Books & Spoken|Blues|Children's Music|Classical|Country|Dance & Disco|Easy "
            "Listening|Folk|"
            "Gospel|Hard Rock|Hip Hop/Rap|Holiday (Christmas "
            "etc.)|House|Industrial|Jazz|Latin|Metal|"
            "New Age|New Wave/Punk|Pop|R&B|Reggae|Rock|Songcontest|Soundtrack|World|Other")
            .split(QLatin1Char('|'));
    return language == languageDutch ? dutch : english;
}
