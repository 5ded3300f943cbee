#pragma once

#include "discdata/discservice.h"
#include "discdata/httpclient.h"

/// The web service of MusicBrainz, in JSON. It takes no discs from here. A server that is too busy
/// is asked again a few times.
class MusicBrainzServer : public DiscService
{
public:
    explicit MusicBrainzServer(const ServiceOptions &options);

    QString name() const override;

    /// By the id of the disc; where that is not known, by the lengths of its tracks. Nothing is
    /// asked for a table that the service takes for invalid.
    std::vector<DiscRecord> find(const TableOfContents &toc, LongWork &work) override;
    std::vector<DiscRecord> search(const SearchWords &words, LongWork &work) override;
    std::vector<DiscRecord> recording(const QString &id, LongWork &work) override;
    DiscRecord complete(const DiscRecord &candidate, LongWork &work) override;

private:
    /// Empty: not known there.
    QByteArray ask(const QString &resource, const QByteArray &question, LongWork &work);
    QByteArrayList pages(const TableOfContents &toc, LongWork &work);
    QByteArray page(const TableOfContents &toc, int from, LongWork &work);
    std::vector<DiscRecord> ofService(std::vector<DiscRecord> records) const;

    HttpClient mClient;
    QUrl mAddress;
};
