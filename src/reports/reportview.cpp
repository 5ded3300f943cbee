#include "reports/reportview.h"

#include "reports/accessiblepage.h"

#include <QKeyEvent>
#include <QPaintEvent>
#include <QPainter>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QWheelEvent>

namespace
{

constexpr int gap = 16;    // around pages, in pixels
constexpr int line = 40;   // that an arrow key moves
constexpr int notch = 120; // of a wheel
constexpr double smallest = 0.1, largest = 4;
constexpr qint64 longest = std::numeric_limits<int>::max() / 2; // that scroll bars can count

} // namespace

ReportView::ReportView(QWidget *parent) : QAbstractScrollArea(parent)
{
    setFocusPolicy(Qt::StrongFocus);
    AccessiblePage::install();
    // One that came and went would change the width that pages are fitted to.
    setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
}

const std::vector<double> &ReportView::zoomSteps()
{
    static const std::vector<double> steps{0.25, 0.33, 0.5, 0.67, 0.75, 0.9, 1,
                                           1.1,  1.25, 1.5, 1.75, 2,    3,   4};
    return steps;
}

qsizetype ReportView::pageCount() const
{
    return mReport ? mReport->layout().pageCount() : 1;
}

void ReportView::setReport(const ReportPainter &report)
{
    mReport.emplace(report);
    layOut(mZoom == Zoom::Fixed ? mFactor : fittingFactor(), {});
    goToPage(mPage);
    viewport()->update();
}

double ReportView::pixelsPerUnit(double factor) const
{
    return factor * logicalDpiX() / ReportLayout::unitsPerInch;
}

double ReportView::fittingFactor() const
{
    if (!mReport)
        return 1;
    const QSizeF paper = mReport->layout().paperSize() * pixelsPerUnit(1);
    const QSize room = viewport()->size() - QSize(2 * gap, 2 * gap);
    const double across = room.width() / paper.width(), down = room.height() / paper.height();
    return mZoom == Zoom::FitWidth ? across : std::min(across, down);
}

QSize ReportView::pageSize() const
{
    return (mReport->layout().paperSize() * pixelsPerUnit(mFactor)).toSize();
}

int ReportView::stride() const
{
    return pageSize().height() + gap;
}

QRect ReportView::pageRect(qsizetype page) const
{
    const QSize size = pageSize();
    const int free = viewport()->width() - size.width() - 2 * gap;
    const int left = gap + (free > 0 ? free / 2 : -horizontalScrollBar()->value());
    return {QPoint(left, gap + int(page) * stride() - verticalScrollBar()->value()), size};
}

qsizetype ReportView::pageAt(int y) const
{
    const auto page = (qsizetype(verticalScrollBar()->value()) + y - gap) / stride();
    return std::clamp<qsizetype>(page, 0, pageCount() - 1);
}

// What is at a point of the viewport stays there.
void ReportView::layOut(double factor, QPoint about)
{
    if (!mReport)
        return;
    const QRect was = pageRect(pageAt(about.y()));
    const qsizetype page = pageAt(about.y());
    const double across = double(about.x() - was.left()) / was.width();
    const double down = double(about.y() - was.top()) / was.height();
    const double page1 = mReport->layout().paperSize().height() * pixelsPerUnit(1) + gap;
    const double most = double(longest) / (double(pageCount()) * page1);
    mFactor = std::clamp(factor, smallest, std::max(smallest, std::min(largest, most)));
    const QScopedValueRollback<bool> going(mGoing, true);
    setBars();
    const QRect now = pageRect(page);
    const auto move = [](QScrollBar *bar, double by) { bar->setValue(bar->value() + qRound(by)); };
    move(horizontalScrollBar(), now.left() + across * now.width() - about.x());
    move(verticalScrollBar(), now.top() + down * now.height() - about.y());
    viewport()->update();
    emit zoomChanged();
}

void ReportView::setBars()
{
    const QSize room = viewport()->size();
    const int wide = pageSize().width() + 2 * gap;
    const int high = int(pageCount()) * stride() + gap;
    horizontalScrollBar()->setRange(0, std::max(0, wide - room.width()));
    horizontalScrollBar()->setPageStep(room.width());
    horizontalScrollBar()->setSingleStep(line);
    verticalScrollBar()->setRange(0, std::max(0, high - room.height()));
    verticalScrollBar()->setPageStep(std::max(line, room.height() - line));
    verticalScrollBar()->setSingleStep(line);
}

void ReportView::setPage(qsizetype page)
{
    if (page == mPage)
        return;
    mPage = page;
    emit pageChanged();
    AccessiblePage::pageChanged(this);
}

void ReportView::goToPage(qsizetype page)
{
    const QScopedValueRollback<bool> going(mGoing, true);
    page = std::clamp<qsizetype>(page, 0, pageCount() - 1);
    if (mReport)
        verticalScrollBar()->setValue(int(page) * stride());
    setPage(page);
}

void ReportView::setZoom(Zoom zoom, double factor)
{
    mZoom = zoom;
    layOut(zoom == Zoom::Fixed ? factor : fittingFactor(), {viewport()->width() / 2, 0});
    if (zoom == Zoom::WholePage)
        goToPage(mPage);
}

void ReportView::zoomBy(int steps)
{
    zoomBy(steps, viewport()->rect().center());
}

void ReportView::zoomBy(int steps, QPoint about)
{
    constexpr double same = 0.005;
    double factor = mFactor;
    const auto &all = zoomSteps();
    for (; steps > 0; --steps) {
        const auto next = std::upper_bound(all.begin(), all.end(), factor + same);
        factor = next == all.end() ? factor : *next;
    }
    for (; steps < 0; ++steps) {
        const auto next = std::lower_bound(all.begin(), all.end(), factor - same);
        factor = next == all.begin() ? factor : *(next - 1);
    }
    mZoom = Zoom::Fixed;
    layOut(factor, about);
}

void ReportView::resizeEvent(QResizeEvent *)
{
    if (!mReport)
        return;
    layOut(mZoom == Zoom::Fixed ? mFactor : fittingFactor(), {});
    if (mZoom == Zoom::WholePage)
        goToPage(mPage);
}

void ReportView::scrollContentsBy(int dx, int dy)
{
    QAbstractScrollArea::scrollContentsBy(dx, dy);
    if (mGoing || !mReport || dy == 0)
        return;
    const bool atEnd = verticalScrollBar()->value() == verticalScrollBar()->maximum();
    setPage(atEnd ? pageCount() - 1 : pageAt(viewport()->height() / 2));
}

void ReportView::wheelEvent(QWheelEvent *event)
{
    if (!(event->modifiers() & Qt::ControlModifier)) {
        QAbstractScrollArea::wheelEvent(event);
        return;
    }
    mWheel += event->angleDelta().y();
    if (const int steps = mWheel / notch) {
        mWheel -= steps * notch;
        zoomBy(steps, event->position().toPoint());
    }
    event->accept();
}

void ReportView::keyPressEvent(QKeyEvent *event)
{
    const bool byPage = mZoom == Zoom::WholePage || event->modifiers() & Qt::ControlModifier;
    if (event->key() == Qt::Key_Home)
        goToPage(0);
    else if (event->key() == Qt::Key_End)
        verticalScrollBar()->setValue(verticalScrollBar()->maximum());
    else if (event->key() == Qt::Key_PageDown && byPage)
        goToPage(mPage + 1);
    else if (event->key() == Qt::Key_PageUp && byPage)
        goToPage(mPage - 1);
    else
        QAbstractScrollArea::keyPressEvent(event);
}

void ReportView::paintEvent(QPaintEvent *event)
{
    QPainter painter(viewport());
    const QColor desk = palette().color(QPalette::Window);
    painter.fillRect(event->rect(), desk.darker(desk.lightness() > 127 ? 116 : 135));
    if (!mReport)
        return;
    const qsizetype last = pageAt(event->rect().bottom());
    for (qsizetype page = pageAt(event->rect().top()); page <= last; ++page)
        paintPage(painter, page, event->rect());
}

void ReportView::paintPage(QPainter &painter, qsizetype page, const QRect &part) const
{
    const QRect sheet = pageRect(page);
    paintShadow(painter, sheet);
    const double scale = pixelsPerUnit(mFactor);
    const QRect shown = sheet.intersected(part);
    painter.fillRect(shown, Qt::white);
    painter.save();
    painter.setClipRect(shown);
    painter.translate(sheet.topLeft());
    painter.scale(scale, scale);
    mReport->paint(painter, page, painter.transform().inverted().mapRect(QRectF(shown)));
    painter.restore();
}

void ReportView::paintShadow(QPainter &painter, const QRect &page) const
{
    painter.setPen(Qt::NoPen);
    for (int reach = 6; reach >= 1; --reach) {
        painter.setBrush(QColor(0, 0, 0, 7));
        painter.drawRoundedRect(page.adjusted(-reach, 2 - reach, reach, reach + 2), reach, reach);
    }
}
