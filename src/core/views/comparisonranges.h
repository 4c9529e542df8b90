// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "engine/perioddataset.h"

#include <QList>

// The earlier ranges a comparison sets beside the produced one: the same months in earlier
// years, or the periods of equal length just before it.
namespace ComparisonRanges {

enum class Kind { Years, Periods };

// Ranges for slots 1 to count (at most 4), each one step before the one in front of it.
QList<PeriodDataSet::Range> earlierRanges(const PeriodDataSet::Range &produced, Kind kind,
                                          int count);
// "Years" or "Periods", as the comparison list offers them.
std::optional<Kind> kindFromText(const QString &text);

} // namespace ComparisonRanges
