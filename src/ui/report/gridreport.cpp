// Veltrix — KPI dashboard for small businesses.
#include "gridreport.h"

#include "printwindow.h"

#include "app/appcontext.h"
#include "common/errorreporter.h"
#include "common/fileoperations.h"
#include "common/numberformat.h"
#include "common/prompter.h"
#include "engine/perioddataset.h"
#include "report/graphsnapshot.h"
#include "report/gridhtml.h"
#include "views/grapharea.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"

using namespace Qt::StringLiterals;

namespace GridReport {

QString reportTitle(AppContext &context)
{
    const PeriodDataSet::Range range = context.periodDataSet().range(0);
    return GridHtml::reportTitle(range.start, range.end, context.numberFormat().locale(),
                                 context.clock().today());
}

QString pageTitle(AppContext &context, const KpiTabView &view)
{
    const QString tab = TabViewBuilder::tabCaptions().value(view.currentTab()).remove(u'&');
    return tab.isEmpty() ? reportTitle(context) : tab + u": "_s + reportTitle(context);
}

QString graphPicture(AppContext &context, KpiTabView &view)
{
    if (view.currentTab() != TabViewBuilder::SummaryTab)
        return {};
    const Settings &settings = context.settings();
    FileOperations::folderExists(settings.tempFolder, true);
    // Rendering the view draws its bars, which are child widgets, into the same picture.
    const QImage rendered = view.picGraph()->grab().toImage();
    if (const std::optional<QString> failure =
            GraphSnapshot::writeSnapshot(rendered, {settings.tempGifFile, settings.tempBmpFile})) {
        context.prompter().message(*failure, u"Print"_s, Prompter::Icon::Exclamation);
        return {};
    }
    return settings.tempBmpFile;
}

void showGridReport(AppContext &context, QWidget *owner, const GridModel &grid,
                    const QString &exclusions, const QString &title, const QString &picturePath)
{
    const QString page = context.settings().tempHtmlFile;
    FileOperations::folderExists(context.settings().tempFolder, true);
    FileOperations::writeTextFile(page, GridHtml::reportPage(grid, exclusions, picturePath),
                                  context.prompter());
    PrintWindow::loadPage(context, owner, page, title);
}

void printGrid(AppContext &context, QWidget *owner, KpiTabView &view)
{
    const QString picture = graphPicture(context, view);
    showGridReport(context, owner, view.grid(), u"id"_s, pageTitle(context, view), picture);
}

} // namespace GridReport
