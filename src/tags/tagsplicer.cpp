#include "tags/tagsplicer.h"

#include "tags/tagerrors.h"
#include "tags/tagfields.h"
#include "tags/tagtexts.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

constexpr qsizetype block = 4096;                 // bytes, of most disks
constexpr qsizetype spare = 512;                  // at least this much padding where a tag grows
constexpr qsizetype longest = qsizetype(1) << 28; // sizes have 28 bits
constexpr char newTag[] = {'I', 'D', '3', 3, 0, 0, 0, 0, 0, 0};

QByteArray frameBytes(const QByteArray &id, const QByteArray &content, const TagLayout &layout)
{
    QByteArray bytes = id;
    if (layout.version == 2)
        bytes += eightBitBytes(content.size(), 3);
    else
        bytes += (layout.version == 4 ? sevenBitBytes(content.size())
                                      : eightBitBytes(content.size(), 4)) +
                 QByteArray(2, '\0');
    bytes += content;
    return layout.isUnsynchronised ? unsynchronised(bytes) : bytes;
}

QByteArray ownIdentifier(const QString &fileId)
{
    return QByteArray(ownFileIdOwner) + '\0' +
           QByteArray::fromHex(fileId.section(u'=', 1).toLatin1());
}

bool isOwn(const QString &fileId)
{
    return fileId.startsWith(QLatin1String(ownFileIdOwner) + u'=');
}

// Language of the first comment of ours, so that it stays what it was.
QByteArray commentLanguage(const QByteArray &before)
{
    return before.size() < 4 ? "eng"_ba : before.sliced(1, 3);
}

QByteArray commentContent(const QString &text, const QByteArray &before, int version)
{
    const QByteArray encoded = encodedText(text, version);
    const QByteArray empty = encoded[0] == 1 ? QByteArray("\xFF\xFE\0\0", 4) : QByteArray(1, '\0');
    return encoded.first(1) + commentLanguage(before) + empty + encoded.sliced(1);
}

// The frames of a tag while fields of it are replaced.
class Splicer
{
public:
    Splicer(const QByteArray &tag, TagLayout layout) : mTag(tag), mLayout(std::move(layout))
    {
        for (const TagFrame &frame : mLayout.frames)
            mFrames.push_back(mTag.sliced(frame.from, frame.to - frame.from));
    }

    void replace(TagField field, const QString &text)
    {
        const std::vector<size_t> there = framesOf(field);
        if (text.isEmpty() && !mustStayEmpty(field)) {
            for (const size_t each : there)
                mFrames[each].clear();
            return;
        }
        const QByteArray before =
            there.empty() ? QByteArray() : mLayout.contentOf(mTag, mLayout.frames[there.front()]);
        const QByteArray frame =
            frameBytes(frameOf(field, mLayout.version), contentOf(field, text, before), mLayout);
        if (there.empty())
            mFrames.push_back(frame);
        else
            mFrames[there.front()] = frame;
        // A year stands in one frame alone, or the other one would be read.
        for (size_t i = 1; field == TagField::Year && i < there.size(); ++i)
            mFrames[there[i]].clear();
    }

    QByteArray frames() const
    {
        QByteArray all;
        for (const QByteArray &frame : mFrames)
            all += frame;
        return all;
    }

private:
    std::vector<size_t> framesOf(TagField field) const
    {
        std::vector<size_t> found;
        for (size_t i = 0; i < mLayout.frames.size(); ++i) {
            if (isFrameOf(field, mLayout.frames[i], mTag, mLayout))
                found.push_back(i);
        }
        return found;
    }

    // Without a comment of ours the first described one would be read.
    bool mustStayEmpty(TagField field) const
    {
        const QByteArray id = frameOf(TagField::Comments, mLayout.version);
        return field == TagField::Comments &&
               std::any_of(mLayout.frames.begin(), mLayout.frames.end(), [&](const TagFrame &f) {
                   return f.id == id && !isFrameOf(field, f, mTag, mLayout);
               });
    }

    QByteArray contentOf(TagField field, const QString &text, const QByteArray &before) const
    {
        if (field == TagField::Comments)
            return commentContent(text, before, mLayout.version);
        if (field == TagField::FileId)
            return ownIdentifier(text);
        // Two brackets are read as one, and none is taken for that of a number.
        const bool isBracketed = field == TagField::Genre && text.startsWith(u'(') &&
                                 genreNames(text) != QStringList(text);
        return encodedText(isBracketed ? u'(' + text : text, mLayout.version);
    }

    const QByteArray &mTag;
    const TagLayout mLayout;
    std::vector<QByteArray> mFrames; // empty: removed
};

// The extended header without a checksum, which would be wrong. In version 2.3 it holds nothing
// else.
QByteArray extendedHeader(const QByteArray &tag, const TagLayout &layout)
{
    constexpr qsizetype flagsAt = 5;
    constexpr char hasUpdate = 0x40, hasChecksum = 0x20;
    if (layout.version != 4 || layout.extended <= flagsAt)
        return {};
    QByteArray bytes = tag.sliced(tagHeader, layout.extended);
    if (!(bytes[flagsAt] & hasChecksum))
        return bytes;
    const qsizetype at = flagsAt + 1 + (bytes[flagsAt] & hasUpdate ? 1 : 0);
    bytes.remove(at, 6);
    bytes[flagsAt] = char(bytes[flagsAt] & ~hasChecksum);
    return sevenBitBytes(bytes.size()) + bytes.sliced(4);
}

qsizetype sizeFor(qsizetype needed, qsizetype before, const TagLayout &layout)
{
    if (layout.hasFooter)
        return needed; // no padding there
    if (needed <= before)
        return before;
    const qsizetype blocks = (needed + spare - before + block - 1) / block;
    return before + blocks * block;
}

// Header, what stands behind it, padding, footer.
QByteArray composed(const QByteArray &tag, const TagLayout &layout, const QByteArray &frames)
{
    constexpr char extendedFlag = 0x40;
    const QByteArray extended = extendedHeader(tag, layout);
    QByteArray header = tag.isEmpty() ? QByteArray(newTag, tagHeader) : tag.first(tagHeader);
    if (layout.version > 2 && extended.isEmpty())
        header[5] = char(header[5] & ~extendedFlag);
    const qsizetype footer = layout.hasFooter ? tagHeader : 0;
    const qsizetype needed = tagHeader + extended.size() + frames.size() + footer;
    const qsizetype size = sizeFor(needed, tag.size(), layout);
    if (size - tagHeader - footer >= longest)
        throw tagError(errTagTooLong, "xTagTooLong", {});
    header.replace(6, 4, sevenBitBytes(size - tagHeader - footer));
    QByteArray bytes = header + extended + frames;
    bytes.append(size - footer - bytes.size(), '\0');
    if (footer > 0)
        bytes += "3DI" + header.sliced(3);
    return bytes;
}

} // namespace

CddbID3Tag asRead(const CddbID3Tag &wanted, const CddbID3Tag &current)
{
    CddbID3Tag fields = current;
    for (int i = 0; i < tagFields; ++i) {
        const auto field = TagField(i);
        if (wanted.field(field) != current.field(field))
            fields.setField(field, asRead(field, wanted.field(field)));
    }
    // By design: what is no identifier of ours is not written, the "y" of the Tags Processor
    // neither.
    if (!isOwn(fields.FileId()) && !(fields.FileId().isEmpty() && isOwn(current.FileId())))
        fields.setFileId(current.FileId());
    return fields;
}

SplicedTag splicedTag(const QByteArray &tag, const CddbID3Tag &current, const CddbID3Tag &wanted)
{
    const CddbID3Tag target = asRead(wanted, current);
    if (target == current)
        return {tag, false};
    const TagLayout layout = tag.isEmpty() ? TagLayout() : layoutOf(tag);
    Splicer splicer(tag, layout);
    // Blanks are read as nothing, yet their frame is not taken away: they say so to other programs.
    const auto toWrite = [&](TagField field) {
        const QString &text = target.field(field);
        const bool isBlank = text.isEmpty() && !wanted.field(field).isEmpty();
        return isBlank && field != TagField::FileId ? u" "_s : text;
    };
    for (int i = 0; i < tagFields; ++i) {
        const auto field = TagField(i);
        if (target.field(field) != current.field(field))
            splicer.replace(field, toWrite(field));
    }
    return {composed(tag, layout, splicer.frames()), true};
}
