#include "discdata/discimport.h"
#include "discdata/lookup.h"
#include "discs/toc.h"
#include "discs/xmcd.h"
#include "measure.h"
#include "opencatalogue.h"
#include "platform/desktop/form.h"
#include "platform/work/longwork.h"
#include "workcommands.h"

#include <QFile>

using namespace Qt::StringLiterals;

namespace
{

// "1 6 95462 150 15363 ...": first, last, lead-out, offsets.
TableOfContents tocFrom(const QString &text)
{
    const QStringList numbers = text.split(u' ', Qt::SkipEmptyParts);
    TableOfContents toc;
    toc.first = numbers.value(0).toInt();
    toc.leadOut = numbers.value(2).toInt();
    for (const QString &offset : numbers.mid(3))
        toc.tracks.push_back({offset.toInt()});
    if (!toc.isValid())
        throw Error(errSyntax, {}, u"not a table of contents"_s);
    return toc;
}

// "cddb+http://127.0.0.1:8123"
ServiceOptions optionsFrom(const QString &service)
{
    ServiceOptions options;
    options.order = {service.section(u'+', 0, 0)};
    options.cddbAddress = options.musicBrainzAddress = service.section(u'+', 1);
    options.mail = u"nobody@songcase.invalid"_s;
    return options;
}

ADODB::RecordsetPtr rowsOf(const DiscRecord &disc)
{
    auto rows = std::make_shared<ADODB::Recordset>();
    for (const char *name : {"Nr", "Artiest", "Titel", "Genre", "Hitjaar"}) {
        if (disc.isCompilation || qstrcmp(name, "Artiest") != 0)
            rows->appendField(QLatin1String(name), ADODB::adVarWChar, 255);
    }
    rows->Open();
    for (int number = 0; const TrackRecord &track : disc.tracks) {
        rows->AddNew();
        rows->Fields(u"Nr").setValue(QString::number(++number));
        if (disc.isCompilation)
            rows->Fields(u"Artiest").setValue(track.artist.name);
        rows->Fields(u"Titel").setValue(track.title);
        rows->Fields(u"Genre").setValue(track.genre);
        rows->Fields(u"Hitjaar").setValue(track.year);
    }
    return rows;
}

} // namespace

void lookUpDisc(const QStringList &arguments)
{
    const TableOfContents toc = tocFrom(arguments[0]);
    Form screen(u"lookup"_s);
    LongWork work(screen);
    work.showPercent = [](int) {};
    measured("lookup", [&] {
        Lookup services(optionsFrom(arguments[1]), KeptAnswers({}));
        const auto found = services.find(toc, work);
        for (const DiscRecord &disc : found.candidates)
            std::printf("%s / %s\n", qUtf8Printable(disc.artist.name), qUtf8Printable(disc.title));
        return count("candidates", static_cast<long long>(found.candidates.size()));
    });
}

void importDisc(const QStringList &arguments)
{
    openForWork(arguments[0]);
    QFile file(arguments[1]);
    if (!file.open(QIODevice::ReadOnly))
        throw Error(errCannotUse, {}, file.errorString());
    const DiscRecord disc = readXmcd(file.readAll()).disc;
    measured("importdisc", [&] {
        DiscImport import({disc.artist.name, disc.title, disc.genre, disc.year, disc.numberInSet,
                           disc.totalInSet, rowsOf(disc)});
        const bool done = disc.isCompilation ? import.ImportCompilation() : import.ImportAlbum();
        return count("tracks", done ? static_cast<long long>(disc.tracks.size()) : 0);
    });
}
