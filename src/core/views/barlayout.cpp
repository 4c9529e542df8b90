// Veltrix — KPI dashboard for small businesses.
#include "barlayout.h"

#include "common/numberformat.h"

#include <QLocale>

#include <cmath>

namespace BarLayout {

double scale(double twipsPerPixelY)
{
    const double s = twipsPerPixelY > 0 ? 2.0 * (15.0 / twipsPerPixelY) : 2.0;
    return s > 0 ? s : 2.0;
}

Bar layoutBar(const QString &optimalString, double actual, double twipsPerPixelY,
              const NumberFormat &numbers, qint64 fieldId)
{
    Bar bar;
    bar.evaluation = KpiEvaluation::evaluateField(fieldId, optimalString, actual, numbers);
    const double s = scale(twipsPerPixelY);
    const KpiEvaluation::Result &e = bar.evaluation;
    bar.extraHeight = int(std::lround(std::fabs(e.variant) * s));
    const bool atMost = e.optimalType == KpiEvaluation::AtMost;
    double height = 0.0;
    if (e.band == KpiEvaluation::Green) {
        height = atMost ? e.optimal * s : actual * s;
        bar.optimalLineY = atMost ? 0 : bar.extraHeight;
    } else {
        height = atMost ? actual * s : e.optimal * s;
        bar.optimalLineY = atMost ? bar.extraHeight : 0;
    }
    bar.columnHeight = std::max(0, int(std::lround(height)));
    if (actual < 0) {
        // Nothing can stand below the base line: the bar reaches its optimal and all of it is
        // the shortfall.
        bar.columnHeight = std::max(0, int(std::lround(e.optimal * s)));
        bar.extraHeight = bar.columnHeight;
        bar.optimalLineY = 0;
    }
    bar.extraVisible = bar.extraHeight > 0;
    return bar;
}

QString tooltip(double variant, const NumberFormat &numbers)
{
    const QString number = numbers.locale().toString(variant, 'g', QLocale::FloatingPointShortest);
    return (variant > 0 ? QStringLiteral("+") : QString()) + number + QLatin1Char('%');
}

int barWidthTwips(double twipsPerPixelX)
{
    return int(std::lround((twipsPerPixelX + 1.0) * 54.0));
}

Spread spreadBars(const QList<qint64> &fieldIds, int width)
{
    Spread spread;
    const int bars = int(fieldIds.size());
    if (bars == 0 || width <= 0)
        return spread;
    int groups = 1;
    for (int n = 1; n < bars; ++n)
        groups += fieldIds[n] != fieldIds[n - 1] ? 1 : 0;
    // bars * w + (groups + 1) * w / 3 = width; a window too narrow still shows a pixel a bar.
    const double barWidth = std::max(1.0, 3.0 * width / (3.0 * bars + groups + 1));
    const double gap = barWidth / 3.0;
    spread.barWidth = int(std::floor(barWidth));
    double left = gap;
    for (int n = 0; n < bars; ++n) {
        if (n > 0 && fieldIds[n] != fieldIds[n - 1])
            left += gap;
        spread.lefts << int(std::lround(left));
        if (n == 0 || fieldIds[n] != fieldIds[n - 1])
            spread.groups.append({spread.lefts.last(), 0});
        left += barWidth;
        spread.groups.last().second = int(std::lround(left));
    }
    return spread;
}

} // namespace BarLayout
