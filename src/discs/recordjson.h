#pragma once

#include "discs/discrecord.h"

#include <QByteArray>
#include <optional>

/// Records as bytes for a file of the program's own, and back; nothing from damaged bytes.
QByteArray toJson(const std::vector<DiscRecord> &records);
std::optional<std::vector<DiscRecord>> recordsFromJson(const QByteArray &json);
