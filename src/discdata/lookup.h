#pragma once

#include "discdata/discservice.h"
#include "discdata/keptanswers.h"
#include "discdata/serviceoptions.h"

#include <QHash>
#include <functional>
#include <memory>

/// What services have refused in this run, by service and settings: they are not asked again.
using Refusals = QHash<QString, QString>;

/// The services in the order of the user, and the answers that are kept.
///
/// The first service that knows something decides. One that cannot be reached, fails or refuses is
/// passed over; where no other knows anything, what it answered at an earlier time is used. "Not
/// known" is said only if the service that takes new discs (CDDB) was among those that said so, or
/// is not asked at all: else the user would be invited to send a disc that may be there already, to
/// a server that cannot take it. Instead it is told why that service gave no answer.
class Lookup
{
public:
    struct Found {
        std::vector<DiscRecord> candidates; // without repeats; one alone is whole
        QString service;                    // empty: nothing found
        std::optional<QDate> keptOn;        // an answer of that day, since nobody can be asked
        bool isDoubtful = false; // the only one has another number of tracks: the user decides
    };
    struct Whole {
        DiscRecord disc;
        std::optional<QDate> keptOn;
    };

    /// `refusals` belong to the run and outlive this object; without them they end with it.
    Lookup(const ServiceOptions &options, const KeptAnswers &kept,
           std::shared_ptr<Refusals> refusals = {});
    ~Lookup();

    /// Told the words of a service that refuses: once in a run, and again whenever nothing else has
    /// come out of a call, which then throws errServiceRefused.
    std::function<void(const QString &words)> tellRefusal;

    /// All throw Error: errHostNotFound, errServiceFailed, errServiceRefused, errNotSignedUp where
    /// nobody has answered; errLookupCancelled.
    Found find(const TableOfContents &toc, LongWork &work);
    Found find(const SearchWords &words, LongWork &work);

    /// The discs that hold a recording which other programs have put the id of into a file.
    Found ofRecording(const QString &id, LongWork &work);

    /// The whole record of a candidate, from the service it comes from. errNothingFound: it is not
    /// there any more.
    Whole complete(const DiscRecord &candidate, LongWork &work);

    /// The same long after it was found: of a record nothing but service and keys.
    Whole again(const DiscRecord &candidate, LongWork &work);

    /// To the CDDB server, whatever the order; errNotAccepted as well. A refusal is not told here.
    void send(const DiscRecord &disc, const TableOfContents &toc, LongWork &work);

private:
    using Ask = std::function<std::vector<DiscRecord>(DiscService &service)>;
    struct Round; // one call over all services
    Found askAll(const QString &question, const Ask &ask, bool senderDecides);
    std::vector<DiscRecord> askOne(DiscService &service, const Ask &ask, Round &round);
    std::optional<Found> keptOf(const Round &round, const QString &question) const;
    void throwUnlessKnown(const Round &round, bool senderDecides) const;
    Found finished(Found found, LongWork &work);
    using Read = DiscRecord (DiscService::*)(const DiscRecord &candidate, LongWork &work);
    Whole read(const DiscRecord &candidate, Read read, LongWork &work);

    void requireNotRefused(const DiscService &service) const;
    void requireReached(const DiscService &service) const;
    void noteRefusal(const DiscService &service, const Error &error, Round &round);
    void tell(const QString &words, Round &round) const;
    QString identityOf(const DiscService &service) const;
    DiscService &serviceNamed(const QString &name);

    ServiceOptions mOptions;
    KeptAnswers mKept;
    std::shared_ptr<Refusals> mRefusals;
    QHash<QString, Error> mNotReached; // by service: another question would wait as long
    std::vector<std::unique_ptr<DiscService>> mServices; // in the order of the user
    std::vector<std::unique_ptr<DiscService>> mOthers;   // not in it, and needed nevertheless
};
