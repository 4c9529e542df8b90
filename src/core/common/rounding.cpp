// Veltrix — KPI dashboard for small businesses.
#include "rounding.h"

#include <QByteArray>

#include <cmath>

namespace Rounding {

namespace {

// The value scaled by 10^decimals, taken through its decimal text, so that the binary error of
// the multiplication (5237.4999999 for 52.375 * 100) does not decide. Fifteen significant
// digits are what a double holds reliably; more would bring the binary error back.
double scaledThroughText(double value, int decimals)
{
    // Only a value that lands next to a half needs its decimal text; elsewhere the binary
    // error cannot change which way it rounds.
    const double scaled = value * std::pow(10.0, decimals);
    const double fraction = std::fabs(scaled - std::trunc(scaled));
    if (std::fabs(fraction - 0.5) > 1e-6 && std::fabs(scaled) < 1e15)
        return scaled;
    const QByteArray text = QByteArray::number(value, 'g', 15) + 'e' + QByteArray::number(decimals);
    return text.toDouble();
}

template<typename ToWhole> double roundTo(double value, int decimals, ToWhole toWhole)
{
    if (!std::isfinite(value))
        return value;
    const double rounded = toWhole(scaledThroughText(value, decimals)) / std::pow(10.0, decimals);
    return rounded == 0.0 ? 0.0 : rounded; // no "-0"
}

} // namespace

double halfAwayFromZero(double value, int decimals)
{
    return roundTo(value, decimals, [](double scaled) { return std::round(scaled); });
}

double halfToEven(double value, int decimals)
{
    // nearbyint rounds halves to even in the default rounding mode.
    return roundTo(value, decimals, [](double scaled) { return std::nearbyint(scaled); });
}

} // namespace Rounding
