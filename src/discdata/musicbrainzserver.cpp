#include "discdata/musicbrainzserver.h"

#include "discdata/serviceerrors.h"
#include "discs/discid.h"
#include "discs/musicbrainzanswer.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr int retries = 3;
constexpr int pageSize = 25; // releases; a look-up by id does not tell that there are more
constexpr int mostPages = 4;
constexpr char included[] = "inc=artist-credits+recordings+release-groups+genres+labels";

QUrl addressOf(const QString &typed)
{
    const QString address = typed.trimmed();
    QUrl url(address.contains("://"_L1) ? address : u"https://"_s + address);
    QString path = url.path();
    while (path.endsWith(u'/'))
        path.chop(1);
    url.setPath(path + u"/ws/2/"_s);
    return url;
}

// First track 1, as many offsets as tracks, rising, the lead-out behind the last.
bool isTakenThere(const QString &table)
{
    const QStringList numbers = table.split(u' ');
    if (numbers.size() < 4 || numbers[0] != "1"_L1 || numbers[1].toInt() != numbers.size() - 3)
        return false;
    for (qsizetype i = 4; i < numbers.size(); ++i) {
        if (numbers[i].toInt() <= numbers[i - 1].toInt())
            return false;
    }
    return numbers[2].toInt() > numbers.last().toInt();
}

} // namespace

MusicBrainzServer::MusicBrainzServer(const ServiceOptions &options)
    : mClient(options, retries), mAddress(addressOf(options.musicBrainzAddress))
{
}

QString MusicBrainzServer::name() const
{
    return u"musicbrainz"_s;
}

QByteArray MusicBrainzServer::ask(const QString &resource, const QByteArray &question,
                                  LongWork &work)
{
    QUrl url = mAddress;
    url.setPath(mAddress.path() + resource, QUrl::DecodedMode);
    url.setQuery(QString::fromLatin1(question + "&fmt=json"), QUrl::StrictMode);
    const HttpAnswer answer = mClient.get(url, work);
    requireAnswer(answer, name());
    if (answer.status == 404 && !answer.isHtml())
        return {};
    if (answer.isTooBusy())
        throw serviceFailed(name(), "xServiceBusy", statusWords(answer));
    if (answer.status == 200 && answer.body.isEmpty())
        throw serviceFailed(name(), "xServiceStrange"); // not the same as "not known"
    if (answer.status == 200)
        return answer.body;
    const QString said = answer.isHtml() ? QString() : musicBrainzError(answer.body);
    const bool refused = answer.status == 401 || answer.status == 403;
    throw Error(refused ? errServiceRefused : errServiceFailed, name(),
                serversWords(said.toUtf8(), statusWords(answer)));
}

std::vector<DiscRecord> MusicBrainzServer::ofService(std::vector<DiscRecord> records) const
{
    for (DiscRecord &record : records)
        record.service = name();
    return records;
}

std::vector<DiscRecord> MusicBrainzServer::find(const TableOfContents &toc, LongWork &work)
{
    if (!toc.isValid() || !isTakenThere(musicBrainzToc(toc)))
        return {};
    const QByteArrayList found = pages(toc, work);
    if (found.isEmpty())
        return {};
    return ofService(understood(name(), [&] { return musicBrainzDiscs(found, toc); }));
}

// A server that does not go on behind `from` gives its first page again.
QByteArrayList MusicBrainzServer::pages(const TableOfContents &toc, LongWork &work)
{
    QByteArrayList all;
    QString first;
    int from = 0;
    for (bool goesOn = true; goesOn && all.size() < mostPages;) {
        QByteArray json;
        try {
            json = page(toc, from, work);
        } catch (const Error &error) {
            if (all.isEmpty() || error.Number == errLookupCancelled)
                throw;
            break; // what is there already counts
        }
        const MusicBrainzPage page = musicBrainzPage(json);
        const bool isNew = all.isEmpty() || (page.listed > 0 && page.first != first);
        if (json.isEmpty() || !isNew)
            break;
        all.append(json);
        first = all.size() == 1 ? page.first : first;
        from += page.listed;
        goesOn = page.listed > 0 && (page.all < 0 ? page.listed >= pageSize : from < page.all);
    }
    return all;
}

QByteArray MusicBrainzServer::page(const TableOfContents &toc, int from, LongWork &work)
{
    QByteArray question =
        "toc=" + musicBrainzToc(toc).replace(u' ', u'+').toLatin1() + "&cdstubs=no&" + included;
    if (from > 0)
        question += "&offset=" + QByteArray::number(from);
    return ask(u"discid/"_s + musicBrainzId(toc), question, work);
}

std::vector<DiscRecord> MusicBrainzServer::search(const SearchWords &words, LongWork &work)
{
    const QString query = musicBrainzQuery(words).trimmed();
    if (words.isEmpty() || query.isEmpty())
        return {};
    const QByteArray question = "query=" + QUrl::toPercentEncoding(query) + "&limit=25";
    const bool ofTrack = !words.track.isEmpty();
    const QByteArray json = ask(ofTrack ? u"recording"_s : u"release"_s, question, work);
    if (json.isEmpty())
        return {};
    const auto read = ofTrack ? musicBrainzRecordings : musicBrainzSearch;
    return ofService(understood(name(), [&] { return read(json); }));
}

std::vector<DiscRecord> MusicBrainzServer::recording(const QString &id, LongWork &work)
{
    const QByteArray json = ask(u"recording/"_s + id, "inc=artist-credits+releases+media", work);
    if (json.isEmpty())
        return {};
    return ofService(understood(name(), [&] { return musicBrainzRecordings(json); }));
}

DiscRecord MusicBrainzServer::complete(const DiscRecord &candidate, LongWork &work)
{
    if (candidate.isWhole())
        return candidate;
    const QByteArray json = ask(u"release/"_s + candidate.keyA, included, work);
    if (json.isEmpty())
        throw Error(errNothingFound, name(), errorText("xServiceNoRecord", {}));
    const int medium = candidate.keyB.toInt();
    DiscRecord disc = understood(name(), [&] { return musicBrainzRelease(json, medium); });
    disc.service = name();
    disc.keyA.clear();
    disc.keyB.clear();
    return disc;
}
