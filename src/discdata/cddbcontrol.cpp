#include "discdata/cddbcontrol.h"

#include "discdata/Candidates.h"
#include "discdata/Credits.h"
#include "discdata/DiscEditor.h"
#include "discdata/SignUp.h"
#include "discdata/cddbtagmanager.h"
#include "discdata/filelookupid.h"
#include "discdata/lookup.h"
#include "discdata/mmcontrol.h"
#include "discs/discid.h"
#include "discs/opaquetoc.h"
#include "platform/ado/value.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/clsRegistry.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QFileInfo>
#include <QLocale>

using namespace Qt::StringLiterals;

namespace
{

// What services have refused: told once, and they are not asked again.
std::shared_ptr<Refusals> refusalsOfRun()
{
    static const auto refusals = std::make_shared<Refusals>();
    return refusals;
}

// Beside the catalogue, as all that the program keeps of its own.
KeptAnswers keptAnswers()
{
    const QString catalogue = gDatabasePath;
    return KeptAnswers(catalogue.isEmpty() ? QString()
                                           : QFileInfo(catalogue).path() + u"/Answers"_s);
}

// For trials: a server looks at a disc that is sent and does not store it.
bool sendsInTest()
{
    clsRegistry settings;
    settings.ysnFailSoftRead = true;
    return settings.GetValue(settingsReadKey, u"CDDBSubmitMode"_s).toString() == "test"_L1;
}

ServiceOptions serviceOptions(const CddbUserProfile &profile, const CddbOptions &options)
{
    ServiceOptions all;
    all.order = profile.services;
    if (!profile.cddbAddress.isEmpty())
        all.cddbAddress = profile.cddbAddress;
    if (!profile.musicBrainzAddress.isEmpty())
        all.musicBrainzAddress = profile.musicBrainzAddress;
    all.mail = profile.mail;
    all.test = sendsInTest();
    all.proxyHost = options.ProxyServer;
    all.proxyPort = options.ProxyServerPortNumber;
    all.proxyUser = options.ProxyUserName;
    all.proxyPassword = options.ProxyPassword;
    return all;
}

void tellKept(const QDate &day)
{
    const QLocale locale(gLanguage == languageDutch ? QLocale::Dutch : QLocale::English);
    informationBox(GetMessage("xKeptPart1") + locale.toString(day, QLocale::LongFormat) +
                   GetMessage("xKeptPart2"));
}

// There is no disc at hand that could be entered as a new one.
[[noreturn]] void tellNothingFound()
{
    const QString text = GetMessage("xNothingFound");
    informationBox(text);
    throw Error(errNothingFound, u"CDDBControl"_s, text);
}

TableOfContents tableOf(const QString &toc)
{
    const auto opaque = OpaqueToc::fromText(toc);
    return opaque ? opaque->toc : TableOfContents();
}

// An empty record with as many tracks as the disc, and what a sheet beside it says.
DiscRecord newRecord(const OpaqueToc &toc)
{
    DiscRecord record = toc.known;
    record.tracks.resize(toc.toc.tracks.size());
    for (size_t i = 0; i < record.tracks.size(); ++i) {
        if (toc.toc.tracks[i].isData && record.tracks[i].title.isEmpty())
            record.tracks[i].title = GetMessage("xDataTrack");
    }
    return record;
}

// The server has it now: what is sent next is its next revision.
void markSent(CddbDisc &disc, const TableOfContents &toc)
{
    disc.isNew = false;
    disc.record.revision = std::max(disc.record.revision, -1) + 1;
    disc.record.service = u"cddb"_s;
    disc.record.discIds = {cddbId(toc)};
}

} // namespace

CDDBControl::CDDBControl() : mGenres(std::make_shared<GenreTable>()) {}

CDDBControl::~CDDBControl() = default;

int CDDBControl::IsUserRegistered(int prompt)
{
    if (!GetUserProfile().registered && prompt != 0)
        ShowRegistrationDialog(GetUserProfile(), 0);
    return GetUserProfile().registered ? 1 : 0;
}

void CDDBControl::SetClientIdentity(const QString &, const QString &, const QString &,
                                    const QString &)
{
}

CddbUserProfile CDDBControl::GetUserProfile() const
{
    return CddbUserProfile::stored();
}

void CDDBControl::SetOptions(const CddbOptions &options)
{
    mOptions = options;
}

void CDDBControl::SetParentWindow(QWidget *window, int)
{
    mParent = window;
}

void CDDBControl::ShutDown()
{
    mParent.clear();
    mMatch = {};
    mFileMatches.reset();
}

QString CDDBControl::GetTocFromDevice(int deviceId) const
{
    const OpaqueToc toc = tocOfDevice(deviceId);
    return toc.toc.isValid() || !toc.words.isEmpty() ? toc.toText() : QString();
}

// Behind ShutDown nothing is asked any more.
Form &CDDBControl::screen() const
{
    auto *form = qobject_cast<Form *>(mParent.data());
    if (!form || form->isUnloaded())
        throw Error(errLookupCancelled, u"CDDBControl"_s, errorText("xLookupCancelled", {}));
    return *form;
}

void CDDBControl::requireRegistered() const
{
    if (!GetUserProfile().registered)
        throw Error(errNotSignedUp, u"CDDBControl"_s, errorText("xNotSignedUp", {}));
}

// What the services are asked with is looked up each time: the user may have changed it meanwhile.
std::unique_ptr<Lookup> CDDBControl::lookup() const
{
    requireRegistered();
    auto services = std::make_unique<Lookup>(serviceOptions(GetUserProfile(), mOptions),
                                             keptAnswers(), refusalsOfRun());
    services->tellRefusal = [](const QString &words) {
        informationBox(GetMessage("xRefusal") + words);
    };
    return services;
}

CddbDiscPtr CDDBControl::discOf(const DiscRecord &record, const QString &toc) const
{
    auto disc = std::make_shared<CddbDisc>(record, mGenres);
    disc->toc = toc;
    return disc;
}

int CDDBControl::LookupDisc(const QString &toc, int)
{
    mMatch = {};
    const auto opaque = OpaqueToc::fromText(toc);
    if (!opaque)
        throw Error(errServiceFailed, u"CDDBControl"_s, GetMessage("MsgInvalidTOC"));
    const auto services = lookup();
    Lookup::Found found;
    {
        LongWork work(screen(), GetMessage("xLookingUp"));
        found = opaque->words.isEmpty() ? services->find(opaque->toc, work)
                                        : services->find(opaque->words, work);
    }
    if (found.keptOn)
        tellKept(*found.keptOn);
    if (found.candidates.empty() && !opaque->words.isEmpty())
        tellNothingFound();
    if (found.candidates.empty())
        return cddbNoMatch;
    if (found.candidates.size() == 1 && !found.isDoubtful) {
        mMatch = discOf(found.candidates.front(), toc);
        return cddbExact;
    }
    const auto list = std::make_shared<CddbMatchList>();
    *list = {std::move(found.candidates), toc};
    mMatch = list;
    return cddbSeveral;
}

CddbDiscPtr CDDBControl::ShowFuzzyDialog(const CddbMatchListPtr &list)
{
    auto *dialog = new Candidates(list->candidates);
    dialog->ShowModal();
    const auto chosen = dialog->chosen();
    return chosen ? discOf(list->candidates[*chosen], list->toc) : nullptr;
}

CddbDiscPtr CDDBControl::GetFullDisc(const CddbDiscPtr &candidate, int)
{
    const auto services = lookup();
    Lookup::Whole whole;
    {
        LongWork work(screen(), GetMessage("xLookingUp"));
        whole = services->complete(candidate->record, work);
    }
    if (whole.keptOn)
        tellKept(*whole.keptOn);
    return discOf(whole.disc, candidate->toc);
}

int CDDBControl::ShowEditDialog(const CddbDiscPtr &disc, int)
{
    const auto newToc = disc->isNew ? std::optional(tableOf(disc->toc)) : std::nullopt;
    auto *dialog = new DiscEditor(disc->record, newToc, mGenres->usualNames());
    dialog->ShowModal();
    if (!dialog->isAccepted())
        return 0;
    disc->record = dialog->disc();
    return (dialog->isToBeSent() ? cddbToSend : 0) | (dialog->isChanged() ? cddbEdited : 0);
}

CddbDiscPtr CDDBControl::CreateDisc(const QString &toc, const QString &, const QString &)
{
    const auto opaque = OpaqueToc::fromText(toc);
    CddbDiscPtr disc = discOf(newRecord(opaque.value_or(OpaqueToc())), toc);
    disc->isNew = true;
    return disc;
}

int CDDBControl::SubmitDisc(const CddbDiscPtr &disc, int)
{
    const auto services = lookup();
    LongWork work(screen(), GetMessage("xSending"));
    const TableOfContents toc = tableOf(disc->toc);
    services->send(disc->record, toc, work);
    markSent(*disc, toc);
    return 0;
}

CddbGenreListPtr CDDBControl::GetGenreList(int) const
{
    return std::make_shared<CddbGenreList>(mGenres);
}

// What is found counts, whoever has answered; a track that is not told stays what it was.
CddbDiscPtr CDDBControl::lookUpFile(const AskFile &ask, int &track)
{
    mFileMatches.reset();
    const auto services = lookup();
    FileLookup::Found found;
    {
        LongWork work(screen(), GetMessage("xLookingUp"));
        FileLookup lookup(*services, work);
        found = ask(lookup);
    }
    if (found.keptOn)
        tellKept(*found.keptOn);
    if (!found.candidates.empty())
        mFileMatches =
            std::make_shared<CddbMatchList>(CddbMatchList{std::move(found.candidates), {}});
    if (!found.disc)
        return nullptr;
    track = found.track;
    return discOf(*found.disc, {});
}

CddbDiscPtr CDDBControl::LookupByFileId(const QString &fileId, int, int &track)
{
    mFileMatches.reset();
    const auto id = trackOfFileId(fileId);
    if (!id)
        return nullptr;
    return lookUpFile([&](FileLookup &lookup) { return lookup.byId(*id); }, track);
}

std::unique_ptr<CddbTagManager> CDDBControl::GetTagManager()
{
    return std::make_unique<CddbTagManager>(*this);
}

void CDDBControl::ShowAboutBox()
{
    (new Credits)->ShowModal();
}

int CDDBControl::ShowRegistrationDialog(const CddbUserProfile &profile, int)
{
    auto *dialog = new SignUp(profile);
    dialog->ShowModal();
    if (!dialog->isAccepted())
        return 0;
    dialog->profile().store();
    return 1;
}

void setUpCddb(CDDBControl &control, QWidget *owner, bool withLanguage)
{
    control.SetClientIdentity(u"4172903"_s, u"7C2E91A04BD36F58A1E07D34C96B1F2D"_s, u"1"_s, {});
    control.SetParentWindow(owner, 0);
    Desktop::current().pump();
    CddbOptions options = control.GetOptions();
    options.ProxyPassword = gProxyPassword;
    options.ProxyServerPortNumber =
        gProxyServerPort.isEmpty() ? 0 : int(ADODB::Value(gProxyServerPort).toLong());
    options.ProxyUserName = gProxyUserName;
    options.ProxyServer = gProxyServer;
    options.ExtraOption = 0;
    if (withLanguage)
        options.ClientLanguage = QString::number(gLanguage);
    control.SetOptions(options);
}

void showCddbError(const Error &error)
{
    errorBox(error.Number == errHostNotFound ? GetMessage("MsgHostNotFound") : error.Description);
}
