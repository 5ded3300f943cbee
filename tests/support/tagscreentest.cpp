#include "support/tagscreentest.h"

#include "discdata/cddbuserprofile.h"

#include <QDir>

void signUpAt(const StandInServer &server)
{
    CddbUserProfile profile;
    profile.registered = true;
    profile.mail = u"jo@example.net"_s;
    profile.services = texts("musicbrainz");
    profile.musicBrainzAddress = server.address();
    profile.store();
}

QByteArray discsOfService(const QStringList &titles, int tracks)
{
    QByteArrayList discs, list;
    for (int number = 1; number <= tracks; ++number)
        list.append("{\"title\":\"Song " + QByteArray::number(number) +
                    "\",\"length\":" + QByteArray::number(10000 * number) + "}");
    for (const QString &title : titles)
        discs.append(
            "{\"id\":\"0b0b0b0b-0000-4000-8000-000000000001\",\"title\":\"" + title.toUtf8() +
            "\",\"date\":\"1985\",\"artist-credit\":[{\"name\":\"Nora\"}],\"label-info\":"
            "[{\"label\":{\"name\":\"Sea\"}}],\"media\":[{\"position\":1,\"track-count\":" +
            QByteArray::number(tracks) + ",\"tracks\":[" + list.join(',') + "]}]}");
    return "{\"id\":\"x\",\"releases\":[" + discs.join(',') + "]}";
}

QString lineOf(const CddbID3Tag &tag)
{
    return QStringList{tag.LeadArtist(),    tag.Album(),     tag.Title(),
                       tag.TrackPosition(), tag.PartOfSet(), tag.Year(),
                       tag.Genre(),         tag.Label(),     tag.Comments()}
        .join(u'|');
}

void TagScreenTest::init()
{
    ScreenTest::init();
    mServer = std::make_unique<StandInServer>();
    signUpAt(*mServer);
    const QString folder = mCatalogue->path(u"Nora - Harbour"_s);
    QDir().mkpath(folder);
    mFiles = makeSounds(folder, {{u"1.mp3"_s, 10000}, {u"2.mp3"_s, 20000}, {u"3.mp3"_s, 30000}});
    mCatalogue->exec(uR"(insert into Artiesten values (1,'Nora');
        insert into Tracks values (1,1,'One','Rock',1985),(2,1,'Two',null,null),(3,1,'Three','Pop',1);
        insert into CDTitels values (1,'Harbour',1,'E',null,1990);
        insert into CompactDiscs values (1,1,1,1,1,null),(2,1,1,2,2,null),(3,1,1,3,3,null),
            (4,1,2,1,1,null);)"_s);
    gTagsChanged = false;
}

QString TagScreenTest::tagIn(int file) const
{
    CddbID3Tag tag;
    tag.LoadFromFile(path(file), 1);
    return lineOf(tag);
}

void TagScreenTest::serve(const QStringList &titles, int tracks)
{
    mServer->answer("discid/", discsOfService(titles, tracks));
    mServer->answer("query=", "{\"releases\":[],\"recordings\":[]}");
}
