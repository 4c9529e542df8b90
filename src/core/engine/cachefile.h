// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "perioddataset.h"

#include <QDateTime>

#include <optional>

// The figures of slot 0 between runs: one line per entry, Field ID, value, absolute value and
// type code separated by TAB, lines ended by CR LF.
namespace CacheFile {

struct ReadProblem
{
    QString description;
    // The file was read but is not a cache (a cut or overwritten file), as opposed to one
    // that could not be read at all.
    bool damaged = false;
};

// Appends the file's entries to the slot. Blank lines are skipped; a line with fewer than
// four fields is an error, described in the result. A missing file adds nothing.
std::optional<ReadProblem> read(const QString &path, PeriodDataSet::Slot &slot);

// Moves a damaged cache out of the way, keeping it beside under a name with the moment, such
// as data.db.damaged-20260105-143000, so that the next start begins without it and nothing is
// lost. The new path, or nothing when the file could not be moved.
std::optional<QString> setAside(const QString &path, const QDateTime &moment);

// Replaces the file with the slot's entries. The new content goes to a temporary file that is
// renamed over the old one only when complete, so a crash or a full disk never leaves a cut
// cache behind. False when the file could not be written.
bool write(const QString &path, const PeriodDataSet::Slot &slot);

} // namespace CacheFile
