#include "tags/CddbID3Tag.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "platform/files/ordinaryfile.h"

#include <QStringList>
#include <commentsframe.h>
#include <id3v1genres.h>
#include <id3v2framefactory.h>
#include <id3v2tag.h>
#include <mpegfile.h>
#include <textidentificationframe.h>
#include <uniquefileidentifierframe.h>

using namespace Qt::StringLiterals;

const char *const ownFileIdOwner = "songcase";

namespace
{

using TagLib::ID3v2::FrameList;

// Blanks and zero bytes at the ends belong to no text: fields of fixed length are filled with them.
QString textOf(const TagLib::String &text)
{
    const QByteArray utf8 = QByteArray::fromStdString(text.to8Bit(true));
    const QString all = QString::fromUtf8(utf8);
    const auto isFilling = [](QChar c) { return c.isNull() || c.isSpace(); };
    qsizetype from = 0, to = all.size();
    while (to > from && isFilling(all[to - 1]))
        --to;
    while (from < to && isFilling(all[from]))
        ++from;
    return all.sliced(from, to - from);
}

QStringList valuesOf(const TagLib::ID3v2::Tag &tag, const char *frame)
{
    const FrameList &frames = tag.frameListMap()[frame];
    if (frames.isEmpty())
        return {};
    QStringList values;
    const auto *text = dynamic_cast<const TagLib::ID3v2::TextIdentificationFrame *>(frames.front());
    for (const TagLib::String &value : text ? text->fieldList() : TagLib::StringList()) {
        if (const QString each = textOf(value); !each.isEmpty())
            values.append(each);
    }
    return values;
}

QString joined(const TagLib::ID3v2::Tag &tag, const char *frame)
{
    return valuesOf(tag, frame).join(u'/');
}

// "03/09" is 3/9.
QString withoutZeros(const QString &numbers)
{
    QStringList parts = numbers.split(u'/');
    for (QString &part : parts) {
        while (part.size() > 1 && part.startsWith(u'0') && part[1].isDigit())
            part.remove(0, 1);
    }
    return parts.join(u'/');
}

QString yearOf(const TagLib::ID3v2::Tag &tag)
{
    constexpr qsizetype digits = 4;
    for (const char *frame : {"TDRC", "TYER"}) {
        QString year = joined(tag, frame).left(digits);
        if (!year.isEmpty())
            return year;
    }
    return {};
}

// "17" and "(17)" are Rock, "(17)Hard rock" is what stands behind the number.
QString genreName(const QString &genre)
{
    QString rest = genre;
    QString number = genre;
    if (genre.startsWith(u'(') && !genre.startsWith("(("_L1)) {
        number = genre.mid(1, genre.indexOf(u')') - 1);
        rest = genre.mid(genre.indexOf(u')') + 1);
        if (!rest.isEmpty())
            return genreName(rest);
    } else if (genre.startsWith("(("_L1)) {
        return genre.mid(1);
    }
    if (number == "RX"_L1)
        return u"Remix"_s;
    if (number == "CR"_L1)
        return u"Cover"_s;
    bool isNumber = false;
    const int index = number.toInt(&isNumber);
    const QString name = isNumber ? textOf(TagLib::ID3v1::genre(index)) : QString();
    return name.isEmpty() ? genre : name;
}

QString genresOf(const TagLib::ID3v2::Tag &tag)
{
    QStringList names = valuesOf(tag, "TCON");
    for (QString &name : names)
        name = genreName(name);
    names.removeDuplicates();
    return names.join(u'/');
}

// One that says what it is about is a comment of some program.
QString commentOf(const TagLib::ID3v2::Tag &tag)
{
    const TagLib::ID3v2::CommentsFrame *first = nullptr;
    for (const auto *frame : tag.frameListMap()["COMM"]) {
        const auto *comment = dynamic_cast<const TagLib::ID3v2::CommentsFrame *>(frame);
        if (!comment)
            continue;
        if (comment->description().isEmpty())
            return textOf(comment->text());
        if (!first)
            first = comment;
    }
    return first ? textOf(first->text()) : QString();
}

QString fileIdOf(const TagLib::ID3v2::Tag &tag)
{
    QString other;
    for (const auto *frame : tag.frameListMap()["UFID"]) {
        const auto *id = dynamic_cast<const TagLib::ID3v2::UniqueFileIdentifierFrame *>(frame);
        if (!id)
            continue;
        const TagLib::ByteVector data = id->identifier();
        QString text = textOf(id->owner()) + u'=' +
                       QString::fromLatin1(QByteArray(data.data(), data.size()).toHex());
        if (id->owner() == ownFileIdOwner)
            return text;
        if (other.isEmpty())
            other = text;
    }
    return other;
}

} // namespace

void CddbID3Tag::LoadFromFile(const QString &path, int)
{
    mFields = {};
    if (!isOrdinaryFile(path))
        throw makeError(errCannotUse, path);
    TagLib::MPEG::File file(nativeName(path).constData(), TagLib::ID3v2::FrameFactory::instance(),
                            false);
    if (!file.isOpen())
        throw makeError(errCannotUse, path);
    if (!file.hasID3v2Tag())
        return;
    const TagLib::ID3v2::Tag &tag = *file.ID3v2Tag();
    setAlbum(joined(tag, "TALB"));
    setTitle(joined(tag, "TIT2"));
    setCopyrightHolder(joined(tag, "TCOP"));
    setComments(commentOf(tag));
    setLabel(joined(tag, "TPUB"));
    setLeadArtist(joined(tag, "TPE1"));
    setPartOfSet(withoutZeros(joined(tag, "TPOS")));
    setTrackPosition(withoutZeros(joined(tag, "TRCK")));
    setYear(yearOf(tag));
    setGenre(genresOf(tag));
    setFileId(fileIdOf(tag));
}
