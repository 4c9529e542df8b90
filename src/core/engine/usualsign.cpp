// Veltrix — KPI dashboard for small businesses.
#include "usualsign.h"

#include <QHash>

#include <cmath>

namespace UsualSign {

namespace {

// Fields not listed (headings, Fields added later) keep the sign they have.
const QHash<qint64, Sign> &table()
{
    static const QHash<qint64, Sign> signs = [] {
        // Income accounts, profits, margins, percentages, counts and hours.
        const qint64 positive[] = {
            1,  2,  3,  4,  5,   6,   7,   8,   11,  13,  15,  16,  18,  19,  21,  23,  24,  27, 28,
            30, 31, 32, 33, 34,  35,  37,  38,  39,  41,  42,  43,  46,  47,  50,  51,  54,  55, 56,
            57, 59, 60, 62, 63,  64,  65,  66,  67,  72,  73,  74,  75,  76,  77,  78,  79,  90, 92,
            93, 94, 96, 97, 104, 105, 106, 107, 108, 109, 110, 111, 112, 115, 116, 124, 126, 127};
        // Cost accounts, discounts allowed, cost totals and costs per hour or repair order.
        const qint64 negative[] = {14, 17,  22,  25,  26,  36,  40,  45,  49,  53, 58, 68,
                                   69, 70,  81,  82,  83,  84,  85,  86,  87,  88, 89, 98,
                                   99, 101, 102, 103, 113, 117, 118, 119, 120, 125};
        QHash<qint64, Sign> map;
        for (const qint64 id : positive)
            map.insert(id, Positive);
        for (const qint64 id : negative)
            map.insert(id, Negative);
        return map;
    }();
    return signs;
}

} // namespace

Sign of(qint64 fieldId)
{
    return table().value(fieldId, Unknown);
}

bool isUnusual(qint64 fieldId, double signedValue)
{
    const Sign usual = of(fieldId);
    return (usual == Positive && signedValue < 0) || (usual == Negative && signedValue > 0);
}

double shown(qint64 fieldId, double signedValue)
{
    const double magnitude = std::fabs(signedValue);
    return isUnusual(fieldId, signedValue) ? -magnitude : magnitude;
}

} // namespace UsualSign
