#include "reports/reportpainter.h"

#include <QFontMetricsF>
#include <QPainter>
#include <QTextLayout>

using namespace Qt::StringLiterals;

namespace
{

// In twentieths of a point.
constexpr int textSize = 190, captionSize = 340, headSize = 160, footSize = 160;
constexpr double ruleWidth = 15, hairline = 8, columnGap = 200;

constexpr QRgb ink = 0xff1d2127, softInk = 0xff8b949e, headInk = 0xff5b6570;
constexpr QRgb ruleInk = 0xff3487d6, hairlineInk = 0xffdde2e7;

// How narrow letters may become before they become smaller, too.
constexpr double narrowest = 0.7;

// Unhinted: the widths must be the same in every size and on every device. The trace of spacing
// keeps letters apart that a font would join: an "fi" must be found again in a PDF file.
QFont fontOf(int size, QFont::Weight weight = QFont::Normal)
{
    QFont font;
    font.setFamilies({u"Arial"_s, u"Liberation Sans"_s, u"DejaVu Sans"_s});
    font.setStyleHint(QFont::SansSerif);
    font.setPixelSize(size);
    font.setWeight(weight);
    font.setHintingPreference(QFont::PreferNoHinting);
    font.setLetterSpacing(QFont::AbsoluteSpacing, 0.05);
    return font;
}

// On one line at the side of the box, whole, whatever its length.
void drawText(QPainter &painter, const QString &text, const QFont &font, const QRectF &box,
              Qt::AlignmentFlag side = Qt::AlignLeft)
{
    QTextOption option(Qt::AlignLeft | Qt::AlignAbsolute);
    option.setWrapMode(QTextOption::NoWrap);
    QTextLayout layout(text, font);
    layout.setTextOption(option);
    layout.beginLayout();
    QTextLine line = layout.createLine();
    layout.endLayout();
    if (!line.isValid())
        return;
    const double width = line.naturalTextWidth();
    const double wide = width > box.width() ? box.width() / width : 1;
    const double high = std::min(1.0, wide / narrowest);
    const QFontMetricsF metrics(font);
    const double base = box.center().y() + (metrics.capHeight() * high) / 2;
    const double left = side == Qt::AlignRight  ? box.right() - width * wide
                        : side == Qt::AlignLeft ? box.left()
                                                : box.center().x() - width * wide / 2;
    painter.save();
    painter.translate(left, base);
    painter.scale(wide, high);
    layout.draw(&painter, {0, -line.ascent()});
    painter.restore();
}

void drawRule(QPainter &painter, double left, double right, double y, double width, QRgb colour)
{
    painter.setPen(QPen(QColor(colour), width, Qt::SolidLine, Qt::FlatCap));
    painter.drawLine(QPointF(left, y), QPointF(right, y));
}

} // namespace

ReportPainter::ReportPainter(std::shared_ptr<const ReportContent> content,
                             const ReportLayout &layout)
    : mContent(std::move(content)),
      mLayout(layout),
      mText(fontOf(textSize)),
      mCaption(fontOf(captionSize, QFont::Bold)),
      mHead(fontOf(headSize, QFont::Bold)),
      mFoot(fontOf(footSize))
{
}

void ReportPainter::paint(QPainter &painter, qsizetype page) const
{
    paint(painter, page, QRectF({}, mLayout.paperSize()));
}

void ReportPainter::paint(QPainter &painter, qsizetype page, const QRectF &part) const
{
    painter.setRenderHint(QPainter::Antialiasing, false);
    paintHead(painter);
    const auto rows = mLayout.rowsOf(page);
    for (qsizetype row = rows.first; row < rows.end; ++row) {
        const qsizetype line = row - rows.first;
        if (mLayout.row(line).intersects(part))
            paintRow(painter, row, line);
    }
    paintFoot(painter, page);
}

QString ReportPainter::text(qsizetype page) const
{
    QStringList lines{mContent->caption()};
    const auto addLine = [&](auto &&cellOf) {
        QStringList cells;
        for (const auto &column : mContent->columns())
            cells.append(cellOf(column));
        lines.append(cells.join(u'\t'));
    };
    if (mLayout.columnHeads().height() > 0)
        addLine([](const auto &column) { return column.head; });
    const auto rows = mLayout.rowsOf(page);
    for (qsizetype row = rows.first; row < rows.end; ++row)
        addLine([&](const auto &column) { return mContent->text(row, column); });
    lines += {mContent->date(), mContent->count(), mContent->pageOf(page, mLayout.pageCount())};
    return lines.join(u'\n');
}

void ReportPainter::paintHead(QPainter &painter) const
{
    const QRectF caption = mLayout.caption(), heads = mLayout.columnHeads();
    painter.setPen(QColor(ink));
    drawText(painter, mContent->caption(), mCaption, caption.adjusted(0, 0, 0, -100));
    drawRule(painter, caption.left(), caption.right(), caption.bottom(), ruleWidth, ruleInk);
    if (heads.height() == 0)
        return;
    painter.setPen(QColor(headInk));
    for (std::size_t i = 0; i < mContent->columns().size(); ++i)
        drawText(painter, mContent->columns()[i].head, mHead, cell(heads.adjusted(0, 60, 0, 0), i));
}

void ReportPainter::paintRow(QPainter &painter, qsizetype row, qsizetype line) const
{
    const QRectF box = mLayout.row(line);
    const bool repeated = line > 0 && mContent->repeatsArtist(row);
    if (!repeated && (line > 0 || mContent->hasArtists()))
        drawRule(painter, box.left(), box.right(), box.top(), hairline, hairlineInk);
    for (std::size_t i = 0; i < mContent->columns().size(); ++i) {
        const bool soft = repeated && i == 0;
        painter.setPen(QColor(soft ? softInk : ink));
        drawText(painter, mContent->text(row, mContent->columns()[i]), mText, cell(box, i));
    }
}

void ReportPainter::paintFoot(QPainter &painter, qsizetype page) const
{
    const QRectF foot = mLayout.foot();
    drawRule(painter, foot.left(), foot.right(), foot.top() + 90, hairline, ruleInk);
    painter.setPen(QColor(headInk));
    const double third = foot.width() / 3;
    const QRectF box(foot.left(), foot.top() + 130, third, foot.height() - 130);
    drawText(painter, mContent->date(), mFoot, box);
    drawText(painter, mContent->count(), mFoot, box.translated(third, 0), Qt::AlignHCenter);
    drawText(painter, mContent->pageOf(page, mLayout.pageCount()), mFoot,
             box.translated(2 * third, 0), Qt::AlignRight);
}

QRectF ReportPainter::cell(QRectF line, std::size_t column) const
{
    double left = line.left();
    for (std::size_t i = 0; i < column; ++i)
        left += mContent->columns()[i].share * line.width();
    const double width = mContent->columns()[column].share * line.width();
    const bool last = column + 1 == mContent->columns().size();
    return {left, line.top(), last ? width : width - columnGap, line.height()};
}
