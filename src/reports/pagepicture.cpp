#include "reports/pagepicture.h"

#include "reports/reportpainter.h"

#include <QPainter>

namespace
{

constexpr QSizeF largestPaper(11 * ReportLayout::unitsPerInch, 17 * ReportLayout::unitsPerInch);
constexpr QRgb marginInk = 0x803487d6;

} // namespace

void PagePicture::setReport(std::shared_ptr<const ReportContent> content)
{
    mContent = std::move(content);
    update();
}

void PagePicture::setPaper(const QPageLayout &paper)
{
    mPaper = paper;
    update();
}

// Large paper is larger in the picture, too, though not as much as it is on the desk.
void PagePicture::paintEvent(QPaintEvent *)
{
    if (!mContent)
        return;
    const ReportLayout layout(mPaper, mContent->rowCount(), mContent->hasArtists());
    const QSizeF paper = layout.paperSize();
    const double most = std::min((width() - 4) / paper.width(), (height() - 4) / paper.height());
    const double share = std::max(paper.width(), paper.height()) / largestPaper.height();
    const double scale = most * std::min(1.0, 0.55 + 0.45 * share);
    const QSize size = (paper * scale).toSize();
    const QRect sheet({(width() - size.width()) / 2, (height() - size.height()) / 2}, size);
    QPainter painter(this);
    painter.fillRect(sheet.translated(2, 2), QColor(0, 0, 0, 50));
    painter.fillRect(sheet, Qt::white);
    painter.setClipRect(sheet);
    painter.translate(sheet.topLeft());
    painter.scale(scale, scale);
    ReportPainter(mContent, layout).paint(painter, 0);
    painter.setPen(QPen(QColor::fromRgba(marginInk), 0, Qt::DashLine));
    painter.drawRect(layout.printable());
}
