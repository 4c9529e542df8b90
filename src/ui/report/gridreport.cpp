// Veltrix — KPI dashboard for small businesses.
#include "gridreport.h"

#include "printwindow.h"

#include "app/appcontext.h"
#include "app/errorreporter.h"
#include "app/fileoperations.h"
#include "app/numberformat.h"
#include "app/prompter.h"
#include "engine/perioddataset.h"
#include "report/graphsnapshot.h"
#include "report/gridhtml.h"

#include <QWidget>

using namespace Qt::StringLiterals;

namespace GridReport {

QString reportTitle(AppContext &context)
{
    const PeriodDataSet::Range range = context.periodDataSet().range(0);
    const QLocale &locale = context.numberFormat().locale();
    return locale.toString(range.start, QLocale::ShortFormat) + u" to "_s +
           locale.toString(range.end, QLocale::ShortFormat);
}

QString captureGraphPicture(AppContext &context, QWidget &graph)
{
    const Settings &settings = context.settings();
    FileOperations::folderExists(settings.tempFolder, true);
    // Rendering the view draws its bars, which are child widgets, into the same picture.
    const QImage rendered = graph.grab().toImage();
    if (const std::optional<QString> failure =
            GraphSnapshot::writeSnapshot(rendered, {settings.tempGifFile, settings.tempBmpFile})) {
        context.prompter().message(*failure, u"Print"_s, Prompter::Icon::Exclamation);
        return {};
    }
    return settings.tempBmpFile;
}

QString writeReportPage(AppContext &context, const GridModel &grid, const QString &exclusions,
                        const QString &picturePath)
{
    const QString path = context.settings().tempHtmlFile;
    FileOperations::folderExists(context.settings().tempFolder, true);
    FileOperations::writeTextFile(path, GridHtml::reportPage(grid, exclusions, picturePath),
                                  context.prompter());
    return path;
}

void showGridReport(AppContext &context, QWidget *owner, const GridModel &grid,
                    const QString &exclusions, const QString &title, const QString &picturePath)
{
    const QString page = writeReportPage(context, grid, exclusions, picturePath);
    PrintWindow::loadPage(context, owner, page, title);
}

void printGrid(AppContext &context, QWidget *owner, const GridModel &grid, QWidget *graph)
{
    const QString picture = graph ? captureGraphPicture(context, *graph) : QString();
    showGridReport(context, owner, grid, u"id"_s, reportTitle(context), picture);
}

} // namespace GridReport
