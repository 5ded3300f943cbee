#include "reports/reportcontent.h"

#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "services/messages.h"

namespace
{

constexpr double artistShare = 0.4;

bool breaksLine(QChar c)
{
    const auto category = c.category();
    return category == QChar::Other_Control || category == QChar::Separator_Line ||
           category == QChar::Separator_Paragraph;
}

} // namespace

QLocale reportLocale()
{
    const auto language = gLanguage == languageDutch ? QLocale::Dutch : QLocale::English;
    const QLocale system = QLocale::system();
    return system.language() == language ? system : QLocale(language);
}

ReportContent::ReportContent(const ADODB::Recordset &recordset, const QString &caption, QDate date)
    : mRows(recordset.rows()),
      mCaption(caption),
      mDate(reportLocale().toString(date, QLocale::LongFormat))
{
    const auto title = recordset.columnOf(u"titel");
    const bool artists = recordset.fieldCount() > 1;
    if (artists)
        mColumns.push_back({GetMessage("Artiest"), recordset.columnOf(u"artiest"), artistShare});
    mColumns.push_back({GetMessage("Titel"), title, artists ? 1 - artistShare : 1});
}

QString ReportContent::text(qsizetype row, const Column &column) const
{
    QString text = mRows->text(row, column.index);
    if (std::any_of(text.cbegin(), text.cend(), breaksLine))
        std::replace_if(text.begin(), text.end(), breaksLine, QChar(u' '));
    return text;
}

bool ReportContent::repeatsArtist(qsizetype row) const
{
    const int artist = mColumns.front().index;
    return hasArtists() && row > 0 && mRows->text(row, artist) == mRows->text(row - 1, artist);
}

QString ReportContent::count() const
{
    return GetMessage("xReportLines") + reportLocale().toString(rowCount());
}

QString ReportContent::pageOf(qsizetype page, qsizetype pageCount) const
{
    const QLocale locale = reportLocale();
    return GetMessage("xReportPage") + locale.toString(page + 1) + GetMessage("xReportOf") +
           locale.toString(pageCount);
}
