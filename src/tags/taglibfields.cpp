#include "tags/taglibfields.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "tags/tagfields.h"
#include "tags/tagtexts.h"

#include <QStringList>
#include <commentsframe.h>
#include <id3v2framefactory.h>
#include <id3v2tag.h>
#include <mpegfile.h>
#include <textidentificationframe.h>
#include <uniquefileidentifierframe.h>

using namespace Qt::StringLiterals;

namespace
{

using TagLib::ID3v2::CommentsFrame;
using TagLib::ID3v2::Tag;
using TagLib::ID3v2::TextIdentificationFrame;
using TagLib::ID3v2::UniqueFileIdentifierFrame;

QString textOf(const TagLib::String &text)
{
    return withoutFilling(QString::fromUtf8(QByteArray::fromStdString(text.to8Bit(true))));
}

QStringList valuesOf(const Tag &tag, const char *frame)
{
    const TagLib::ID3v2::FrameList &frames = tag.frameListMap()[frame];
    if (frames.isEmpty())
        return {};
    QStringList values;
    const auto *text = dynamic_cast<const TextIdentificationFrame *>(frames.front());
    for (const TagLib::String &value : text ? text->fieldList() : TagLib::StringList()) {
        if (const QString each = textOf(value); !each.isEmpty())
            values.append(each);
    }
    return values;
}

QString joined(const Tag &tag, TagField field)
{
    return asRead(field, valuesOf(tag, frameOf(field, 4).constData()).join(u'/'));
}

QString genresOf(const Tag &tag)
{
    QStringList names;
    for (const QString &value : valuesOf(tag, "TCON"))
        names += genreNames(value);
    names.removeDuplicates();
    return names.join(u'/');
}

QString commentOf(const Tag &tag)
{
    const CommentsFrame *first = nullptr;
    for (const auto *frame : tag.frameListMap()["COMM"]) {
        const auto *comment = dynamic_cast<const CommentsFrame *>(frame);
        if (comment && comment->description().isEmpty())
            return textOf(comment->text());
        first = first ? first : comment;
    }
    return first ? textOf(first->text()) : QString();
}

QString textOf(const UniqueFileIdentifierFrame &id)
{
    const TagLib::ByteVector data = id.identifier();
    return textOf(id.owner()) + u'=' +
           QString::fromLatin1(QByteArray(data.data(), data.size()).toHex());
}

QString fileIdOf(const Tag &tag)
{
    const UniqueFileIdentifierFrame *first = nullptr;
    for (const auto *frame : tag.frameListMap()["UFID"]) {
        const auto *id = dynamic_cast<const UniqueFileIdentifierFrame *>(frame);
        if (id && id->owner() == ownFileIdOwner)
            return textOf(*id);
        first = first ? first : id;
    }
    return first ? textOf(*first) : QString();
}

} // namespace

std::optional<CddbID3Tag> fieldsByTagLib(const QString &path)
{
    TagLib::MPEG::File file(nativeName(path).constData(), TagLib::ID3v2::FrameFactory::instance(),
                            false);
    if (!file.isOpen())
        throw makeError(errFileFailed, path);
    if (!file.hasID3v2Tag())
        return {};
    const Tag &tag = *file.ID3v2Tag();
    CddbID3Tag fields;
    for (const auto field :
         {TagField::Album, TagField::Title, TagField::CopyrightHolder, TagField::Label,
          TagField::LeadArtist, TagField::PartOfSet, TagField::TrackPosition, TagField::Year})
        fields.setField(field, joined(tag, field));
    if (fields.Year().isEmpty())
        fields.setYear(asRead(TagField::Year, valuesOf(tag, "TYER").join(u'/')));
    fields.setComments(commentOf(tag));
    fields.setGenre(genresOf(tag));
    fields.setFileId(fileIdOf(tag));
    return fields;
}
