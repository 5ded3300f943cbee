#include "fuzz/fuzz.h"
#include "platform/error/error.h"
#include "support/madetag.h"
#include "tags/tagfields.h"
#include "tags/tagsplicer.h"

using namespace Qt::StringLiterals;

namespace
{

// The frames that are not the field's, as bytes.
QByteArrayList others(TagField field, const QByteArray &tag, const TagLayout &layout)
{
    QByteArrayList frames;
    for (const TagFrame &frame : layout.frames) {
        if (!isFrameOf(field, frame, tag, layout))
            frames.append(tag.sliced(frame.from, frame.to - frame.from));
    }
    return frames;
}

// Behind the tag of this size stands what no tag is allowed to touch.
void splice(const QByteArray &input, const QByteArray &value)
{
    const qsizetype size = tagSize(input);
    if (size == 0 || size > input.size())
        return;
    const QByteArray tag = input.first(size);
    const TagLayout layout = layoutOf(tag);
    const auto fields = fieldsOf(tag, layout);
    if (!fields)
        return;
    const auto field = TagField(value.size() % tagFields);
    CddbID3Tag wanted = *fields;
    wanted.setField(field, QString::fromUtf8(value));
    const SplicedTag spliced = splicedTag(tag, *fields, wanted);
    fuzz::must(tagSize(spliced.bytes) == spliced.bytes.size(),
               "a tag of another size than it says");
    const TagLayout after = layoutOf(spliced.bytes);
    fuzz::must(fieldsOf(spliced.bytes, after) == asRead(wanted, *fields),
               "read other than written");
    const QByteArrayList kept = others(field, tag, layout);
    fuzz::must(others(field, spliced.bytes, after) == kept, "a foreign frame is not what it was");
}

fuzz::Target tags(
    "tag",
    [] {
        const QByteArray frames = textFrame("TIT2", "Title") + textFrame("TCON", "(17)(18)Rock") +
                                  frame("TPE1", "\1\xFF\xFE\x41\0\0\0\xFF\xFE\x42\0"_ba) +
                                  commentFrame("iTunNORM", "00") + commentFrame("", "mine") +
                                  fileIdFrame("http://x", "ab") +
                                  frame("APIC", "\xFF\xE0\xFF\0"_ba);
        const QByteArray later = textFrame("TDRC", "1985-05", 4) +
                                 frame("TPE1", "\3\xC3\xA9\0\xC3\xA8"_ba, 4) +
                                 fileIdFrame("songcase", "ab", 4);
        return fuzz::Inputs{
            tagOf(frames, 3, 40) + "|Été"_ba,
            tagOf(unsynchronised(frames), 3, 9, char(0x80)) + "|€uro"_ba,
            tagOf(later, 4, 20) + "|(18)x",
            tagOf("\0\0\0\x0E\1\x30\5\1\1\1\1\1\1\x40"_ba + later, 4, 20, 0x40) + "|songcase=01",
            tagOf(textFrame("TT2", "Title", 2) + commentFrame("", "x", 2), 2, 12) + "|07/09"};
    },
    [](const QByteArray &input) {
        const auto at = input.lastIndexOf('|');
        try {
            splice(input.left(at), at < 0 ? QByteArray() : input.mid(at + 1));
        } catch (const Error &) { // damaged
        }
    });

} // namespace
