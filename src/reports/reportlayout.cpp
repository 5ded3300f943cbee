#include "reports/reportlayout.h"

#include <algorithm>

namespace
{

constexpr double unitsPerPoint = ReportLayout::unitsPerInch / 72.0;
constexpr double captionHeight = 500, headsHeight = 340, footHeight = 360, gap = 120;

QRectF inUnits(const QRectF &points)
{
    return {points.topLeft() * unitsPerPoint, points.size() * unitsPerPoint};
}

} // namespace

ReportLayout::ReportLayout(const QPageLayout &paper, qsizetype rowCount, bool columnHeads)
    : mRowCount(rowCount)
{
    const QRectF sheet = paper.fullRect(QPageLayout::Point);
    mPaper = inUnits(sheet).size();
    mPrintable = inUnits(sheet.marginsRemoved(paper.margins(QPageLayout::Point)));
    mCaption = {mPrintable.topLeft(), QSizeF(mPrintable.width(), captionHeight)};
    mHeads = {mCaption.bottomLeft(), QSizeF(mPrintable.width(), columnHeads ? headsHeight : 0)};
    mFoot = {mPrintable.left(), mPrintable.bottom() - footHeight, mPrintable.width(), footHeight};
    mBody = {QPointF(mPrintable.left(), mHeads.bottom() + gap),
             QPointF(mPrintable.right(), mFoot.top())};
    mRowsPerPage = std::max<qsizetype>(1, qsizetype(mBody.height() / rowHeight));
}

qsizetype ReportLayout::pageCount() const
{
    return std::max<qsizetype>(1, (mRowCount + mRowsPerPage - 1) / mRowsPerPage);
}

ReportLayout::Range ReportLayout::rowsOf(qsizetype page) const
{
    const qsizetype first = page * mRowsPerPage;
    return {first, std::min(first + mRowsPerPage, mRowCount)};
}

QRectF ReportLayout::row(qsizetype line) const
{
    return {mBody.left(), mBody.top() + double(line) * rowHeight, mBody.width(), rowHeight};
}
