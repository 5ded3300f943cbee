// Label: unit
#include "discdata/musicbrainzserver.h"
#include "platform/work/longwork.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/standinserver.h"

namespace
{

// Releases of which one in ten fits a disc of one track of four seconds.
QByteArray page(int from, int count, const QByteArray &rest)
{
    QByteArrayList releases;
    for (int i = from; i < from + count; ++i)
        releases << "{\"id\":\"" + QByteArray::number(i) + "\",\"title\":\"" +
                        QByteArray::number(i) + "\",\"media\":[{\"tracks\":[{\"length\":" +
                        (i % 10 ? "90000" : QByteArray::number(4900 - i)) + "}]}]}";
    return "{\"releases\":[" + releases.join(',') + ']' + rest + '}';
}

} // namespace

/// The web service of MusicBrainz, on real sockets.
class tst_MusicBrainzServer : public QObject
{
    Q_OBJECT

private slots:
    void pages_data()
    {
        const QByteArray all = ",\"release-count\":45";
        const DataRows<QByteArrayList, QString, int> row("pages", "offsets", "discs");
        row("one", {page(0, 25, ",\"release-count\":25")}, "", 3);
        row("cut short, and all told", {page(0, 20, all), page(20, 20, all), page(40, 5, all)},
            "20 40", 5);
        row("how many is not told", {page(1, 25, ""), page(26, 3, "")}, "25", 2);
        row("always the first", {page(0, 25, "")}, "25", 3);
        row("fewer than told", {page(0, 20, all), page(0, 0, all)}, "20", 2);
        row("too many", {page(0, 25, ""), page(25, 25, ""), page(50, 25, ""), page(75, 25, "")},
            "25 50 75", 10);
        row("none", {page(0, 0, ",\"release-count\":0")}, "", 0);
    }

    void pages()
    {
        QFETCH(QByteArrayList, pages);
        const ScriptedDesktop desktop;
        Form screen(u"frmAsking"_s);
        StandInServer server;
        for (const QByteArray &page : pages)
            server.answer("/ws/2/discid/", page);
        ServiceOptions options;
        options.musicBrainzAddress = server.address();
        options.interval = 0;
        options.paceFolder = desktop.folder;
        LongWork work(screen);
        const auto discs = MusicBrainzServer(options).find({{{150}}, 1, 450}, work);
        QStringList offsets;
        for (const QByteArray &words : server.words().mid(1))
            offsets << QString::fromLatin1(words).section(u"offset="_s, 1).section(u'&', 0, 0);
        QTEST(offsets.join(u' '), "offsets");
        QTEST(int(discs.size()), "discs");
        const bool nearestFirst = std::ranges::is_sorted(discs, {}, [](const DiscRecord &disc) {
            return std::abs(disc.tracks.at(0).length - 4000);
        });
        QVERIFY(nearestFirst);
    }
};

QTEST_MAIN(tst_MusicBrainzServer)
#include "tst_MusicBrainzServer.moc"
