#include "reports/clampedspinbox.h"

#include <algorithm>

std::optional<qint64> ClampedSpinBox::numberIn(const QString &input) const
{
    QString digits = input;
    digits.remove(suffix()).remove(locale().groupSeparator());
    bool isNumber = false;
    const qint64 number = digits.trimmed().toLongLong(&isNumber);
    return isNumber && number >= 0 ? std::optional(number) : std::nullopt;
}

QValidator::State ClampedSpinBox::validate(QString &input, int &position) const
{
    const auto state = QSpinBox::validate(input, position);
    return state == QValidator::Invalid && numberIn(input) ? QValidator::Intermediate : state;
}

void ClampedSpinBox::fixup(QString &input) const
{
    if (const auto number = numberIn(input))
        input = textFromValue(int(std::clamp<qint64>(*number, minimum(), maximum()))) + suffix();
    else
        QSpinBox::fixup(input);
}
