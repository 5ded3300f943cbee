#pragma once

#include <QByteArray>
#include <vector>

/// A frame as it stands in the bytes of a tag, its own header included.
struct TagFrame {
    QByteArray id; // three letters in version 2.2, else four
    qsizetype from = 0, content = 0, to = 0;
    bool isPlain = true; // neither compressed, encrypted, grouped nor unsynchronised by itself
};

/// How an ID3v2 tag (2.2, 2.3, 2.4; id3.org) is laid out.
struct TagLayout {
    int version = 3; // 2, 3 or 4
    bool isUnsynchronised =
        false; // as a whole, as versions 2.2 and 2.3 are: each FF has a 00 behind it
    bool hasFooter = false;
    qsizetype extended = 0; // bytes of the extended header, behind the header
    std::vector<TagFrame> frames;

    /// What a frame holds, in the words of the tag.
    QByteArray contentOf(const QByteArray &tag, const TagFrame &frame) const;
};

inline constexpr qsizetype tagHeader = 10; // bytes

/// Bytes of the tag that begins with these ten, its header and footer included; 0 if none does.
qsizetype tagSize(QByteArrayView header);

/// Throws Error (errTagDamaged) for a tag that is not whole: frames that lie about their size, that
/// have no name, or something else than padding behind the last one.
TagLayout layoutOf(const QByteArray &tag);

/// Numbers in seven bits a byte, and in eight, highest first.
qsizetype sevenBitNumber(QByteArrayView bytes);
qsizetype eightBitNumber(QByteArrayView bytes);
QByteArray sevenBitBytes(qsizetype number); // four
QByteArray eightBitBytes(qsizetype number, int count);

/// Each FF with a 00 behind it where another reader could take it for sound.
QByteArray unsynchronised(const QByteArray &bytes);
