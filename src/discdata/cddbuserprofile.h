#pragma once

#include <QStringList>

/// What the user has said in the sign-up dialog: who he is towards the services, which of them are
/// asked and in which order. It stands in the settings; nothing is sent before it is registered.
struct CddbUserProfile {
    bool registered = false; // the user has said yes
    QString name;
    QString mail;         // of the user's own, for a CDDB-type server
    QStringList services; // "musicbrainz", "cddb", in the order in which they are asked
    QString cddbAddress, musicBrainzAddress; // empty: the usual ones

    static CddbUserProfile stored();
    void store() const;
};

/// All services there are, in the order that a new user is offered.
QStringList knownServices();

/// The name under which users know a service.
QString serviceTitle(const QString &service);

/// "user@host.domain": what a CDDB-type server takes for a mail address.
bool isMailAddress(const QString &text);
