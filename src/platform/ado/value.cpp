#include "platform/ado/value.h"

#include "platform/error/error.h"
#include "platform/text/textrules.h"

#include <cmath>

namespace ADODB
{

QString Value::toText() const
{
    if (const auto *whole = std::get_if<qint64>(&mValue))
        return QString::number(*whole);
    if (const auto *fraction = std::get_if<double>(&mValue))
        return QString::number(*fraction, 'g', 15);
    if (const auto *words = std::get_if<QString>(&mValue))
        return *words;
    return {};
}

namespace
{

qint64 rounded(double v)
{
    constexpr double limit = 9.2e18;
    if (!(std::abs(v) < limit))
        throw makeError(errOverflow);
    return qint64(std::nearbyint(v));
}

} // namespace

qint64 Value::toLong() const
{
    if (const auto *whole = std::get_if<qint64>(&mValue))
        return *whole;
    if (const auto *fraction = std::get_if<double>(&mValue))
        return rounded(*fraction);
    const auto *words = std::get_if<QString>(&mValue);
    if (!words || !text::isNumeric(*words))
        throw makeError(errTypeMismatch);
    bool fits = false;
    const qint64 whole = words->trimmed().toLongLong(&fits);
    return fits ? whole : rounded(words->trimmed().toDouble());
}

} // namespace ADODB
