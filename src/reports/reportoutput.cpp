#include "reports/reportoutput.h"

#include "platform/files/wholefile.h"
#include "services/messages.h"

#include <QPainter>
#include <QPdfWriter>
#include <QPrinter>
#include <algorithm>
#include <numeric>

namespace reportoutput
{

namespace
{

Result failed()
{
    return {Outcome::Failed, {}};
}

std::vector<qsizetype> allPages(const ReportLayout &layout)
{
    std::vector<qsizetype> pages(std::size_t(layout.pageCount()));
    std::iota(pages.begin(), pages.end(), 0);
    return pages;
}

std::vector<qsizetype> chosenPages(const QPrinter &printer, const ReportLayout &layout,
                                   qsizetype currentPage)
{
    if (printer.printRange() == QPrinter::CurrentPage)
        return {std::min(currentPage, layout.pageCount() - 1)};
    auto pages = allPages(layout);
    const QPageRanges ranges = printer.pageRanges();
    if (!ranges.isEmpty())
        std::erase_if(pages, [&](qsizetype page) { return !ranges.contains(int(page) + 1); });
    if (printer.pageOrder() == QPrinter::LastPageFirst)
        std::reverse(pages.begin(), pages.end());
    return pages;
}

// The device ends what it has begun before this returns.
Result paintPages(QPagedPaintDevice &device, const std::vector<qsizetype> &pages,
                  const ReportPainter &report, const std::function<bool()> &isWell,
                  const Progress &progress)
{
    QPainter painter;
    if (!painter.begin(&device))
        return failed();
    const double scale = device.logicalDpiX() / double(ReportLayout::unitsPerInch);
    qsizetype done = 0;
    for (const qsizetype page : pages) {
        if (done > 0 && !device.newPage())
            return failed();
        painter.save();
        painter.scale(scale, scale);
        report.paint(painter, page);
        painter.restore();
        if (!isWell())
            return failed();
        if (!progress(++done, qsizetype(pages.size())))
            return {Outcome::Cancelled, {}};
    }
    return painter.end() ? Result() : failed();
}

} // namespace

Result writePdf(const QString &name, const ReportPainter &report, const QPageLayout &paper,
                const Progress &progress)
{
    WholeFile file(name);
    if (!file.open(QIODevice::WriteOnly))
        return {Outcome::Failed, file.errorString()};
    QPdfWriter writer(&file);
    writer.setResolution(ReportLayout::unitsPerInch);
    writer.setPageLayout(paper);
    writer.setTitle(report.content().caption());
    writer.setCreator(GetMessage("MainScreen.Caption"));
    const auto isWell = [&file] { return file.reason().isEmpty(); };
    Result result = paintPages(writer, allPages(report.layout()), report, isWell, progress);
    if (result.outcome == Outcome::Done && !file.commit())
        result.outcome = Outcome::Failed;
    if (result.outcome == Outcome::Failed)
        result.reason = file.reason();
    return result;
}

Result print(QPrinter &printer, const std::shared_ptr<const ReportContent> &content,
             qsizetype currentPage, const Progress &progress)
{
    printer.setFullPage(true);
    printer.setDocName(content->caption());
    printer.setCreator(GetMessage("MainScreen.Caption"));
    const ReportLayout layout(printer.pageLayout(), content->rowCount(), content->hasArtists());
    const auto isWell = [&printer] { return printer.printerState() != QPrinter::Error; };
    return paintPages(printer, chosenPages(printer, layout, currentPage),
                      ReportPainter(content, layout), isWell, progress);
}

} // namespace reportoutput
