#include "discdata/lookup.h"

#include "discdata/cddbserver.h"
#include "discdata/musicbrainzserver.h"
#include "discs/candidates.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr auto sender = "cddb"_L1; // takes new discs

std::unique_ptr<DiscService> makeService(const QString &name, const ServiceOptions &options)
{
    if (name == sender)
        return std::make_unique<CddbServer>(options);
    if (name == "musicbrainz"_L1)
        return std::make_unique<MusicBrainzServer>(options);
    return nullptr;
}

// More than the disc id says: two discs may share that.
QString questionOf(const TableOfContents &toc)
{
    QStringList parts = {u"disc"_s, QString::number(toc.first), QString::number(toc.leadOut)};
    for (const TocTrack &track : toc.tracks)
        parts.append(QString::number(track.offset) + (track.isData ? u"d"_s : QString()));
    return parts.join(u' ');
}

QString questionOf(const SearchWords &words)
{
    QStringList parts{u"search"_s, words.artist, words.title, words.barcode};
    if (!words.track.isEmpty())
        parts.append(words.track);
    return parts.join(u'\t');
}

QString questionOf(const DiscRecord &candidate)
{
    return QStringList{u"record"_s, candidate.keyA, candidate.keyB}.join(u'\t');
}

QString keptAs(const QString &service, const QString &question)
{
    return service + u'\t' + question;
}

// What a CDDB server finds close may be another disc.
bool isDoubtful(const std::vector<DiscRecord> &candidates, const TableOfContents &toc)
{
    return candidates.size() == 1 && candidates.front().service == sender &&
           candidates.front().tracks.size() != toc.tracks.size();
}

// Of two failures the one that tells the user more of what to do.
int weight(const Error &error)
{
    switch (error.Number) {
    case errServiceRefused:
        return 3;
    case errHostNotFound:
        return 2;
    case errNotSignedUp:
        return 0;
    default:
        return 1;
    }
}

} // namespace

struct Lookup::Round {
    std::vector<std::pair<QString, Error>> failures; // by service
    QStringList withoutMatch;                        // services that know nothing
    bool told = false;                               // a refusal
};

Lookup::Lookup(const ServiceOptions &options, const KeptAnswers &kept,
               std::shared_ptr<Refusals> refusals)
    : mOptions(options),
      mKept(kept),
      mRefusals(refusals ? std::move(refusals) : std::make_shared<Refusals>())
{
    for (const QString &name : options.order) {
        if (auto service = makeService(name, options))
            mServices.push_back(std::move(service));
    }
}

Lookup::~Lookup() = default;

DiscService &Lookup::serviceNamed(const QString &name)
{
    for (const auto *services : {&mServices, &mOthers}) {
        for (const auto &service : *services) {
            if (service->name() == name)
                return *service;
        }
    }
    auto made = makeService(name, mOptions);
    if (!made)
        throw Error(errServiceFailed, name, errorText("xServiceStrange", {}));
    return *mOthers.emplace_back(std::move(made));
}

// With other settings a service may answer.
QString Lookup::identityOf(const DiscService &service) const
{
    const bool takes = service.name() == sender;
    return QStringList{service.name(),
                       takes ? mOptions.cddbAddress : mOptions.musicBrainzAddress,
                       takes ? mOptions.mail : QString(),
                       mOptions.proxyHost,
                       QString::number(mOptions.proxyPort),
                       mOptions.proxyUser,
                       mOptions.proxyPassword}
        .join(u'\t');
}

void Lookup::requireNotRefused(const DiscService &service) const
{
    const auto words = mRefusals->constFind(identityOf(service));
    if (words != mRefusals->constEnd())
        throw Error(errServiceRefused, service.name(), *words);
}

void Lookup::requireReached(const DiscService &service) const
{
    const auto failure = mNotReached.constFind(service.name());
    if (failure != mNotReached.constEnd())
        throw Error(*failure);
}

void Lookup::tell(const QString &words, Round &round) const
{
    round.told = true;
    if (tellRefusal)
        tellRefusal(words);
}

// What is between all services and this program, as a proxy, is told for the first of them alone.
void Lookup::noteRefusal(const DiscService &service, const Error &error, Round &round)
{
    const QString identity = identityOf(service);
    if (mRefusals->contains(identity))
        return;
    const bool isNew = !mRefusals->values().contains(error.Description);
    mRefusals->insert(identity, error.Description);
    if (isNew)
        tell(error.Description, round);
}

std::vector<DiscRecord> Lookup::askOne(DiscService &service, const Ask &ask, Round &round)
{
    try {
        requireNotRefused(service);
        requireReached(service);
        auto records = ask(service);
        if (records.empty())
            round.withoutMatch.append(service.name());
        return records;
    } catch (const Error &error) {
        if (error.Number == errLookupCancelled)
            throw;
        if (error.Number == errServiceRefused)
            noteRefusal(service, error, round);
        if (error.Number == errHostNotFound)
            mNotReached.insert(service.name(), error);
        round.failures.emplace_back(service.name(), error);
        return {};
    }
}

Lookup::Found Lookup::askAll(const QString &question, const Ask &ask, bool senderDecides)
{
    Round round;
    for (const auto &service : mServices) {
        const auto records = askOne(*service, ask, round);
        if (records.empty())
            continue;
        mKept.keep(keptAs(service->name(), question), records);
        return {withoutRepeats(records), service->name(), {}};
    }
    if (auto kept = keptOf(round, question))
        return *kept;
    try {
        throwUnlessKnown(round, senderDecides);
    } catch (const Error &error) {
        if (error.Number == errServiceRefused && !round.told)
            tell(error.Description, round);
        throw;
    }
    return {};
}

// Of those alone that have not answered today.
std::optional<Lookup::Found> Lookup::keptOf(const Round &round, const QString &question) const
{
    for (const auto &[service, error] : round.failures) {
        if (const auto kept = mKept.find(keptAs(service, question)))
            return Found{withoutRepeats(kept->records), service, kept->date};
    }
    return {};
}

// Returns where it may be said that nothing is known.
void Lookup::throwUnlessKnown(const Round &round, bool senderDecides) const
{
    if (mServices.empty())
        throw Error(errHostNotFound, {}, errorText("xServiceNotReached", {}));
    if (senderDecides && round.withoutMatch.contains(sender))
        return;
    const Error *heaviest = nullptr;
    for (const auto &[service, error] : round.failures) {
        const bool counts = error.Number != errNotSignedUp || round.withoutMatch.isEmpty();
        if (counts && (!heaviest || weight(error) > weight(*heaviest)))
            heaviest = &error;
    }
    if (heaviest)
        throw *heaviest;
}

// Repeats that were taken out may leave one alone.
Lookup::Found Lookup::finished(Found found, LongWork &work)
{
    if (found.candidates.size() != 1 || found.candidates.front().isWhole())
        return found;
    Whole whole = complete(found.candidates.front(), work);
    found.candidates.front() = std::move(whole.disc);
    if (!found.keptOn)
        found.keptOn = whole.keptOn;
    return found;
}

Lookup::Found Lookup::find(const TableOfContents &toc, LongWork &work)
{
    const auto ask = [&](DiscService &service) { return service.find(toc, work); };
    Found found = finished(askAll(questionOf(toc), ask, true), work);
    found.isDoubtful = isDoubtful(found.candidates, toc);
    return found;
}

Lookup::Found Lookup::find(const SearchWords &words, LongWork &work)
{
    const auto ask = [&](DiscService &service) { return service.search(words, work); };
    return finished(askAll(questionOf(words), ask, false), work);
}

Lookup::Found Lookup::ofRecording(const QString &id, LongWork &work)
{
    const auto ask = [&](DiscService &service) { return service.recording(id, work); };
    return finished(askAll(u"recording\t"_s + id, ask, false), work);
}

Lookup::Whole Lookup::complete(const DiscRecord &candidate, LongWork &work)
{
    return read(candidate, &DiscService::complete, work);
}

Lookup::Whole Lookup::again(const DiscRecord &candidate, LongWork &work)
{
    return read(candidate, &DiscService::again, work);
}

Lookup::Whole Lookup::read(const DiscRecord &candidate, Read read, LongWork &work)
{
    if (candidate.isWhole())
        return {candidate, {}};
    DiscService &service = serviceNamed(candidate.service);
    const QString question = keptAs(service.name(), questionOf(candidate));
    try {
        requireNotRefused(service);
        DiscRecord disc = (service.*read)(candidate, work);
        disc.soughtTrack = candidate.soughtTrack;
        mKept.keep(question, {disc});
        return {disc, {}};
    } catch (const Error &error) {
        if (error.Number == errLookupCancelled || error.Number == errNothingFound)
            throw;
        if (auto kept = mKept.find(question))
            return {std::move(kept->records.front()), kept->date};
        Round round;
        if (error.Number == errServiceRefused)
            noteRefusal(service, error, round);
        if (error.Number == errServiceRefused && !round.told)
            tell(error.Description, round);
        throw;
    }
}

void Lookup::send(const DiscRecord &disc, const TableOfContents &toc, LongWork &work)
{
    DiscService &service = serviceNamed(sender);
    requireNotRefused(service);
    try {
        service.send(disc, toc, work);
    } catch (const Error &error) {
        if (error.Number == errServiceRefused)
            mRefusals->insert(identityOf(service), error.Description); // told by the caller
        throw;
    }
}
