#pragma once

#include "discs/discrecord.h"

/// Takes out those that differ from an earlier one in nothing that is shown or stored. Texts count
/// as equal with typographic signs folded (’ and ', ‐ and -).
std::vector<DiscRecord> withoutRepeats(const std::vector<DiscRecord> &candidates);

/// A name of "Various Artists", in the languages that records use.
bool isVariousArtists(const QString &name);

/// Without control signs, blanks at the ends and marks that a text cannot be shown with; what is
/// left is as it came.
QString cleanText(const QString &foreign);

/// With typographic signs as a keyboard has them: ’ as ', ‐ as -, … as three points.
QString plainSigns(const QString &text);

/// The first four digits of a date or a year; empty where it does not begin with a year.
QString yearOf(QStringView date);
