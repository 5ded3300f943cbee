#pragma once

#include "discs/discsheet.h"

#include <QByteArrayView>

/// Reads a text as cdrdao writes it (.toc). Nothing from bytes that are none, or whose table no
/// disc can have.
std::optional<DiscSheet> readTocSheet(QByteArrayView bytes, const LengthOfFile &lengthOf);
