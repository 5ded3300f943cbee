#pragma once

#include "mp3/collectionrow.h"
#include "support/screentest.h"

/// A test of what is done with rows of a collection, whose screen it has.
class RowsTest : public ScreenTest
{
    Q_OBJECT

protected slots:
    void init()
    {
        ScreenTest::init();
        mScreen = new Form(u"frmCDRootMP3"_s);
        mScreen->Load();
    }

protected:
    /// A row for each line, its fields parted by "|"; numbered from `first` on.
    static std::vector<CollectionRow> rowsOf(const QString &lines,
                                             const std::vector<CollectionField> &fields, int first)
    {
        std::vector<CollectionRow> rows;
        for (const QString &line : lines.split(u'\n', Qt::SkipEmptyParts)) {
            CollectionRow &row = rows.emplace_back();
            row.index = first++;
            const QStringList cells = line.split(u'|');
            for (qsizetype cell = 0; const auto field : fields)
                row[field] = cells.value(cell++);
        }
        return rows;
    }

    /// Boxes that come, each a part of its line; "=Yes" or "=No" behind it is the answer.
    void expect(const QStringList &boxes)
    {
        for (const QString &box : boxes)
            mDesktop->expectBox(box.section(u'=', 0, 0), box.endsWith(u"=Yes"_s)  ? vbYes
                                                         : box.endsWith(u"=No"_s) ? vbNo
                                                                                  : vbOK);
    }

    QPointer<Form> mScreen;
};
