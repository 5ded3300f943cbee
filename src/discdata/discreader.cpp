#include "discdata/discreader.h"

#include "discs/candidates.h"
#include "discs/discsheet.h"
#include "platform/work/helperprogram.h"

using namespace Qt::StringLiterals;

namespace
{

using End = HelperProgram::End;

// A disc is some hundred short lines, and hardly any work.
constexpr qint64 mostMemory = qint64(256) << 20, mostOutput = 1 << 20; // bytes
constexpr int mostWork = 15;                                           // seconds

class Answer
{
public:
    void take(const QByteArray &line);
    std::optional<DiscSheet> sheet();

private:
    void takeTrack(const QList<QByteArray> &words);
    void takeText(const QString &line);

    DiscSheet mSheet;
    bool mWhole = false, mNonsense = false;
};

void Answer::takeTrack(const QList<QByteArray> &words)
{
    TableOfContents &toc = mSheet.toc;
    const int number = words[1].toInt();
    if (toc.tracks.empty())
        toc.first = number;
    if (number != toc.first + int(toc.tracks.size()))
        mNonsense = true;
    toc.tracks.push_back({words[2].toInt(), words[3] == "data"});
    mSheet.known.tracks.emplace_back();
}

// "text NUMBER FIELD TEXT"
void Answer::takeText(const QString &line)
{
    DiscRecord &disc = mSheet.known;
    const int number = line.section(u' ', 1, 1).toInt();
    const size_t at = size_t(number - mSheet.toc.first);
    if (number != 0 && at >= disc.tracks.size())
        return;
    const QString field = line.section(u' ', 2, 2);
    const QString text = cleanText(line.section(u' ', 3));
    if (field == "title"_L1)
        (number == 0 ? disc.title : disc.tracks[at].title) = text;
    else if (field == "performer"_L1)
        (number == 0 ? disc.artist : disc.tracks[at].artist).name = text;
    else if (field == "genre"_L1)
        disc.genre = text;
    else if (field == "barcode"_L1)
        disc.barcode = text;
}

void Answer::take(const QByteArray &line)
{
    const QList<QByteArray> words = line.split(' ');
    if (mWhole && words[0] == "text")
        takeText(QString::fromUtf8(line));
    else if (!mWhole && words[0] == "track" && words.size() == 4)
        takeTrack(words);
    else if (!mWhole && words[0] == "leadout" && words.size() == 2)
        mSheet.toc.leadOut = words[1].toInt();
    else if (!mWhole && line == "end")
        mWhole = true;
    else
        mNonsense = true;
}

// The table counts once it has come whole, even if the program dies behind it.
std::optional<DiscSheet> Answer::sheet()
{
    if (!mWhole || mNonsense || !discsheet::complete(mSheet))
        return {};
    return mSheet;
}

FoundDisc found(Answer &answer, End end)
{
    FoundDisc disc;
    disc.cancelled = end == End::Cancelled;
    if (disc.cancelled)
        return disc;
    if (const auto sheet = answer.sheet()) {
        disc.toc = {sheet->toc, sheet->known, {}};
        disc.tracks = sheet->known.trackCount;
    } else if (end == End::NotStarted) {
        disc.problem = "xDiscNoHelper";
    } else if (end == End::TooSlow) {
        disc.problem = "xDiscTooSlow";
    }
    return disc;
}

} // namespace

FoundDisc DiscReader::ask(const QStringList &arguments)
{
    HelperProgram helper(mWork, mProgram, arguments, {mostMemory, mostOutput, mPatience, mostWork});
    Answer answer;
    while (const auto line = helper.line())
        answer.take(*line);
    FoundDisc disc = found(answer, helper.end());
    disc.about = helper.end() == End::NotStarted ? mProgram : arguments.last();
    return disc;
}

FoundDisc DiscReader::readImage(const QString &file)
{
    FoundDisc disc = ask({u"image"_s, file});
    if (disc.tracks == 0 && !disc.problem && !disc.cancelled)
        disc.problem = "xDiscNoTable";
    return disc;
}

FoundDisc DiscReader::readDrive(const QString &device)
{
    return ask({u"drive"_s, device});
}
