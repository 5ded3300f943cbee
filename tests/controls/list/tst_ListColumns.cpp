// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "support/datarows.h"

#include <QHeaderView>
#include <QTest>

namespace
{

const std::vector<ListColumn> threeColumns{{ListColumn::Hidden},
                                           {ListColumn::Number, "Track", 1},
                                           {ListColumn::Text, "Titel", 2},
                                           {ListColumn::Text, "Genre", 1}};

/// A list of one row that shows under three columns, 401 pixels wide.
class ShownColumns
{
public:
    explicit ShownColumns(int whole = 0, ListColumns::Dragged dragged = ListColumns::Dragged::Kept)
        : columns(new ListColumns(&list, threeColumns, whole, dragged))
    {
        show();
        resize(401);
        list.show();
    }

    void show()
    {
        const auto rows = std::make_shared<ADODB::Recordset>();
        for (const char *name : {"Id", "N", "T", "G"})
            rows->appendField(QLatin1String(name), ADODB::adVarWChar);
        rows->Open();
        rows->AddNew();
        columns->show(rows);
    }

    void resize(int room) { list.resize(room + 2 * list.frameWidth(), 200); }
    void drag(int column, int width) { list.ColumnHeaders().Item(column).setWidth(width); }

    QString widths()
    {
        QStringList all;
        for (int column = 1; column <= 4; ++column)
            all.append(QString::number(list.ColumnHeaders().Item(column).Width()));
        return all.join(u' ');
    }

    DBListViewCTL list;
    ListColumns *columns;
};

} // namespace

/// Captions, widths and hidden columns of the lists of all screens.
class tst_ListColumns : public QObject
{
    Q_OBJECT

private slots:
    void captionsAndSides()
    {
        ShownColumns shown;
        QCOMPARE(shown.list.ColumnHeaders().Item(3).Text(), u"Title"_s);
        const auto isRight = [&](int column) {
            const QModelIndex cell = shown.list.model()->index(0, column);
            const auto head =
                shown.list.model()->headerData(column, Qt::Horizontal, Qt::TextAlignmentRole);
            const bool right = cell.data(Qt::TextAlignmentRole).toInt() & Qt::AlignRight;
            return right && head.toInt() & Qt::AlignRight;
        };
        QVERIFY(isRight(1) && !isRight(2));
    }

    void widthsFollowTheList()
    {
        ShownColumns shown;
        QTRY_COMPARE(shown.widths(), u"0 100 200 101"_s);
        shown.resize(801);
        QCOMPARE(shown.widths(), u"0 200 400 201"_s);
        ShownColumns parts(10); // which leave room, or take more than there is
        QTRY_COMPARE(parts.widths(), u"0 40 80 40"_s);
    }

    // What one set of columns hid does not stay hidden under the next.
    void otherColumnsInTheSameList()
    {
        ShownColumns shown;
        QTRY_COMPARE(shown.widths(), u"0 100 200 101"_s);
        delete shown.columns;
        const auto rows = std::make_shared<ADODB::Recordset>();
        rows->appendField(u"Dummy"_s, ADODB::adVarWChar);
        rows->Open();
        rows->AddNew();
        shown.columns = new ListColumns(&shown.list, {{ListColumn::Hidden}});
        shown.columns->show(rows);
        QVERIFY(shown.list.isColumnHidden(0));
        delete shown.columns;
        shown.columns = new ListColumns(
            &shown.list, {{ListColumn::Text, "Titel", 1}, {ListColumn::Text, "Genre", 3}});
        shown.columns->showNone();
        QCOMPARE(shown.widths(), u"100 301 0 0"_s);
    }

    void whatWasDraggedIsKept_data()
    {
        const DataRows<int, bool, QString, QString> row("whole", "kept", "shown again", "wider");
        row("parts of their sum", 0, true, "0 100 50 101", "0 319 160 323");
        row("parts of ten", 10, true, "0 40 50 40", "0 80 100 80");
        row("not kept", 10, false, "0 40 80 40", "0 80 160 80");
    }

    void whatWasDraggedIsKept()
    {
        QFETCH(int, whole);
        QFETCH(bool, kept);
        ShownColumns shown(whole, kept ? ListColumns::Dragged::Kept : ListColumns::Dragged::Lost);
        QTRY_COMPARE(shown.list.viewport()->width(), 401);
        shown.drag(3, 50);
        shown.show();
        QTEST(shown.widths(), "shown again");
        shown.resize(802);
        QTEST(shown.widths(), "wider");
    }

    void noRows()
    {
        ShownColumns shown;
        shown.columns->showNone();
        QCOMPARE(shown.list.ListItems().Count(), 0);
        QCOMPARE(shown.list.ColumnHeaders().Item(4).Text(), u"Genre"_s);
        QCOMPARE(shown.widths(), u"0 100 200 101"_s);
    }
};

QTEST_MAIN(tst_ListColumns)
#include "tst_ListColumns.moc"
