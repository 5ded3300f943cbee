#include "tags/taglayout.h"

#include "tags/tagerrors.h"

#include <algorithm>
#include <cstring>

namespace
{

constexpr char flagUnsynchronised = char(0x80), flagExtended = 0x40, flagFooter = 0x10;
constexpr qsizetype lengthOfSize = 4;

[[noreturn]] void damaged()
{
    throw tagError(errTagDamaged, "xTagDamaged", {});
}

// Walks through the bytes of a tag as they were before they were unsynchronised.
class Cursor
{
public:
    Cursor(const QByteArray &tag, qsizetype from, qsizetype to, bool stuffed)
        : mTag(tag), mAt(from), mTo(to), mStuffed(stuffed)
    {
    }
    qsizetype at() const { return mAt; }
    bool atEnd() const { return mAt >= mTo; }
    char next() const { return mTag[mAt]; }

    QByteArray take(qsizetype count)
    {
        const qsizetype from = mAt;
        skip(count);
        return between(from, mAt);
    }

    void skip(qsizetype count)
    {
        if (count > mTo - mAt)
            damaged();
        if (!mStuffed) {
            mAt += count;
            return;
        }
        for (; count > 0; --count) {
            if (mAt >= mTo)
                damaged();
            const bool isStuffed = mTag[mAt] == char(0xFF) && mAt + 1 < mTo && mTag[mAt + 1] == 0;
            mAt += isStuffed ? 2 : 1;
        }
    }

    QByteArray between(qsizetype from, qsizetype to) const
    {
        QByteArray bytes = mTag.mid(from, to - from);
        if (mStuffed)
            bytes.replace(QByteArray::fromRawData("\xFF\0", 2), QByteArray::fromRawData("\xFF", 1));
        return bytes;
    }

private:
    const QByteArray &mTag;
    qsizetype mAt, mTo;
    bool mStuffed;
};

bool isFrameId(QByteArrayView id)
{
    return id.size() >= 3 && std::all_of(id.begin(), id.end(), [](char c) {
               return (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9');
           });
}

// Some programs write sizes of version 2.4 in eight bits a byte, as 2.3 has them: taken so where
// only that leads to another frame.
qsizetype sizeInVersion4(const QByteArray &tag, qsizetype behindHeader, QByteArrayView bytes)
{
    const qsizetype seven = sevenBitNumber(bytes), eight = eightBitNumber(bytes);
    const auto leadsToFrame = [&](qsizetype size) {
        const qsizetype behind = behindHeader + size;
        return behind + 4 <= tag.size() && isFrameId(QByteArrayView(tag).sliced(behind, 4));
    };
    return seven > 127 && !leadsToFrame(seven) && leadsToFrame(eight) ? eight : seven;
}

bool isPlain(int version, QByteArrayView flags)
{
    return version == 2 || (flags[1] & (version == 3 ? 0xE0 : 0x4F)) == 0;
}

TagFrame takeFrame(Cursor &cursor, const QByteArray &tag, int version)
{
    TagFrame frame;
    frame.from = cursor.at();
    const int letters = version == 2 ? 3 : 4;
    frame.id = cursor.take(letters);
    if (!isFrameId(frame.id))
        damaged();
    const QByteArray size = cursor.take(letters);
    if (version > 2)
        frame.isPlain = isPlain(version, cursor.take(2));
    frame.content = cursor.at();
    const qsizetype length =
        version == 4 ? sizeInVersion4(tag, frame.content, size) : eightBitNumber(size);
    if (length == 0)
        damaged();
    cursor.skip(length);
    frame.to = cursor.at();
    return frame;
}

void takeExtendedHeader(Cursor &cursor, TagLayout &layout)
{
    const QByteArray size = cursor.take(lengthOfSize);
    const qsizetype rest =
        layout.version == 4 ? sevenBitNumber(size) - lengthOfSize : eightBitNumber(size);
    if (rest < 0)
        damaged();
    cursor.skip(rest);
    layout.extended = cursor.at() - tagHeader;
}

} // namespace

qsizetype sevenBitNumber(QByteArrayView bytes)
{
    qsizetype number = 0;
    for (const char byte : bytes)
        number = (number << 7) | (byte & 0x7F);
    return number;
}

qsizetype eightBitNumber(QByteArrayView bytes)
{
    qsizetype number = 0;
    for (const char byte : bytes)
        number = (number << 8) | uchar(byte);
    return number;
}

QByteArray sevenBitBytes(qsizetype number)
{
    QByteArray bytes;
    for (int shift = 21; shift >= 0; shift -= 7)
        bytes += char((number >> shift) & 0x7F);
    return bytes;
}

QByteArray eightBitBytes(qsizetype number, int count)
{
    QByteArray bytes;
    for (int shift = 8 * (count - 1); shift >= 0; shift -= 8)
        bytes += char((number >> shift) & 0xFF);
    return bytes;
}

QByteArray unsynchronised(const QByteArray &bytes)
{
    QByteArray result;
    for (qsizetype i = 0; i < bytes.size(); ++i) {
        result += bytes[i];
        const bool isLast = i + 1 == bytes.size();
        if (bytes[i] == char(0xFF) &&
            (isLast || bytes[i + 1] == 0 || (bytes[i + 1] & 0xE0) == 0xE0))
            result += '\0';
    }
    return result;
}

qsizetype tagSize(QByteArrayView header)
{
    if (header.size() < tagHeader || !header.startsWith("ID3"))
        return 0;
    const char version = header[3];
    const auto isSevenBit = [](char byte) { return (byte & 0x80) == 0; };
    if (version < 2 || version > 4 ||
        !std::all_of(header.begin() + 6, header.begin() + 10, isSevenBit))
        return 0;
    const bool hasFooter = version == 4 && (header[5] & flagFooter);
    return tagHeader + sevenBitNumber(header.sliced(6, 4)) + (hasFooter ? tagHeader : 0);
}

TagLayout layoutOf(const QByteArray &tag)
{
    TagLayout layout;
    if (tagSize(tag) != tag.size())
        damaged();
    layout.version = uchar(tag[3]);
    const char flags = tag[5];
    layout.isUnsynchronised = layout.version < 4 && (flags & flagUnsynchronised);
    layout.hasFooter = layout.version == 4 && (flags & flagFooter);
    if (layout.version == 2 && (flags & flagExtended)) // there it means compressed
        damaged();
    const qsizetype end = tag.size() - (layout.hasFooter ? tagHeader : 0);
    Cursor cursor(tag, tagHeader, end, layout.isUnsynchronised);
    if (layout.version > 2 && (flags & flagExtended))
        takeExtendedHeader(cursor, layout);
    while (!cursor.atEnd() && cursor.next() != 0)
        layout.frames.push_back(takeFrame(cursor, tag, layout.version));
    if (!std::all_of(tag.begin() + cursor.at(), tag.begin() + end, [](char c) { return c == 0; }))
        damaged();
    return layout;
}

QByteArray TagLayout::contentOf(const QByteArray &tag, const TagFrame &frame) const
{
    return Cursor(tag, 0, tag.size(), isUnsynchronised).between(frame.content, frame.to);
}
