#pragma once

#include "discs/discrecord.h"

#include <QByteArray>

/// The first line of a server's answer, and the lines behind it up to the single point.
struct CddbAnswer {
    int code = 0;
    QString text; // behind the code
    QByteArray body;
    bool isWhole = false; // false: lines should follow and their end did not come

    /// The server does not want this program or this command; its own words are in `text`. Not
    /// so: no such entry (401), an entry that is damaged (403), and its own trouble.
    bool isRefusal() const;

    bool isMissing() const; // no such entry

    /// An error of the server or too many users: it may be asked again later.
    bool isTrouble() const;
};

/// Throws Error (errSyntax) where the bytes do not begin with three digits, as HTML does.
CddbAnswer readCddbAnswer(const QByteArray &bytes);

/// The candidates of an answer to a query, in the order of the server, with both keys: category and
/// id. Empty for "no match"; Error (errSyntax) where it is no answer to a query, or a cut one.
std::vector<DiscRecord> cddbCandidates(const CddbAnswer &answer);

/// Whether a record stands for a refusal: its tracks say that the program is not supported.
bool isRefusal(const DiscRecord &disc);

/// The eleven places that such a server stores records in.
const QStringList &cddbCategories();
