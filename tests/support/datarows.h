#pragma once

#include "support/texts.h"

#include <QTest>
#include <concepts>

/// The data of a test. The columns are named once; then each row is one call, with its name and the
/// values, or with the values alone, of which the first is the name too. Plain literals are UTF-8.
///
///     const DataRows<QString, bool> row("year", "taken");
///     row("too early", "1900", false);
///     row("1901", true);
template <typename... Column> class DataRows
{
public:
    template <typename... Name> explicit DataRows(Name... columns)
    {
        (QTest::addColumn<Column>(columns), ...);
    }

    void operator()(const QByteArray &name, const Given<Column> &...values) const
    {
        auto &row = QTest::newRow(name);
        (row << ... << static_cast<const Column &>(values));
    }
    void operator()(const Given<Column> &...values) const
    {
        operator()(nameOf(values...), values...);
    }

private:
    static QByteArray bytes(const QString &text) { return text.toUtf8(); }
    static QByteArray bytes(const QByteArray &bytes) { return bytes; }
    static QByteArray bytes(qint64 number) { return QByteArray::number(number); }
    template <typename First, typename... Rest>
    static QByteArray nameOf(const First &first, const Rest &...)
    {
        const QByteArray name = bytes(first);
        return name.isEmpty() ? QByteArray("empty") : name;
    }
};
