// Veltrix — KPI dashboard for small businesses.
#include "rangeselection.h"

#include "common/settingsstore.h"

using namespace Qt::StringLiterals;

namespace RangeSelection {

namespace {

// The range becomes the single first month.
Selection singleMonth(int month, int year)
{
    return {month, year, month, year};
}

} // namespace

std::optional<Selection> previousMonth(const Selection &selection)
{
    if (selection.firstMonth == 1) {
        if (selection.firstYear <= EarliestYear)
            return std::nullopt;
        return singleMonth(12, selection.firstYear - 1);
    }
    return singleMonth(selection.firstMonth - 1, selection.firstYear);
}

std::optional<Selection> followingMonth(const Selection &selection, int currentYear)
{
    if (selection.firstMonth == 12) {
        if (selection.firstYear >= currentYear)
            return std::nullopt;
        return singleMonth(1, selection.firstYear + 1);
    }
    return singleMonth(selection.firstMonth + 1, selection.firstYear);
}

std::optional<Selection> previousYear(const Selection &selection)
{
    if (selection.firstYear <= EarliestYear)
        return std::nullopt;
    Selection stepped = selection;
    stepped.firstYear = selection.firstYear - 1;
    stepped.lastYear = stepped.firstYear + 1;
    return stepped;
}

std::optional<Selection> followingYear(const Selection &selection, int currentYear)
{
    if (selection.firstYear >= currentYear)
        return std::nullopt;
    Selection stepped = selection;
    stepped.firstYear = selection.firstYear + 1;
    stepped.lastYear = stepped.firstYear + 1;
    return stepped;
}

bool isValidYear(const QString &text, int currentYear)
{
    bool ok = false;
    const int year = text.trimmed().toInt(&ok);
    return ok && year >= EarliestYear && year <= currentYear;
}

QString invalidYearMessage(int currentYear)
{
    return u"The specified year is invalid! The year must be between 1950 and the current year "_s +
           QString::number(currentYear);
}

std::optional<Remembered> remembered(const SettingsStore &store, int currentYear)
{
    const QString thisYear = QString::number(currentYear);
    Remembered choice;
    for (auto [name, month] :
         {std::pair{u"M1"_s, &choice.firstMonth}, std::pair{u"M2"_s, &choice.lastMonth}}) {
        bool ok = false;
        const int index = store.readSetting(name, {}, u"0"_s).toInt(&ok);
        if (!ok) {
            *month = 1;
            continue;
        }
        if (index < 0 || index > 11)
            return std::nullopt;
        *month = index + 1;
    }
    for (auto [name, year] :
         {std::pair{u"Y1"_s, &choice.firstYear}, std::pair{u"Y2"_s, &choice.lastYear}}) {
        *year = store.readSetting(name, {}, thisYear);
        if (year->size() < 4)
            *year = thisYear;
    }
    return choice;
}

} // namespace RangeSelection
