#pragma once

#include <QString>
#include <variant>

namespace ADODB
{

/// One value of a record: NULL, a whole number, a fraction or a text.
class Value
{
public:
    Value() = default; // NULL
    Value(int v) : mValue(qint64(v)) {}
    Value(qint64 v) : mValue(v) {}
    Value(double v) : mValue(v) {}
    Value(QString v) : mValue(std::move(v)) {}

    bool isNull() const { return mValue.index() == 0; }
    const auto &variant() const { return mValue; }

    /// The value as a person reads it; NULL is the empty text.
    QString toText() const;

    /// The value as a whole number, fractions rounded half to even. Throws errTypeMismatch for NULL
    /// and texts that are no number, errOverflow for what 64 bits cannot hold.
    qint64 toLong() const;

    friend bool operator==(const Value &a, const Value &b) = default;

private:
    std::variant<std::monostate, qint64, double, QString> mValue;
};

} // namespace ADODB
