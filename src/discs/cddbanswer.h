#pragma once

#include "discs/discrecord.h"

#include <QByteArray>

/// The first line of a server's answer, and the lines behind it up to the single point.
struct CddbAnswer {
    int code = 0;
    QString text; // behind the code
    QByteArray body;
    bool isWhole = false; // false: lines should follow and their end did not come

    bool isRefusal() const; // in the server's own words: `text`
};

/// Throws Error (errSyntax) where the bytes do not begin with three digits, as HTML does.
CddbAnswer readCddbAnswer(const QByteArray &bytes);

/// The candidates of an answer to a query, in the order of the server, with both keys: category and
/// id. Empty for "no match".
std::vector<DiscRecord> cddbCandidates(const CddbAnswer &answer);

/// Whether a record stands for a refusal: its tracks say that the program is not supported.
bool isRefusal(const DiscRecord &disc);

/// The eleven places that such a server stores records in.
const QStringList &cddbCategories();
