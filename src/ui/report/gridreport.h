// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class AppContext;
class GridModel;
class QWidget;

// The print command of the KPI windows: the grid as a report page, with a picture of the bar
// graph below it when the graph is showing, opened in the print window.
namespace GridReport {

// "1/07/2025 to 30/06/2026": the produced range in the region's short date form.
QString reportTitle(AppContext &context);
// Captures the graph into the temporary bitmap; the path on success, empty otherwise.
QString captureGraphPicture(AppContext &context, QWidget &graph);
// Writes the report page of the grid; the page's path.
QString writeReportPage(AppContext &context, const GridModel &grid, const QString &exclusions,
                        const QString &picturePath);
void showGridReport(AppContext &context, QWidget *owner, const GridModel &grid,
                    const QString &exclusions, const QString &title, const QString &picturePath);
// The whole command: graph is the visible graph view, or nullptr on a tab without one.
void printGrid(AppContext &context, QWidget *owner, const GridModel &grid, QWidget *graph);

} // namespace GridReport
