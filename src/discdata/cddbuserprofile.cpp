#include "discdata/cddbuserprofile.h"

#include "services/clsRegistry.h"

#include <QRegularExpression>

using namespace Qt::StringLiterals;

QStringList knownServices()
{
    return {u"musicbrainz"_s, u"cddb"_s};
}

QString serviceTitle(const QString &service)
{
    return service == "cddb"_L1 ? u"CDDB"_s : u"MusicBrainz"_s;
}

bool isMailAddress(const QString &text)
{
    static const QRegularExpression address(
        u"\\A[^\\s@\"<>,;:()]+@[^\\s@\"<>,;:()]+\\.[^\\s@\"<>,;:().]{2,}\\z"_s);
    return address.match(text).hasMatch();
}

CddbUserProfile CddbUserProfile::stored()
{
    clsRegistry settings;
    settings.ysnFailSoftRead = true;
    const auto read = [&](const QString &name) {
        return settings.GetValue(settingsReadKey, name).toString();
    };
    CddbUserProfile profile;
    profile.registered = read(u"CDDBRegistered"_s) == u'1';
    profile.name = read(u"CDDBUserName"_s);
    profile.mail = read(u"CDDBUserMail"_s);
    profile.cddbAddress = read(u"CDDBAddress"_s);
    profile.musicBrainzAddress = read(u"MusicBrainzAddress"_s);
    for (const QString &service : read(u"CDDBServices"_s).split(u',', Qt::SkipEmptyParts)) {
        if (knownServices().contains(service) && !profile.services.contains(service))
            profile.services.append(service);
    }
    if (!profile.registered && profile.services.isEmpty())
        profile.services = knownServices();
    return profile;
}

void CddbUserProfile::store() const
{
    clsRegistry settings;
    settings.CreateKey(settingsKey);
    const auto write = [&](const QString &name, const QVariant &value) {
        settings.SetValue(settingsKey, name, value);
    };
    write(u"CDDBUserName"_s, name);
    write(u"CDDBUserMail"_s, mail);
    write(u"CDDBAddress"_s, cddbAddress);
    write(u"MusicBrainzAddress"_s, musicBrainzAddress);
    write(u"CDDBServices"_s, services.join(u','));
    write(u"CDDBRegistered"_s, registered ? 1 : 0);
}
