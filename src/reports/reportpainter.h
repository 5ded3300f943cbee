#pragma once

#include "reports/reportcontent.h"
#include "reports/reportlayout.h"

#include <QFont>
#include <memory>

class QPainter;

/// Paints the pages of a report, on the screen, on paper and into files alike: dark on white in
/// every palette. A text that is too long for its column is condensed until it fits its line.
class ReportPainter
{
public:
    ReportPainter(std::shared_ptr<const ReportContent> content, const ReportLayout &layout);

    /// Paints a page with its corner at the painter's origin, in the units of the layout; of the
    /// lines only those that touch this part.
    void paint(QPainter &painter, qsizetype page, const QRectF &part) const;
    void paint(QPainter &painter, qsizetype page) const;

    /// The same as text, line by line, cells with a tab between them.
    QString text(qsizetype page) const;

    const ReportContent &content() const { return *mContent; }
    const ReportLayout &layout() const { return mLayout; }

private:
    void paintHead(QPainter &painter) const;
    void paintFoot(QPainter &painter, qsizetype page) const;
    void paintRow(QPainter &painter, qsizetype row, qsizetype line) const;
    QRectF cell(QRectF line, std::size_t column) const;

    std::shared_ptr<const ReportContent> mContent;
    ReportLayout mLayout;
    QFont mText, mCaption, mHead, mFoot;
};
