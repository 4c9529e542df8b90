// Veltrix — KPI dashboard for small businesses.

#include "app/appcontext.h"
#include "app/loadingwindow.h"
#include "app/qtprompter.h"
#include "app/shutdown.h"
#include "app/widgetplacement.h"
#include "common/prompter.h"
#include "common/settingsstore.h"
#include "main/mainwindow.h"

#include <QApplication>
#include <QStyle>

using namespace Qt::StringLiterals;

int main(int argc, char *argv[])
{
    QApplication app(argc, argv);
    QApplication::setOrganizationName(u"Veltrix"_s);
    QApplication::setApplicationName(u"veltrix"_s);

    QtPrompter prompter;
    AppContext context(std::make_unique<SettingsStore>(), prompter, AppLocations::forThisMachine());
    context.setPlatformScrollBarHeight(
        QApplication::style()->pixelMetric(QStyle::PM_ScrollBarExtent));

    auto *loading = new LoadingWindow(context, prompter);
    loading->setAttribute(Qt::WA_DeleteOnClose);
    std::unique_ptr<MainWindow> mainWindow;
    QObject::connect(loading, &LoadingWindow::startupSucceeded, &app, [&] {
        mainWindow = std::make_unique<MainWindow>(context, prompter);
        mainWindow->setProgramEnd([&context] { endProgramNow(context); });
        prompter.setParentWindow(mainWindow.get());
        WidgetPlacement::fitToScreen(*mainWindow);
        mainWindow->show();
    });
    WidgetPlacement::fitToScreen(*loading);
    loading->show();
    loading->startLoading();
    return QApplication::exec();
}
