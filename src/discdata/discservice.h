#pragma once

#include "discs/discrecord.h"
#include "discs/toc.h"
#include "platform/error/error.h"

#include <vector>

class LongWork;

/// Failures of a look-up that callers tell apart. What a server says itself stands in Description.
enum DiscDataError : int {
    errHostNotFound = int(0x82FA0008), // no server of a service can be reached
    errLookupCancelled = int(0x82FA1001),
    errNotSignedUp = int(0x82FA1002),
    errServiceRefused =
        int(0x82FA1003), // in the server's own words: no use to ask again in this run
    errServiceFailed = int(0x82FA1004), // an answer that is none, an error of the server, too busy
    errNotAccepted = int(0x82FA1005),   // a record that was to be sent
    errNothingFound = int(0x82FA1006),  // by words: no disc that could be entered as a new one; by
                                        // its keys: the record is not there any more
};

/// A service that knows discs. To the caller each call is synchronous; the work shows itself, lets
/// the program paint and can be cancelled meanwhile (errLookupCancelled). Throws Error with one of
/// the numbers above.
class DiscService
{
public:
    virtual ~DiscService() = default;
    virtual QString name() const = 0; // "musicbrainz", "cddb"

    /// Discs with this table of contents; empty: not known there. One alone is whole.
    virtual std::vector<DiscRecord> find(const TableOfContents &toc, LongWork &work) = 0;

    /// Empty also where a service cannot search.
    virtual std::vector<DiscRecord> search(const SearchWords &words, LongWork &work) = 0;

    /// The discs that hold a recording which other programs have put the id of into a file. Empty
    /// also where a service has no such ids.
    virtual std::vector<DiscRecord> recording(const QString &id, LongWork &work);

    /// The whole record of a candidate of this service. errNothingFound: it is not there any more.
    virtual DiscRecord complete(const DiscRecord &candidate, LongWork &work) = 0;

    /// The same long after it was found, from the keys alone.
    virtual DiscRecord again(const DiscRecord &candidate, LongWork &work)
    {
        return complete(candidate, work);
    }

    /// Sends a record that is to be stored; errNotAccepted tells why it was not.
    virtual void send(const DiscRecord &disc, const TableOfContents &toc, LongWork &work);
};
