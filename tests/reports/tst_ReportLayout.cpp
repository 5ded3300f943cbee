// Label: unit
#include "reports/reportlayout.h"

#include <QTest>

/// The arithmetic of pages: every row stands on exactly one, between the margins and clear of head
/// and foot.
class tst_ReportLayout : public QObject
{
    Q_OBJECT

private slots:
    void everyRowHasItsPlace_data()
    {
        QTest::addColumn<QPageLayout>("paper");
        QTest::addColumn<qsizetype>("rows");
        const auto papers = {QPageLayout(QPageSize(QPageSize::A4), QPageLayout::Portrait,
                                         {15, 15, 15, 15}, QPageLayout::Millimeter),
                             QPageLayout(QPageSize(QPageSize::A5), QPageLayout::Landscape,
                                         {50, 37, 50, 37}, QPageLayout::Millimeter),
                             QPageLayout(QPageSize(QPageSize::A3), QPageLayout::Portrait,
                                         {5, 5, 5, 5}, QPageLayout::Millimeter)};
        for (const QPageLayout &paper : papers) {
            const qsizetype perPage = ReportLayout(paper, 0, true).rowsPerPage();
            for (const qsizetype rows : {qsizetype(0), qsizetype(1), perPage, perPage + 1,
                                         7 * perPage - 1, qsizetype(1300000)})
                QTest::addRow("%s, %lld rows", qPrintable(paper.pageSize().name()),
                              static_cast<long long>(rows))
                    << paper << rows;
        }
    }

    void everyRowHasItsPlace()
    {
        QFETCH(QPageLayout, paper);
        QFETCH(qsizetype, rows);
        const ReportLayout layout(paper, rows, true);
        QVERIFY(layout.rowsPerPage() >= 8);
        QVERIFY(layout.pageCount() >= 1);
        qsizetype next = 0;
        for (qsizetype page = 0; page < layout.pageCount(); ++page) {
            const auto range = layout.rowsOf(page);
            QCOMPARE(range.first, next);
            QVERIFY(rows == 0 || (range.end > range.first && range.end <= rows));
            next = range.end;
        }
        QCOMPARE(next, rows);
        const QRectF last = layout.row(layout.rowsPerPage() - 1);
        QVERIFY(layout.row(0).top() >= layout.columnHeads().bottom());
        QVERIFY(last.bottom() <= layout.foot().top());
        QVERIFY(last.bottom() + ReportLayout::rowHeight > layout.foot().top()); // no room is wasted
        QCOMPARE(layout.foot().bottom(), layout.printable().bottom());
        QVERIFY(QRectF({}, layout.paperSize()).contains(layout.printable()));
    }
};

QTEST_APPLESS_MAIN(tst_ReportLayout)
#include "tst_ReportLayout.moc"
