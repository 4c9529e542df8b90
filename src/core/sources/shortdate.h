// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QDate>
#include <QLocale>
#include <QString>

// Dates in the region's short form, as MoneyWorks expressions carry them both ways. Short
// forms often have two-digit years; those are read as years from 1950 to 2049.
namespace ShortDate {

QString format(const QDate &date, const QLocale &locale);
// An invalid date when the text is not a date in the region's short form (or in ISO form).
QDate parse(const QString &text, const QLocale &locale);

} // namespace ShortDate
