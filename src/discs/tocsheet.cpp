#include "discs/tocsheet.h"

#include "discs/candidates.h"

#include <QRegularExpression>

using namespace Qt::StringLiterals;

namespace
{

constexpr int samplesPerFrame = 588;
constexpr int bytesPerSample = 4;
constexpr qint64 mostUnits = qint64(1) << 40; // of one length; a disc has far less

struct Token {
    QString text;
    bool quoted = false;

    bool is(QLatin1StringView word) const { return !quoted && text == word; }
};

// Words, texts in quotes, braces and commas; comments are left out.
class Tokens
{
public:
    explicit Tokens(const QString &text) : mText(text) {}
    bool atEnd();
    Token next();
    Token peek();

private:
    QString quoted();
    QChar escaped();
    QChar at(qsizetype place) const { return place < mText.size() ? mText[place] : QChar(); }

    const QString &mText;
    qsizetype mAt = 0;
};

bool Tokens::atEnd()
{
    while (mAt < mText.size()) {
        if (at(mAt) == u'/' && at(mAt + 1) == u'/') {
            const qsizetype end = mText.indexOf(u'\n', mAt);
            mAt = end < 0 ? mText.size() : end;
        } else if (mText[mAt].isSpace()) {
            ++mAt;
        } else {
            return false;
        }
    }
    return true;
}

// \" and \\, and a letter by its number in octal digits.
QChar Tokens::escaped()
{
    ushort code = 0;
    int digits = 0;
    while (digits < 3 && at(mAt) >= u'0' && at(mAt) <= u'7') {
        code = ushort(code * 8 + at(mAt++).digitValue());
        ++digits;
    }
    return digits > 0 ? QChar(code) : at(mAt++);
}

QString Tokens::quoted()
{
    QString text;
    for (++mAt; mAt < mText.size();) {
        const QChar c = mText[mAt++];
        if (c == u'"')
            break;
        text += c == u'\\' ? escaped() : c;
    }
    return text;
}

Token Tokens::next()
{
    if (atEnd())
        return {};
    if (at(mAt) == u'"')
        return {quoted(), true};
    const auto isSign = [](QChar c) { return c == u'{' || c == u'}' || c == u','; };
    const qsizetype from = mAt++;
    if (isSign(at(from)))
        return {at(from), false};
    while (mAt < mText.size() && !at(mAt).isSpace() && at(mAt) != u'"' && !isSign(at(mAt)))
        ++mAt;
    return {mText.mid(from, mAt - from), false};
}

Token Tokens::peek()
{
    const qsizetype here = mAt;
    Token token = next();
    mAt = here;
    return token;
}

// Sound is counted in samples, data in bytes.
struct Track {
    bool isData = false;
    int perFrame = samplesPerFrame;
    qint64 length = 0;
    qint64 start = 0; // of what is heard, behind the gap

    qint64 frames(qint64 units) const { return (units + perFrame - 1) / perFrame; }
};

int bytesPerFrame(const QString &mode)
{
    static const QHash<QString, int> sizes{{u"MODE1"_s, 2048},         {u"MODE1_RAW"_s, 2352},
                                           {u"MODE2"_s, 2336},         {u"MODE2_RAW"_s, 2352},
                                           {u"MODE2_FORM1"_s, 2048},   {u"MODE2_FORM2"_s, 2324},
                                           {u"MODE2_FORM_MIX"_s, 2336}};
    return sizes.value(mode, 0);
}

bool isSoundInItsOwnFormat(const QString &name)
{
    static const QRegularExpression ending(u"\\.(wav|mp3|ogg|flac|aiff?)$"_s,
                                           QRegularExpression::CaseInsensitiveOption);
    return ending.match(name).hasMatch();
}

class TocReader
{
public:
    TocReader(const QString &text, const LengthOfFile &lengthOf)
        : mTokens(text), mLengthOf(lengthOf)
    {
    }
    std::optional<DiscSheet> read();

private:
    void statement(const Token &word);
    void trackStatement(const Token &word);
    void track();
    void cdText();
    void sound();
    void data();
    void silence();
    void start();
    std::optional<qint64> length();
    qint64 byteOffset();
    std::optional<qint64> measured(const QString &name, qint64 byteOffset);
    void place();

    Tokens mTokens;
    const LengthOfFile &mLengthOf;
    DiscSheet mSheet;
    std::vector<Track> mTracks;
    bool mDamaged = false;
};

// The length that comes next, if one does: a time, or a number of the units of the track.
std::optional<qint64> TocReader::length()
{
    const Token token = mTokens.peek();
    if (token.quoted || token.text.isEmpty() || !token.text[0].isDigit())
        return {};
    mTokens.next();
    if (const auto frames = discsheet::framesOf(token.text))
        return *frames * mTracks.back().perFrame;
    bool isNumber = false;
    const qint64 units = token.text.toLongLong(&isNumber);
    if (!isNumber || units > mostUnits)
        mDamaged = true;
    return mDamaged ? 0 : units;
}

// "#1234" before the length: where in the file it begins.
qint64 TocReader::byteOffset()
{
    if (mTokens.peek().is("SWAP"_L1))
        mTokens.next();
    const Token token = mTokens.peek();
    if (token.quoted || !token.text.startsWith(u'#'))
        return 0;
    mTokens.next();
    return std::clamp<qint64>(QStringView(token.text).mid(1).toLongLong(), 0, mostUnits);
}

// The whole file in the units of the track.
std::optional<qint64> TocReader::measured(const QString &name, qint64 byteOffset)
{
    const Track &track = mTracks.back();
    const bool raw = track.isData || !isSoundInItsOwnFormat(name);
    const auto length = mLengthOf(name, raw ? LengthIn::Bytes : LengthIn::Frames);
    if (!length && mSheet.missing.isEmpty())
        mSheet.missing = name;
    if (!length)
        return {};
    if (!raw)
        return *length * samplesPerFrame;
    const qint64 bytes = std::max<qint64>(*length - byteOffset, 0);
    return track.isData ? bytes : bytes / bytesPerSample;
}

// FILE "name" [SWAP] [#offset] START [LENGTH]; without a length, or with 0, to its end.
void TocReader::sound()
{
    const QString name = mTokens.next().text;
    const qint64 offset = byteOffset();
    const qint64 from = length().value_or(0);
    qint64 units = length().value_or(0);
    if (units == 0)
        units = std::max<qint64>(measured(name, offset).value_or(0) - from, 0);
    mTracks.back().length += units;
}

// DATAFILE "name" [#offset] [LENGTH]
void TocReader::data()
{
    const QString name = mTokens.next().text;
    const qint64 offset = byteOffset();
    qint64 units = length().value_or(0);
    if (units == 0)
        units = measured(name, offset).value_or(0);
    mTracks.back().length += units;
}

// SILENCE LENGTH, ZERO [MODE] [SUBCHANNEL] LENGTH
void TocReader::silence()
{
    for (int words = 0; words < 2 && !mTokens.peek().quoted; ++words) {
        const QString word = mTokens.peek().text;
        if (word != "AUDIO"_L1 && !word.startsWith("RW"_L1) && bytesPerFrame(word) == 0)
            break;
        mTokens.next();
    }
    const auto units = length();
    if (!units)
        mDamaged = true;
    mTracks.back().length += units.value_or(0);
}

// START [TIME]: what is heard begins at this time of the track, or where the next file begins.
void TocReader::start()
{
    Track &track = mTracks.back();
    track.start = length().value_or(track.length);
}

void TocReader::track()
{
    const QString mode = mTokens.next().text;
    Track track;
    track.isData = mode != "AUDIO"_L1;
    if (track.isData)
        track.perFrame = bytesPerFrame(mode);
    if (track.perFrame == 0) {
        mDamaged = true;
        track.perFrame = 1;
    }
    mTracks.push_back(track);
    mSheet.known.tracks.emplace_back();
}

// CD_TEXT { LANGUAGE_MAP { 0 : EN } LANGUAGE 0 { TITLE "..." PERFORMER "..." } }; the first
// language that says something counts.
void TocReader::cdText()
{
    DiscRecord &disc = mSheet.known;
    QString &title = mTracks.empty() ? disc.title : disc.tracks.back().title;
    QString &artist = (mTracks.empty() ? disc.artist : disc.tracks.back().artist).name;
    int depth = 0;
    do {
        const Token token = mTokens.next();
        depth += int(token.is("{"_L1)) - int(token.is("}"_L1));
        const bool isTitle = token.is("TITLE"_L1);
        if ((!isTitle && !token.is("PERFORMER"_L1)) || !mTokens.peek().quoted)
            continue;
        QString &field = isTitle ? title : artist;
        const QString value = cleanText(mTokens.next().text);
        if (field.isEmpty())
            field = value;
    } while (depth > 0 && !mTokens.atEnd());
}

void TocReader::trackStatement(const Token &word)
{
    if (word.is("FILE"_L1) || word.is("AUDIOFILE"_L1)) {
        sound();
    } else if (word.is("DATAFILE"_L1) || word.is("FIFO"_L1)) {
        data();
    } else if (word.is("SILENCE"_L1) || word.is("ZERO"_L1)) {
        silence();
    } else if (word.is("START"_L1)) {
        start();
    } else if (word.is("PREGAP"_L1)) {
        silence();
        mTracks.back().start = mTracks.back().length;
    }
}

void TocReader::statement(const Token &word)
{
    if (word.is("TRACK"_L1))
        track();
    else if (word.is("CD_TEXT"_L1))
        cdText();
    else if (word.is("CATALOG"_L1))
        mSheet.known.barcode = cleanText(mTokens.next().text);
    else if (!mTracks.empty())
        trackStatement(word);
}

void TocReader::place()
{
    qint64 at = firstFrame;
    const auto frame = [](qint64 frames) { return int(std::min<qint64>(frames, INT_MAX)); };
    for (const Track &track : mTracks) {
        const qint64 offset = at + track.frames(track.start);
        mSheet.toc.tracks.push_back({frame(offset), track.isData});
        at += track.frames(track.length);
    }
    mSheet.toc.leadOut = frame(at);
}

std::optional<DiscSheet> TocReader::read()
{
    while (!mDamaged && !mTokens.atEnd())
        statement(mTokens.next());
    if (mDamaged || mTracks.empty())
        return {};
    place();
    return discsheet::complete(mSheet) ? std::optional(mSheet) : std::nullopt;
}

} // namespace

std::optional<DiscSheet> readTocSheet(QByteArrayView bytes, const LengthOfFile &lengthOf)
{
    const QString text = discsheet::decoded(bytes);
    return TocReader(text, lengthOf).read();
}
