#pragma once

#include "discs/discsheet.h"

#include <QByteArrayView>

/// Reads a cue sheet. Files of raw sectors and of sound may follow each other; the silence of
/// PREGAP and POSTGAP and the gap between sessions count. Nothing from bytes that are no cue sheet,
/// or whose table no disc can have.
std::optional<DiscSheet> readCueSheet(QByteArrayView bytes, const LengthOfFile &lengthOf);
