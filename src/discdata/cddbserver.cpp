#include "discdata/cddbserver.h"

#include "discdata/serviceerrors.h"
#include "discs/candidates.h"
#include "discs/discid.h"
#include "discs/xmcd.h"

#include <QRegularExpression>

using namespace Qt::StringLiterals;

namespace
{

constexpr auto clientName = "Songcase"_L1, clientVersion = SONGCASE_VERSION ""_L1;
constexpr auto protocolLevel = "6"_L1; // UTF-8, year and genre

bool hasScheme(const QString &address)
{
    return address.contains("://"_L1);
}

QUrl addressOf(const QString &typed)
{
    const QString address = typed.trimmed();
    QUrl url(hasScheme(address) ? address : u"https://"_s + address);
    if (url.path().size() <= 1)
        url.setPath(u"/~cddb/cddb.cgi"_s);
    return url;
}

// One word of a request: what is no letter, digit or plain sign is escaped.
QByteArray encoded(QStringView word)
{
    return QUrl::toPercentEncoding(word.toString());
}

QByteArray encodedWords(const QString &words)
{
    QByteArrayList parts;
    for (const QStringView word : QStringView(words).split(u' ', Qt::SkipEmptyParts))
        parts.append(encoded(word));
    return parts.join('+');
}

bool isMailAddress(const QString &mail)
{
    static const QRegularExpression form(u"^[^\\s@\\x{0}-\\x{1f}]+@[^\\s@\\x{0}-\\x{1f}]+$"_s);
    return form.match(mail).hasMatch();
}

QByteArray hello(const QString &mail)
{
    return encoded(mail.section(u'@', 0, 0)) + '+' + encoded(mail.section(u'@', 1)) + '+' +
           encodedWords(clientName) + '+' + encodedWords(clientVersion);
}

// What stands for a refusal says so in its titles.
QString refusalIn(const DiscRecord &disc)
{
    const QString first = disc.tracks.empty() ? QString() : disc.tracks.front().title;
    return first.isEmpty() ? disc.title : first;
}

// The next revision of a record that is there for this disc; else the first of a new one.
DiscRecord asSent(const DiscRecord &disc, const TableOfContents &toc, const QString &service)
{
    DiscRecord sent = disc;
    const QString id = cddbId(toc);
    const bool known = disc.service == service && disc.discIds.contains(id, Qt::CaseInsensitive);
    sent.revision = known ? disc.revision + 1 : 0;
    if (!known)
        sent.discIds = QStringList{id};
    return sent;
}

} // namespace

CddbServer::CddbServer(const ServiceOptions &options)
    : mOptions(options),
      mClient(options, 0), // who asks a busy server again may be shut out for hours
      mAddress(addressOf(options.cddbAddress)),
      mMayFallBack(!hasScheme(options.cddbAddress))
{
    mOptions.mail = options.mail.trimmed();
}

QString CddbServer::name() const
{
    return u"cddb"_s;
}

HttpAnswer CddbServer::ask(const Ask &ask)
{
    if (!isMailAddress(mOptions.mail))
        throw Error(errNotSignedUp, name(), errorText("xServiceNoMail", {}));
    HttpAnswer answer = ask(mAddress);
    if (mMayFallBack && answer.end == HttpAnswer::End::NotConnected) {
        QUrl plain = mAddress;
        plain.setScheme(u"http"_s);
        answer = ask(plain);
        if (answer.end == HttpAnswer::End::Answered)
            mAddress = plain;
    }
    mMayFallBack = mMayFallBack && answer.end != HttpAnswer::End::Answered;
    requireAnswer(answer, name());
    requireNoRefusal(answer);
    return answer;
}

void CddbServer::requireNoRefusal(const HttpAnswer &answer) const
{
    if (answer.status != 403 && answer.status != 429 && answer.status != 503)
        return;
    const QByteArray said = answer.isHtml() ? QByteArray() : answer.body;
    throw Error(errServiceRefused, name(), serversWords(said, statusWords(answer)));
}

CddbAnswer CddbServer::command(const QString &words, LongWork &work)
{
    const QByteArray question = "cmd=" + encodedWords(words) + "&hello=" + hello(mOptions.mail) +
                                "&proto=" + protocolLevel.latin1();
    const HttpAnswer got = ask([&](QUrl url) {
        url.setQuery(QString::fromLatin1(question), QUrl::StrictMode);
        return mClient.get(url, work);
    });
    if (got.status >= 400 && (got.isHtml() || got.body.isEmpty()))
        throw Error(errServiceFailed, name(), statusWords(got));
    CddbAnswer answer = understood(name(), [&] { return readCddbAnswer(got.body); });
    if (answer.isRefusal())
        throw Error(errServiceRefused, name(), answer.text);
    if (answer.isMissing())
        throw Error(errNothingFound, name(), answer.text);
    if (answer.code / 100 != 2)
        throw Error(errServiceFailed, name(), answer.text);
    if (!answer.isWhole)
        throw serviceFailed(name(), "xServiceCutOff");
    return answer;
}

CddbAnswer CddbServer::query(const QString &arguments, LongWork &work)
{
    CddbAnswer answer = command(u"cddb query "_s + arguments, work);
    mQuery = arguments;
    mHasQueried = true;
    return answer;
}

std::vector<DiscRecord> CddbServer::find(const TableOfContents &toc, LongWork &work)
{
    const CddbAnswer answer = query(cddbQuery(toc), work);
    auto candidates = understood(name(), [&] { return cddbCandidates(answer); });
    for (DiscRecord &candidate : candidates)
        candidate.service = name();
    if (candidates.size() == 1)
        candidates.front() = read(candidates.front(), work);
    return candidates;
}

std::vector<DiscRecord> CddbServer::search(const SearchWords & /*words*/, LongWork & /*work*/)
{
    return {};
}

// A server wants to see a query before each record that is read.
DiscRecord CddbServer::complete(const DiscRecord &candidate, LongWork &work)
{
    if (candidate.isWhole())
        return candidate;
    if (!mHasQueried && !mQuery.isEmpty())
        query(mQuery, work);
    return read(candidate, work);
}

// The query before it can only be made of what the id says.
DiscRecord CddbServer::again(const DiscRecord &candidate, LongWork &work)
{
    query(cddbQueryOfId(candidate.keyB), work);
    return read(candidate, work);
}

DiscRecord CddbServer::read(const DiscRecord &candidate, LongWork &work)
{
    mHasQueried = false;
    const CddbAnswer answer =
        command(u"cddb read "_s + candidate.keyA + u' ' + candidate.keyB, work);
    DiscRecord disc = understood(name(), [&] { return readXmcd(answer.body); }).disc;
    if (isRefusal(disc))
        throw Error(errServiceRefused, name(), refusalIn(disc));
    disc.service = name();
    disc.category = candidate.keyA;
    disc.fromA = candidate.keyA;
    disc.fromB = candidate.keyB;
    disc.keyA.clear();
    disc.keyB.clear();
    return disc;
}

QUrl CddbServer::submitAddress(const QUrl &commands) const
{
    QUrl url = commands;
    url.setPath(commands.path().section(u'/', 0, -2) + u"/submit.cgi"_s);
    return url;
}

void CddbServer::send(const DiscRecord &disc, const TableOfContents &toc, LongWork &work)
{
    const char *reason =
        cddbCategories().contains(disc.category) ? notToBeSent(disc, toc) : "xServiceNoCategory";
    if (reason)
        throw Error(errNotAccepted, name(), errorText(reason, {}));
    const QByteArray body = writeXmcd(asSent(disc, toc, name()), toc, clientName, clientVersion);
    const HttpClient::Headers headers = {{"Category", disc.category.toLatin1()},
                                         {"Discid", cddbId(toc).toLatin1()},
                                         {"User-Email", mOptions.mail.toUtf8()},
                                         {"Submit-Mode", mOptions.test ? "test" : "submit"},
                                         {"Charset", "UTF-8"},
                                         {"Content-Type", "text/plain; charset=UTF-8"}};
    const HttpAnswer got =
        ask([&](const QUrl &url) { return mClient.post(submitAddress(url), headers, body, work); });
    if (got.isHtml() || (got.status >= 400 && got.body.isEmpty()))
        throw Error(errServiceFailed, name(), statusWords(got));
    const CddbAnswer answer = understood(name(), [&] { return readCddbAnswer(got.body); });
    if (answer.code != 200)
        throw Error(errNotAccepted, name(), answer.text);
}
