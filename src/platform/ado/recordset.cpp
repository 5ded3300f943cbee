#include "platform/ado/recordset.h"

namespace ADODB
{

QString Field::Name() const
{
    return mRecordset.mRows->fields()[std::size_t(mColumn)].name;
}

Value Field::Value() const
{
    mRecordset.requireRecord();
    return mRecordset.mRows->value(mRecordset.mPosition, mColumn);
}

void Field::setValue(const ADODB::Value &v)
{
    mRecordset.requireRecord();
    mRecordset.changeable().setValue(mRecordset.mPosition, mColumn, v);
}

void Recordset::Open(const QString &statement, Connection &connection, CursorTypeEnum, LockTypeEnum,
                     int)
{
    adopt(connection.run(statement));
}

void Recordset::appendField(const QString &name, DataTypeEnum type, int size)
{
    if (mRows)
        throw makeError(errNotPermitted);
    if (!mNewFields)
        mNewFields = std::make_shared<FieldList>();
    mNewFields->push_back({name, type, size});
}

void Recordset::Open()
{
    if (!mNewFields)
        throw makeError(errNotPermitted);
    adopt(std::make_shared<Rows>(std::move(mNewFields)));
}

void Recordset::adopt(std::shared_ptr<const Rows> rows)
{
    // Nobody writes to rows that others hold: see changeable().
    mRows = std::const_pointer_cast<Rows>(std::move(rows));
    mPosition = 0;
    mOnDeleted = false;
}

void Recordset::Close()
{
    requireOpen();
    mRows.reset();
}

void Recordset::requireOpen() const
{
    if (!mRows)
        throw makeError(errObjectClosed);
}

void Recordset::requireRecord() const
{
    requireOpen();
    if (mOnDeleted || mPosition < 0 || mPosition >= mRows->rowCount())
        throw makeError(errNoCurrentRecord);
}

bool Recordset::isEOF() const
{
    requireOpen();
    return !mOnDeleted && (mPosition >= mRows->rowCount() || mRows->rowCount() == 0);
}

bool Recordset::isBOF() const
{
    requireOpen();
    return mPosition < 0 || (mRows->rowCount() == 0 && !mOnDeleted);
}

qsizetype Recordset::RecordCount() const
{
    requireOpen();
    return mRows->rowCount();
}

void Recordset::MoveFirst()
{
    requireOpen();
    if (mRows->rowCount() == 0)
        throw makeError(errNoCurrentRecord);
    mPosition = 0;
    mOnDeleted = false;
}

void Recordset::MoveLast()
{
    MoveFirst();
    mPosition = mRows->rowCount() - 1;
}

void Recordset::MoveNext()
{
    requireOpen();
    if (mOnDeleted) {
        mOnDeleted = false; // the next record has moved up to this position
        return;
    }
    if (mPosition >= mRows->rowCount())
        throw makeError(errNoCurrentRecord);
    ++mPosition;
}

void Recordset::MovePrevious()
{
    requireOpen();
    if (isBOF())
        throw makeError(errNoCurrentRecord);
    mOnDeleted = false;
    --mPosition;
}

int Recordset::fieldCount() const
{
    requireOpen();
    return mRows->columnCount();
}

int Recordset::columnOf(QStringView name) const
{
    requireOpen();
    const FieldList &fields = mRows->fields();
    for (std::size_t i = 0; i < fields.size(); ++i) {
        if (name.compare(fields[i].name, Qt::CaseInsensitive) == 0)
            return int(i);
    }
    throw makeError(errItemNotFound, name.toString());
}

Field Recordset::Fields(int column)
{
    if (column < 0 || column >= fieldCount())
        throw makeError(errItemNotFound, QString::number(column));
    return {*this, column};
}

Field Recordset::Fields(QStringView name)
{
    return {*this, columnOf(name)};
}

Rows &Recordset::changeable()
{
    requireOpen();
    if (mRows.use_count() > 1)
        mRows = mRows->clone();
    return *mRows;
}

void Recordset::AddNew()
{
    mPosition = changeable().addRow();
    mOnDeleted = false;
}

void Recordset::Delete()
{
    requireRecord();
    changeable().removeRow(mPosition);
    mOnDeleted = true;
}

void Recordset::arrange(const std::vector<std::uint32_t> &order)
{
    changeable().arrange(order);
    mPosition = 0;
    mOnDeleted = false;
}

std::shared_ptr<const Rows> Recordset::rows() const
{
    requireOpen();
    return mRows;
}

} // namespace ADODB
