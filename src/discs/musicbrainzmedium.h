#pragma once

#include "discs/discrecord.h"

#include <QJsonArray>
#include <QJsonObject>

/// What one medium of a release in an answer of MusicBrainz says: the disc, whole where its tracks
/// are listed, else a candidate with both keys.
DiscRecord recordOfMedium(const QJsonObject &release, const QJsonObject &medium, int position);

/// The names of a credit, joined as printed; the parts of the name where it is one person alone.
ArtistName artistOfCredit(const QJsonArray &credit);

/// A text cleaned of what cannot be shown; empty for null, what is missing and other types.
QString textIn(const QJsonObject &object, const QString &name);
