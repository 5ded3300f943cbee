#pragma once

#include <QSpinBox>
#include <optional>

/// A field for a whole number that takes one beyond its range for the nearest end, where the usual
/// field would drop the digit too many: "99999" of 820 pages is the last page and not page 99.
class ClampedSpinBox : public QSpinBox
{
    Q_OBJECT

public:
    using QSpinBox::QSpinBox;

protected:
    QValidator::State validate(QString &input, int &position) const override;
    void fixup(QString &input) const override;

private:
    std::optional<qint64> numberIn(const QString &input) const;
};
