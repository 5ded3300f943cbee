#pragma once

#include "tags/CddbID3Tag.h"
#include "tags/taglayout.h"

#include <optional>

/// The fields of a tag as they stand in its frames; nothing where a frame of one of them is
/// compressed, encrypted or the like.
std::optional<CddbID3Tag> fieldsOf(const QByteArray &tag, const TagLayout &layout);

/// A field as a tag that holds it will be read: without blanks around, numbers without zeros before
/// them, the year of four digits, the name of a genre.
QString asRead(TagField field, const QString &text);

/// The name of a field's frame in a version. The year has two, the one that is written first.
QByteArray frameOf(TagField field, int version);
QByteArray otherYearFrame(int version);

/// Whether a frame holds the field: one that has a text of its own purpose, a described comment or
/// the identifier of another program, does not.
bool isFrameOf(TagField field, const TagFrame &frame, const QByteArray &tag,
               const TagLayout &layout);
