#pragma once

#include <QByteArray>

// Tags made byte by byte.

inline QByteArray tagNumber(qsizetype number, int bits, int bytes = 4)
{
    QByteArray text;
    for (int shift = (bytes - 1) * bits; shift >= 0; shift -= bits)
        text.append(char((number >> shift) & ((1 << bits) - 1)));
    return text;
}

inline QByteArray frame(const char *id, const QByteArray &content, int version = 3)
{
    const QByteArray size = version == 2 ? tagNumber(content.size(), 8, 3)
                                         : tagNumber(content.size(), version == 4 ? 7 : 8);
    return id + size + QByteArray(version == 2 ? 0 : 2, '\0') + content;
}

inline QByteArray textFrame(const char *id, const QByteArray &latin1, int version = 3)
{
    return frame(id, '\0' + latin1, version);
}

inline QByteArray commentFrame(const QByteArray &description, const QByteArray &content,
                               int version = 3)
{
    return frame(version == 2 ? "COM" : "COMM",
                 QByteArray("\0eng", 4) + description + '\0' + content, version);
}

inline QByteArray fileIdFrame(const QByteArray &owner, const QByteArray &data, int version = 3)
{
    return frame(version == 2 ? "UFI" : "UFID", owner + '\0' + data, version);
}

/// `padding` zero bytes behind the frames.
inline QByteArray tagOf(const QByteArray &frames, int version = 3, qsizetype padding = 0,
                        char flags = 0)
{
    return QByteArray("ID3") + char(version) + '\0' + flags +
           tagNumber(frames.size() + padding, 7) + frames + QByteArray(padding, '\0');
}
