#pragma once

#include "discdata/discservice.h"
#include "discdata/httpclient.h"
#include "discs/cddbanswer.h"

/// A server that speaks the open CDDB protocol, by HTTP. It wants the user's own mail address with
/// each request: without one every call throws errNotSignedUp.
///
/// An address without a scheme is asked by https; by http only where nobody listens for https at
/// all, and never once https has answered.
class CddbServer : public DiscService
{
public:
    explicit CddbServer(const ServiceOptions &options);

    QString name() const override;
    std::vector<DiscRecord> find(const TableOfContents &toc, LongWork &work) override;
    std::vector<DiscRecord> search(const SearchWords &words, LongWork &work) override; // cannot
    DiscRecord complete(const DiscRecord &candidate, LongWork &work) override;
    DiscRecord again(const DiscRecord &candidate, LongWork &work) override;

    /// `category` says where it is stored. A record that the server has already, for this very
    /// disc, goes as its next revision, any other as a new one.
    void send(const DiscRecord &disc, const TableOfContents &toc, LongWork &work) override;

private:
    using Ask = std::function<HttpAnswer(const QUrl &address)>;
    HttpAnswer ask(const Ask &ask);
    CddbAnswer command(const QString &words, LongWork &work);
    CddbAnswer query(const QString &arguments, LongWork &work);
    DiscRecord read(const DiscRecord &candidate, LongWork &work);
    void requireNoRefusal(const HttpAnswer &answer) const;
    QUrl submitAddress(const QUrl &commands) const;

    ServiceOptions mOptions;
    HttpClient mClient;
    QUrl mAddress; // of commands
    bool mMayFallBack;
    QString mQuery;           // the last one's arguments
    bool mHasQueried = false; // since the last read
};
