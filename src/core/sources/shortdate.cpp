// Veltrix — KPI dashboard for small businesses.
#include "shortdate.h"

namespace ShortDate {

QString format(const QDate &date, const QLocale &locale)
{
    return locale.toString(date, QLocale::ShortFormat);
}

QDate parse(const QString &text, const QLocale &locale)
{
    const QString trimmed = text.trimmed();
    QDate date = locale.toDate(trimmed, QLocale::ShortFormat);
    if (!date.isValid())
        date = locale.toDate(trimmed, QLocale::LongFormat);
    if (!date.isValid())
        date = QDate::fromString(trimmed, Qt::ISODate);
    if (date.isValid() && date.year() < 1950)
        date = date.addYears(100);
    return date;
}

} // namespace ShortDate
