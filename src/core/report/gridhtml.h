// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QColor>
#include <QDate>
#include <QLocale>
#include <QString>
#include <QStringList>

class GridModel;

// The printed report: a page holding a grid as an HTML table and, below it, an optional
// picture. Texts go into the page as they are, so a cell may carry its own mark-up.
namespace GridHtml {

// "#RRGGBB" of a colour held as red in the low byte, green in the next and blue above.
QString colourToHtml(quint32 colour);
QString colourToHtml(const QColor &colour);
bool isInList(const QStringList &list, const QString &text, bool caseSensitive);
// The table of the grid's visible rows and of its visible columns whose key is not in the
// comma-separated exclusion list (compared without regard to case).
QString gridToHtml(const GridModel &grid, const QString &exclusions);
// The whole page; the picture paragraph only when the path names an existing file.
QString reportPage(const GridModel &grid, const QString &exclusions, const QString &picturePath);
// The report's title: the produced range, "1/7/25 to 30/6/26" in the region's short dates,
// with "(to date: 7 Dec 2026)" after it when the range ends after today.
QString reportTitle(const QDate &start, const QDate &end, const QLocale &locale,
                    const QDate &today = {});
// A font size as the page writes it: "10.25", "12".
QString fontSizeText(double points);

} // namespace GridHtml
