#pragma once

#include <QPageLayout>
#include <QRectF>

/// Where everything stands on the pages of a report. All lines have one height, so that the page of
/// a row is arithmetic: a report of a million rows is laid out at no cost, and each page is known
/// without those before it. Lengths are in twentieths of a point, from the upper left corner of the
/// paper; pages and rows are counted from 0. A report without rows has one page.
class ReportLayout
{
public:
    static constexpr int unitsPerInch = 1440;
    static constexpr double rowHeight = 270;

    ReportLayout() : ReportLayout(QPageLayout(), 0, false) {}
    ReportLayout(const QPageLayout &paper, qsizetype rowCount, bool columnHeads);

    QSizeF paperSize() const { return mPaper; }
    qsizetype rowCount() const { return mRowCount; }
    qsizetype rowsPerPage() const { return mRowsPerPage; }
    qsizetype pageCount() const;

    /// The rows of a page: from first, and not the one at end.
    struct Range {
        qsizetype first, end;
    };
    Range rowsOf(qsizetype page) const;

    QRectF printable() const { return mPrintable; } // within the margins
    QRectF caption() const { return mCaption; }
    QRectF columnHeads() const { return mHeads; } // of no height if there are none
    QRectF foot() const { return mFoot; }
    QRectF row(qsizetype line) const; // of the line of a page

private:
    QSizeF mPaper;
    QRectF mPrintable, mCaption, mHeads, mBody, mFoot;
    qsizetype mRowCount, mRowsPerPage;
};
