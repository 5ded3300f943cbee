#pragma once

#include "support/madesound.h"
#include "support/screentest.h"
#include "support/standinserver.h"
#include "tags/CddbID3Tag.h"

/// What a test of a screen for tags stands on: three silent files in a folder, a service that knows
/// the disc they make, an album of the catalogue of as many tracks.
class TagScreenTest : public ScreenTest
{
    Q_OBJECT

protected slots:
    void init();

protected:
    QString path(int file) const { return mFiles.at(file - 1); }

    /// The tag as it is in a file: artist|album|title|track|part|year|genre|label|comments.
    QString tagIn(int file) const;

    /// What the service answers to a look-up by playing times: discs of these titles, whole.
    void serve(const QStringList &titles, int tracks = 3);

    std::unique_ptr<StandInServer> mServer;
    QStringList mFiles; // full names
};

/// Signs up at a server for both services.
void signUpAt(const StandInServer &server);

/// What MusicBrainz answers where it knows these discs.
QByteArray discsOfService(const QStringList &titles, int tracks);

/// A tag as one line: artist|album|title|track|part|year|genre|label|comments.
QString lineOf(const CddbID3Tag &tag);
