#pragma once

#include <string>
#include <vector>

/// The parts of songcase-disc, the small program that asks libcdio: a process of its own, since the
/// library ends its process on damaged images, and a drive may keep it waiting.
///
/// It prints lines: "track NUMBER OFFSET audio|data" (frames, 150 added), "leadout OFFSET" and
/// "end", in this order; behind them what the disc says of itself (CD-Text), "text NUMBER
/// title|performer|genre|barcode TEXT", number 0 for the disc. Texts are UTF-8 without line ends.
namespace disc
{

enum class Result : int { Read = 0, Usage = 2, NotOpened = 3, NoTable = 4 };

Result printImage(const std::string &file); // of Nero, the only kind that libcdio reads itself
Result printDrive(const std::string &device);
Result printDrives(); // "drive DEVICE"

} // namespace disc
