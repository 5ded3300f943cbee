#pragma once

#include "platform/ado/rows.h"

#include <QDate>
#include <QLocale>
#include <memory>
#include <vector>

namespace ADODB
{
class Recordset;
}

/// What a report prints: a caption above rows of an artist and a title, or of a title alone, in the
/// language of the run. It shares the rows with the recordset that they came from and never
/// changes, so that a long print goes on with what it began with.
class ReportContent
{
public:
    struct Column {
        QString head;
        int index;    // in the rows
        double share; // of the width
    };

    /// The columns are the recordset's fields "artiest" and "titel"; throws errItemNotFound if it
    /// has no titles.
    ReportContent(const ADODB::Recordset &recordset, const QString &caption, QDate date);

    const QString &caption() const { return mCaption; }
    const std::vector<Column> &columns() const { return mColumns; }
    bool hasArtists() const { return mColumns.size() > 1; }
    qsizetype rowCount() const { return mRows->rowCount(); }

    /// The text of a cell as it stands on its one line: signs that would break it are blanks.
    QString text(qsizetype row, const Column &column) const;

    /// Whether the row has the artist of the one before it.
    bool repeatsArtist(qsizetype row) const;

    // What stands at the foot of the page of this index.
    QString date() const { return mDate; }
    QString count() const;
    QString pageOf(qsizetype page, qsizetype pageCount) const;

private:
    std::shared_ptr<const ADODB::Rows> mRows;
    std::vector<Column> mColumns;
    QString mCaption, mDate;
};

/// How numbers and dates are written in the language of the run: as the user's own country does if
/// that is its language.
QLocale reportLocale();
