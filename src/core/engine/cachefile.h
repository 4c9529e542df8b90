// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "perioddataset.h"

#include <optional>

// The figures of slot 0 between runs: one line per entry, Field ID, value, absolute value and
// type code separated by TAB, lines ended by CR LF.
namespace CacheFile {

// Appends the file's entries to the slot. Blank lines are skipped; a line with fewer than
// four fields is an error, described in the result. A missing file adds nothing.
std::optional<QString> read(const QString &path, PeriodDataSet::Slot &slot);

// Replaces the file with the slot's entries. The new content goes to a temporary file that is
// renamed over the old one only when complete, so a crash or a full disk never leaves a cut
// cache behind. False when the file could not be written.
bool write(const QString &path, const PeriodDataSet::Slot &slot);

} // namespace CacheFile
