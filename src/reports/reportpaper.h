#pragma once

#include <QPageLayout>
#include <vector>

/// The paper that reports are printed on: what the user has set up last is remembered in the
/// settings. Margins are whole millimetres.
namespace reportpaper
{

struct Size {
    QPageSize::PageSizeId id;
    const char *name; // on the screen and in the settings
};
const std::vector<Size> &sizes();

constexpr int smallestMargin = 5;

/// A quarter of this side of the paper, so that lines have room between any two margins.
int largestMargin(double side);

/// A full page of this size with margins within the limits.
QPageLayout layout(QPageSize::PageSizeId size, QPageLayout::Orientation orientation,
                   const QMargins &margins);

QPageLayout stored(); // what cannot be used is replaced by the default
void store(const QPageLayout &paper);

} // namespace reportpaper
