#include "controls/list/listcolumns.h"

#include "controls/list/DBListViewCTL.h"
#include "services/messages.h"

#include <QEvent>

namespace
{

constexpr int digits = 6; // of a number without a share

QList<int> sharesOf(const std::vector<ListColumn> &columns)
{
    QList<int> shares;
    for (const ListColumn &column : columns)
        shares.append(column.kind == ListColumn::Hidden ? ColumnShares::NotShown : column.share);
    return shares;
}

} // namespace

ListColumns::ListColumns(DBListViewCTL *list, std::vector<ListColumn> columns, int whole,
                         Dragged dragged)
    : QObject(list),
      mList(list),
      mColumns(std::move(columns)),
      mShares(new ColumnShares(list, sharesOf(mColumns), digits, whole, dragged))
{
    mList->viewport()->installEventFilter(this);
}

// Where the list goes first, it has deleted them.
ListColumns::~ListColumns()
{
    delete mShares;
}

void ListColumns::show(const ADODB::RecordsetPtr &recordset)
{
    mShares->keepOver([&] {
        mList->setRecordset(recordset);
        mList->Populate();
        setUpColumns();
    });
}

void ListColumns::showNone()
{
    const auto empty = std::make_shared<ADODB::Recordset>();
    for (std::size_t i = 0; i < mColumns.size(); ++i)
        empty->appendField(QString::number(i), ADODB::adVarWChar);
    empty->Open();
    show(empty);
}

void ListColumns::setUpColumns()
{
    auto headers = mList->ColumnHeaders();
    int index = 0;
    for (const ListColumn &column : mColumns) {
        auto header = headers.Item(++index);
        if (column.kind == ListColumn::Hidden)
            header.setWidth(0);
        if (column.kind == ListColumn::Number)
            header.setAlignment(Qt::AlignRight);
        if (column.caption)
            header.setText(GetMessage(column.caption));
    }
}

bool ListColumns::eventFilter(QObject *watched, QEvent *event)
{
    if (event->type() == QEvent::Resize)
        mShares->layOut();
    return QObject::eventFilter(watched, event);
}
