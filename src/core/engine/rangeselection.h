// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <optional>

class SettingsStore;

// The main window's choice of months: stepping it by month or year within the limits, checking
// typed years, and the choice remembered from the last produce.
namespace RangeSelection {

inline constexpr int EarliestYear = 1950;

struct Selection
{
    int firstMonth = 1; // 1 to 12
    int firstYear = 0;
    int lastMonth = 1;
    int lastYear = 0;
};

// Each step gives the new choice, or nothing when it would pass a limit.
std::optional<Selection> previousMonth(const Selection &selection);
std::optional<Selection> followingMonth(const Selection &selection, int currentYear);
std::optional<Selection> previousYear(const Selection &selection);
std::optional<Selection> followingYear(const Selection &selection, int currentYear);

inline const QString LimitTitle = QStringLiteral("Limit Reached");
inline const QString LimitMessage = QStringLiteral("The date range has reached its limit!");

// A typed year is valid from 1950 to the current year.
bool isValidYear(const QString &text, int currentYear);
QString invalidYearMessage(int currentYear);
inline const QString InvalidYearTitle = QStringLiteral("Invalid Year");

// The choice remembered in M1, M2, Y1 and Y2: January of the current year when nothing is
// remembered; a month that is not a number is January, a year shorter than four characters
// the current year. A remembered month outside 1 to 12 gives nothing.
struct Remembered
{
    int firstMonth = 1;
    int lastMonth = 1;
    QString firstYear;
    QString lastYear;
};
std::optional<Remembered> remembered(const SettingsStore &store, int currentYear);

} // namespace RangeSelection
