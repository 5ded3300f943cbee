#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>

/// How the services are asked: what the user has set, and what only a test sets otherwise.
struct ServiceOptions {
    QStringList order = {QStringLiteral("musicbrainz"), QStringLiteral("cddb")}; // asked in it

    // Without a scheme: https, and for the first of them http where nobody answers there.
    QString cddbAddress = QStringLiteral("gnudb.gnudb.org");
    QString musicBrainzAddress = QStringLiteral("https://musicbrainz.org");

    QString mail;      // the user's own; a CDDB server wants it with every request
    bool test = false; // discs that are sent are looked at there and not stored

    QString proxyHost; // empty: none
    int proxyPort = 0;
    QString proxyUser, proxyPassword;

    QByteArray extraCa;  // PEM: believed beside those that the system believes
    int silence = 15000; // milliseconds without a byte after which a server is given up
    int interval = 1000; // milliseconds between two requests to a server, and the first pause
    QString paceFolder;  // where the copies of the program tell each other; empty: the user's own
};
