#include "discs/cddbanswer.h"

#include "discs/candidates.h"
#include "discs/notunderstood.h"
#include "discs/partofset.h"
#include "discs/samplertracks.h"
#include "platform/text/codepage.h"

#include <QRegularExpression>

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

constexpr qsizetype codeLength = 3;

enum Code {
    exactMatch = 200,
    noMatch = 202,
    exactMatches = 210,
    closeMatches = 211,
    noSuchEntry = 401,
    serverError = 402,
    refusedOrDamaged = 403,
    environmentError = 408,
    tooManyUsers = 433,
    tooBusy = 434,
    serverTimeOut = 530,
};

QString decoded(QByteArrayView bytes)
{
    return text::decode(bytes, text::encodingOf(bytes));
}

// The next line without its end; `rest` is what follows.
QByteArrayView takeLine(QByteArrayView &rest)
{
    const auto end = rest.indexOf('\n');
    QByteArrayView line = end < 0 ? rest : rest.first(end);
    rest = end < 0 ? QByteArrayView() : rest.sliced(end + 1);
    if (line.endsWith('\r'))
        line.chop(1);
    return line;
}

// "210 Found": three digits, and a blank or the end behind them.
int codeOf(QByteArrayView line)
{
    const bool isCode =
        line.size() >= codeLength &&
        std::all_of(line.begin(), line.begin() + codeLength,
                    [](char c) { return c >= '0' && c <= '9'; }) &&
        (line.size() == codeLength || line[codeLength] == ' ' || line[codeLength] == '-');
    return isCode ? line.first(codeLength).toInt() : 0;
}

bool linesFollow(int code)
{
    return code / 10 % 10 == 1;
}

// A point at the start of a line is sent twice; one alone is the end.
void readBody(QByteArrayView rest, CddbAnswer &answer)
{
    while (!rest.isEmpty()) {
        const QByteArrayView line = takeLine(rest);
        if (line == ".") {
            answer.isWhole = true;
            return;
        }
        answer.body += line.startsWith("..") ? line.sliced(1) : line;
        answer.body += '\n';
    }
}

bool isWord(const QString &category)
{
    static const QRegularExpression pattern(u"^[a-z0-9_-]{1,30}$"_s,
                                            QRegularExpression::CaseInsensitiveOption);
    return pattern.match(category).hasMatch();
}

bool isDiscId(const QString &id)
{
    static const QRegularExpression pattern(u"^[0-9a-f]{8}$"_s,
                                            QRegularExpression::CaseInsensitiveOption);
    return pattern.match(id).hasMatch();
}

DiscRecord candidateOf(const QString &category, const QString &id, const QString &title)
{
    DiscRecord disc;
    const SplitTitle split = splitTitle(title);
    const PartOfSet part = partOfSet(cleanText(split.title), {});
    disc.title = part.title;
    disc.numberInSet = part.number;
    disc.totalInSet = part.total;
    disc.artist.name = cleanText(split.isSplit ? split.artist : split.title);
    disc.isCompilation = isVariousArtists(disc.artist.name);
    disc.trackCount = id.right(2).toInt(nullptr, 16); // the id ends with it
    disc.service = u"cddb"_s;
    disc.keyA = disc.category = category;
    disc.keyB = id;
    disc.discIds = QStringList{id};
    return disc;
}

// "CATEGORY ID ARTIST / TITLE"; nothing is added for other lines.
void addCandidate(const QString &line, std::vector<DiscRecord> &candidates)
{
    const QString category = line.section(u' ', 0, 0), id = line.section(u' ', 1, 1);
    const QString title = line.section(u' ', 2);
    if (isWord(category) && isDiscId(id) && !cleanText(title).isEmpty())
        candidates.push_back(candidateOf(category, id, title));
}

bool saysRefusal(const QString &text)
{
    return text.contains(u"not compatible"_s, Qt::CaseInsensitive) ||
           text.contains(u"gnudb.org/howto"_s, Qt::CaseInsensitive);
}

bool speaksOfEntry(const QString &text)
{
    static const QRegularExpression words(u"\\b(entry|corrupt|damaged)\\b"_s,
                                          QRegularExpression::CaseInsensitiveOption);
    return words.match(text).hasMatch();
}

} // namespace

bool CddbAnswer::isRefusal() const
{
    if (code == refusedOrDamaged)
        return !speaksOfEntry(text);
    return code >= 400 && code < 600 && code != noSuchEntry && !isTrouble();
}

bool CddbAnswer::isMissing() const
{
    return code == noSuchEntry;
}

bool CddbAnswer::isTrouble() const
{
    return code == serverError || code == environmentError || code == tooManyUsers ||
           code == tooBusy || code == serverTimeOut;
}

CddbAnswer readCddbAnswer(const QByteArray &bytes)
{
    QByteArrayView rest = text::withoutByteOrderMark(bytes);
    const QByteArrayView first = takeLine(rest);
    CddbAnswer answer;
    answer.code = codeOf(first);
    if (answer.code == 0)
        throw notUnderstood("xNotACddbAnswer");
    answer.text = cleanText(decoded(first.sliced(codeLength)));
    if (linesFollow(answer.code))
        readBody(rest, answer);
    else
        answer.isWhole = true;
    return answer;
}

std::vector<DiscRecord> cddbCandidates(const CddbAnswer &answer)
{
    std::vector<DiscRecord> candidates;
    if (answer.code == exactMatch) {
        addCandidate(answer.text, candidates);
        if (candidates.empty()) // a line cut short must not count as "no match"
            throw notUnderstood("xNotACddbAnswer", answer.text);
    } else if (answer.code == exactMatches || answer.code == closeMatches) {
        const QString lines = decoded(answer.body);
        for (const QStringView line : QStringView(lines).split(u'\n'))
            addCandidate(line.toString(), candidates);
    } else if (answer.code != noMatch) {
        throw notUnderstood("xNotACddbAnswer", answer.text);
    }
    return candidates;
}

bool isRefusal(const DiscRecord &disc)
{
    return saysRefusal(disc.title) || saysRefusal(disc.artist.name) ||
           std::ranges::any_of(disc.tracks, [](const TrackRecord &track) {
               return saysRefusal(track.title) || saysRefusal(track.artist.name);
           });
}

const QStringList &cddbCategories()
{
    static const QStringList categories{u"blues"_s,  u"classical"_s, u"country"_s,   u"data"_s,
                                        u"folk"_s,   u"jazz"_s,      u"misc"_s,      u"newage"_s,
                                        u"reggae"_s, u"rock"_s,      u"soundtrack"_s};
    return categories;
}
