#pragma once

#include "reports/reportpainter.h"

#include <QPageLayout>
#include <functional>

class QPrinter;

/// The ways of a report onto paper and into a file.
namespace reportoutput
{

enum class Outcome { Done, Cancelled, Failed };
struct Result {
    Outcome outcome = Outcome::Done;
    QString reason; // of a failure, in words of the system; may be empty
};

/// Is told after each page how many are done; false stops there.
using Progress = std::function<bool(qsizetype done, qsizetype all)>;

/// Writes all pages into a PDF file. It takes its name when it is whole; one that stands there
/// already stays as it is until then.
Result writePdf(const QString &name, const ReportPainter &report, const QPageLayout &paper,
                const Progress &progress);

/// Prints the pages that were chosen for this printer, on the paper that it is set to.
Result print(QPrinter &printer, const std::shared_ptr<const ReportContent> &content,
             qsizetype currentPage, const Progress &progress);

} // namespace reportoutput
