#pragma once

#include "reports/reportpainter.h"

#include <QAbstractScrollArea>
#include <optional>

/// The pages of a report below each other, to scroll and to zoom. Nothing is kept of a page: those
/// that show are painted, however many there are.
class ReportView : public QAbstractScrollArea
{
    Q_OBJECT

public:
    enum class Zoom { FitWidth, WholePage, Fixed };

    explicit ReportView(QWidget *parent = nullptr);

    /// The place in the report is kept as far as there is one.
    void setReport(const ReportPainter &report);

    /// Counted from 0: the page that takes the middle, or the one gone to last.
    qsizetype currentPage() const { return mPage; }
    qsizetype pageCount() const;
    void goToPage(qsizetype page);

    /// What stands on the current page, line by line.
    QString pageText() const { return mReport ? mReport->text(mPage) : QString(); }

    /// The steps of the zoom, and how large a page shows now; 1 is the size of the paper.
    static const std::vector<double> &zoomSteps();
    double factor() const { return mFactor; }
    Zoom zoom() const { return mZoom; }
    void setZoom(Zoom zoom, double factor = 1);
    void zoomBy(int steps); // to larger ones, or to smaller ones below 0

signals:
    void pageChanged();
    void zoomChanged();

protected:
    void paintEvent(QPaintEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;
    void scrollContentsBy(int dx, int dy) override;
    void wheelEvent(QWheelEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    double pixelsPerUnit(double factor) const;
    double fittingFactor() const;
    QSize pageSize() const; // in pixels
    int stride() const;
    QRect pageRect(qsizetype page) const; // in the viewport
    qsizetype pageAt(int y) const;
    void layOut(double factor, QPoint about);
    void setBars();
    void setPage(qsizetype page);
    void zoomBy(int steps, QPoint about);
    void paintPage(QPainter &painter, qsizetype page, const QRect &part) const;
    void paintShadow(QPainter &painter, const QRect &page) const;

    std::optional<ReportPainter> mReport;
    Zoom mZoom = Zoom::FitWidth;
    double mFactor = 1;
    qsizetype mPage = 0;
    int mWheel = 0; // turned, but not yet a step
    bool mGoing = false;
};
