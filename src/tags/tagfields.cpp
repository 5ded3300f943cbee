#include "tags/tagfields.h"

#include "tags/tagtexts.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

struct FrameNames {
    TagField field;
    const char *two, *later; // of version 2.2, of 2.3 and 2.4
};

constexpr FrameNames frameNames[] = {
    {TagField::Album, "TAL", "TALB"},
    {TagField::Title, "TT2", "TIT2"},
    {TagField::CopyrightHolder, "TCR", "TCOP"},
    {TagField::Comments, "COM", "COMM"},
    {TagField::Label, "TPB", "TPUB"},
    {TagField::LeadArtist, "TP1", "TPE1"},
    {TagField::PartOfSet, "TPA", "TPOS"},
    {TagField::TrackPosition, "TRK", "TRCK"},
    {TagField::Year, "TYE", "TYER"},
    {TagField::Genre, "TCO", "TCON"},
    {TagField::FileId, "UFI", "UFID"},
};

struct Comment {
    QString description, text;
};

// Encoding, language (three letters), description, text.
Comment commentIn(const QByteArray &content)
{
    constexpr qsizetype language = 3;
    if (content.size() < 1 + language)
        return {};
    const QByteArray texts = content.first(1) + content.sliced(1 + language);
    return {frameTexts(texts).value(0), frameTexts(behindTexts(texts, 1)).value(0)};
}

// Owner in ISO 8859-1, a zero, data.
struct Identifier {
    QByteArray owner, data;
    QString text() const
    {
        return withoutFilling(QString::fromLatin1(owner)) + u'=' +
               QString::fromLatin1(data.toHex());
    }
};

Identifier identifierIn(const QByteArray &content)
{
    const qsizetype end = content.indexOf('\0');
    return {content.left(end), end < 0 ? QByteArray() : content.mid(end + 1)};
}

// As an identifier is read, whatever letters stand in it.
QString hexadecimal(const QString &data)
{
    return QString::fromLatin1(QByteArray::fromHex(data.toLatin1()).toHex());
}

// Collects what the frames of one tag say.
class Reading
{
public:
    Reading(const QByteArray &tag, const TagLayout &layout) : mTag(tag), mLayout(layout) {}

    std::vector<QByteArray> contents(const QByteArray &id) const
    {
        std::vector<QByteArray> all;
        for (const TagFrame &frame : mLayout.frames) {
            if (frame.id == id)
                all.push_back(mLayout.contentOf(mTag, frame));
        }
        return all;
    }

    QStringList values(const QByteArray &id) const
    {
        const auto all = contents(id);
        QStringList values;
        for (const QString &value : all.empty() ? QStringList() : frameTexts(all.front())) {
            if (const QString each = withoutFilling(value); !each.isEmpty())
                values.append(each);
        }
        return values;
    }

    QString field(TagField field) const
    {
        const QByteArray id = frameOf(field, mLayout.version);
        switch (field) {
        case TagField::Year:
            return year(id);
        case TagField::Comments:
            return comment(id);
        case TagField::FileId:
            return fileId(id);
        case TagField::Genre:
            return genre(id);
        default:
            return asRead(field, values(id).join(u'/'));
        }
    }

private:
    // Where there is a date it holds before the year alone.
    QString year(const QByteArray &id) const
    {
        const QByteArray other = otherYearFrame(mLayout.version);
        for (const QByteArray &frame : {QByteArray("TDRC"), id, other}) {
            QString year = asRead(TagField::Year, values(frame).join(u'/'));
            if (!year.isEmpty())
                return year;
        }
        return {};
    }

    QString genre(const QByteArray &id) const
    {
        QStringList names;
        for (const QString &value : values(id))
            names += genreNames(value);
        names.removeDuplicates();
        return names.join(u'/');
    }

    // One that says what it is about is a comment of some program.
    QString comment(const QByteArray &id) const
    {
        const auto all = contents(id);
        for (const QByteArray &content : all) {
            if (const Comment comment = commentIn(content); comment.description.isEmpty())
                return withoutFilling(comment.text);
        }
        return all.empty() ? QString() : withoutFilling(commentIn(all.front()).text);
    }

    QString fileId(const QByteArray &id) const
    {
        const auto all = contents(id);
        for (const QByteArray &content : all) {
            if (const Identifier own = identifierIn(content); own.owner == ownFileIdOwner)
                return own.text();
        }
        return all.empty() ? QString() : identifierIn(all.front()).text();
    }

    const QByteArray &mTag;
    const TagLayout &mLayout;
};

} // namespace

QByteArray frameOf(TagField field, int version)
{
    if (field == TagField::Year && version == 4)
        return "TDRC";
    const auto *names = std::find_if(std::begin(frameNames), std::end(frameNames),
                                     [field](const FrameNames &n) { return n.field == field; });
    return version == 2 ? names->two : names->later;
}

QByteArray otherYearFrame(int version)
{
    return version == 2 ? "" : version == 3 ? "TDRC" : "TYER";
}

bool isFrameOf(TagField field, const TagFrame &frame, const QByteArray &tag,
               const TagLayout &layout)
{
    if (field == TagField::Year && frame.id == otherYearFrame(layout.version))
        return true;
    if (frame.id != frameOf(field, layout.version))
        return false;
    const QByteArray content = layout.contentOf(tag, frame);
    if (field == TagField::Comments)
        return frame.isPlain && commentIn(content).description.isEmpty();
    if (field == TagField::FileId)
        return frame.isPlain && identifierIn(content).owner == ownFileIdOwner;
    return true;
}

QString asRead(TagField field, const QString &text)
{
    constexpr qsizetype digits = 4;
    // A zero would end the text, a byte order mark would be taken for one.
    QString plain =
        withoutFilling(QString(text).remove(QChar(0)).remove(QChar(QChar::ByteOrderMark)));
    switch (field) {
    case TagField::Year:
        return withoutFilling(plain.left(digits));
    case TagField::PartOfSet:
    case TagField::TrackPosition:
        return withoutZeros(plain);
    case TagField::FileId: {
        const QString own = QLatin1String(ownFileIdOwner) + u'=';
        return plain.startsWith(own) ? own + hexadecimal(plain.mid(own.size())) : plain;
    }
    case TagField::Genre: {
        QStringList names = genreNames(plain);
        names.removeDuplicates();
        return names.join(u'/');
    }
    default:
        return plain;
    }
}

std::optional<CddbID3Tag> fieldsOf(const QByteArray &tag, const TagLayout &layout)
{
    const auto isStrange = [&](const TagFrame &frame) {
        return !frame.isPlain &&
               std::any_of(std::begin(frameNames), std::end(frameNames), [&](const FrameNames &n) {
                   return frame.id == frameOf(n.field, layout.version) ||
                          (n.field == TagField::Year && frame.id == otherYearFrame(layout.version));
               });
    };
    if (std::any_of(layout.frames.begin(), layout.frames.end(), isStrange))
        return {};
    const Reading reading(tag, layout);
    CddbID3Tag fields;
    for (int i = 0; i < tagFields; ++i)
        fields.setField(TagField(i), reading.field(TagField(i)));
    return fields;
}
