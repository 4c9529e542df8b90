// Veltrix — KPI dashboard for small businesses.

#include "app/appcontext.h"
#include "app/qtprompter.h"
#include "app/settingsloader.h"
#include "app/settingsstore.h"

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

    // Start-up goes as far as the settings for now: a problem with them is shown and ends
    // the run, as nothing after the settings can work without them.
    prompter.setBusyPointer();
    const QString problem = loadSettings(context);
    prompter.setNormalPointer();
    if (!problem.isEmpty()) {
        prompter.message(problem, u" Veltrix"_s, Prompter::Icon::Exclamation);
        return 1;
    }
    prompter.message(u"Settings loaded; the main database is at "_s +
                         context.settings().mainDatabaseFile,
                     u" Veltrix"_s, Prompter::Icon::Information);
    return 0;
}
