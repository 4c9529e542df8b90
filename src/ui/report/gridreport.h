// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class AppContext;
class GridModel;
class KpiTabView;
class QWidget;

// The print command of the KPI windows: the grid as a report page, with a picture of the bar
// graph below it when the graph is showing, opened in the print window.
namespace GridReport {

// "1/7/25 to 30/6/26": the produced range in the region's short date form; a range that ends
// after today says how far its figures go: "1/7/26 to 30/6/27 (to date: 7 Dec 2026)".
QString reportTitle(AppContext &context);
// The title of a printed page: the tab the grid shows, then the range ("Summary: 1/7/25 to
// 30/6/26"), so that a loose page says what it is.
QString pageTitle(AppContext &context, const KpiTabView &view);
// The picture of the view's graph in the temporary bitmap when the view shows its graph (the
// Summary tab); empty on other tabs or when the picture could not be made (said so).
QString graphPicture(AppContext &context, KpiTabView &view);
void showGridReport(AppContext &context, QWidget *owner, const GridModel &grid,
                    const QString &exclusions, const QString &title, const QString &picturePath);
// The Print command of a KPI window: its grid, and its graph when it shows one.
void printGrid(AppContext &context, QWidget *owner, KpiTabView &view);

} // namespace GridReport
