// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "controls/list/fittedcolumns.h"
#include "support/datarows.h"

#include <QTest>
#include <QVBoxLayout>

/// Columns as wide as their texts: a short and a long one that may give way, and one that may not.
class tst_FittedColumns : public QObject
{
    Q_OBJECT

private slots:
    void widths_data()
    {
        const DataRows<int, bool, bool> row("room", "longIsWhole", "lastIsWhole");
        row("more than they need", 1200, true, true);
        row("what they need", 0, true, true);
        row("less", 450, false, true);
        row("far less", 200, false, false);
    }
    void widths()
    {
        QFETCH(int, room);
        QWidget screen;
        DBListViewCTL list;
        (new QVBoxLayout(&screen))->addWidget(&list);
        FittedColumns columns(&list, {{ListColumn::Hidden},
                                      {ListColumn::Text, "Titel", 1},
                                      {ListColumn::Text, "Genre", 1},
                                      {ListColumn::Number, "Track"}});
        const auto rows = std::make_shared<ADODB::Recordset>();
        for (const char *name : {"Id", "T", "G", "N"})
            rows->appendField(QLatin1String(name), ADODB::adVarWChar);
        rows->Open();
        rows->AddNew();
        rows->Fields(1).setValue(QStringLiteral("short"));
        rows->Fields(2).setValue(QString(60, u'x'));
        rows->Fields(3).setValue(QString(30, u'x'));
        columns.show(rows);
        screen.resize(room, 100);
        if (room == 0)
            columns.widen(&screen);
        screen.show();
        const QAbstractItemView *view = &list;
        const auto left = [&](int column) {
            return list.columnWidth(column) - view->sizeHintForColumn(column);
        };
        QVERIFY(list.isColumnHidden(0));
        QVERIFY(left(1) >= 0);
        QTEST(left(2) >= 0, "longIsWhole");
        QTEST(left(3) >= 0, "lastIsWhole");
        QCOMPARE(list.columnWidth(1) + list.columnWidth(2) + list.columnWidth(3),
                 list.viewport()->width());
    }
};

QTEST_MAIN(tst_FittedColumns)
#include "tst_FittedColumns.moc"
