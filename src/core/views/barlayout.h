// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "kpievaluation.h"

#include <QList>
#include <QString>

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

// Where the bars of a graph stand, in twips: the first at 35, then each after the one before
// with a gap of 16; in a comparison the bars of one Field touch.
struct Placement
{
    int left = 0;
    int top = 0;
    int height = 0;
};
inline constexpr int FirstLeft = 35;
inline constexpr int Gap = 16;
inline constexpr int BaseLineY = 3300;
// The width of a bar stretched over its 54-pixel picture.
int barWidthTwips(double twipsPerPixelX);
QList<Placement> placeBars(const QList<qint64> &fieldIds, const QList<int> &heightsPixels,
                           double twipsPerPixelX, double twipsPerPixelY, bool compare);

// A comparison graph stretched over the width it has: every bar as wide as the others, the
// bars of one Field touching, a gap between Fields. The first bar keeps its place.
struct CompareLayout
{
    int barWidth = 0;
    QList<int> lefts;
};
CompareLayout layoutCompareBars(const QList<qint64> &fieldIds, int periods, int firstLeft,
                                int innerWidthTwips);

} // namespace BarLayout
