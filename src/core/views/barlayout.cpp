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

QList<Placement> placeBars(const QList<qint64> &fieldIds, const QList<int> &heightsPixels,
                           double twipsPerPixelX, double twipsPerPixelY, bool compare)
{
    QList<Placement> placements;
    const int width = barWidthTwips(twipsPerPixelX);
    for (int n = 0; n < fieldIds.size(); ++n) {
        Placement place;
        place.height = int(std::lround(heightsPixels.value(n) * twipsPerPixelY)) - 1;
        if (n == 0) {
            place.left = FirstLeft;
        } else {
            const bool sameField = compare && fieldIds[n] == fieldIds[n - 1];
            place.left = placements.last().left + width + (sameField ? 0 : Gap);
        }
        place.top = BaseLineY - place.height;
        placements << place;
    }
    return placements;
}

CompareLayout layoutCompareBars(const QList<qint64> &fieldIds, int periods, int firstLeft,
                                int innerWidthTwips)
{
    CompareLayout layout;
    const int bars = int(fieldIds.size());
    if (bars == 0 || periods < 1)
        return layout;
    const int groups = bars / periods;
    // A window too narrow for its bars still shows each of them one twip wide.
    layout.barWidth = std::max(1, (innerWidthTwips - Gap * groups - 20) / bars);
    for (int n = 0; n < bars; ++n) {
        if (n == 0) {
            layout.lefts << firstLeft;
            continue;
        }
        const bool newField = fieldIds[n] != fieldIds[n - 1];
        layout.lefts << layout.lefts.last() + layout.barWidth + (newField ? Gap : 0);
    }
    return layout;
}

} // namespace BarLayout
