// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "kpievaluation.h"

#include <QList>
#include <QString>

#include <utility>

class NumberFormat;

// The shape of one bar of the KPI graph: as tall as the larger of value and optimal, with the
// span between them marked at the top and a line at the optimal level. Sizes in pixels.
namespace BarLayout {

struct Bar
{
    KpiEvaluation::Result evaluation;
    int columnHeight = 0;
    int extraHeight = 0;
    int optimalLineY = 0;
    bool extraVisible = false;
};

// Two pixels per percentage point at 15 twips per pixel (96 dpi), more on denser screens.
double scale(double twipsPerPixelY);
// The Field, when known, judges a figure of the wrong sign red.
Bar layoutBar(const QString &optimalString, double actual, double twipsPerPixelY,
              const NumberFormat &numbers, qint64 fieldId = 0);
// "+2.5%" above the optimal, "-3%" below, "0%" on it.
QString tooltip(double variant, const NumberFormat &numbers);

// The width of a bar stretched over its 54-pixel picture, in twips.
int barWidthTwips(double twipsPerPixelX);

// The bars spread over the width they have: the bars of one Field (its periods in a
// comparison) side by side, a gap of a third of a bar between Fields and at both ends. Every
// bar is as wide as the others; left edges in pixels from the start of the width.
struct Spread
{
    int barWidth = 0;
    QList<int> lefts;
    // Where each Field's bars begin and end, for its name below them.
    QList<std::pair<int, int>> groups;
};
Spread spreadBars(const QList<qint64> &fieldIds, int width);

} // namespace BarLayout
