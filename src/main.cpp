// Veltrix — KPI dashboard for small businesses.

#include "app/appcontext.h"
#include "app/loadingwindow.h"
#include "app/prompter.h"
#include "app/qtprompter.h"
#include "app/settingsstore.h"
#include "app/shutdown.h"

#include <QApplication>
#include <QStyle>

using namespace Qt::StringLiterals;

int main(int argc, char *argv[])
{
    QApplication app(argc, argv);
    QApplication::setOrganizationName(u"Veltrix"_s);
    QApplication::setApplicationName(u"veltrix"_s);
    QApplication::setApplicationDisplayName(u"Veltrix"_s);

    QtPrompter prompter;
    AppContext context(std::make_unique<SettingsStore>(), prompter, AppLocations::forThisMachine());
    context.setPlatformScrollBarHeight(
        QApplication::style()->pixelMetric(QStyle::PM_ScrollBarExtent));

    auto *loading = new LoadingWindow(context, prompter);
    loading->setAttribute(Qt::WA_DeleteOnClose);
    QObject::connect(loading, &LoadingWindow::startupSucceeded, &app, [&] {
        // The main window is not part of this build yet: say where start-up got to, then end
        // the run in order.
        prompter.message(u"Start-up is complete: the database at "_s +
                             context.settings().mainDatabaseFile +
                             u" is connected (database version "_s +
                             context.mainDatabase().databaseVersion() + u")."_s,
                         u" Veltrix"_s, Prompter::Icon::Information);
        shutDown(context);
        QApplication::quit();
    });
    loading->show();
    loading->startLoading();
    return QApplication::exec();
}
