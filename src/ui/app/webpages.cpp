// Veltrix — KPI dashboard for small businesses.
#include "webpages.h"

#include "app/appcontext.h"
#include "common/errorreporter.h"
#include "common/version.h"
#include "web/webpageopener.h"

#include <QScreen>
#include <QWidget>

using namespace Qt::StringLiterals;

namespace WebPages {

void open(AppContext &context, Prompter &prompter, const QWidget &window, const QString &url,
          const QSize &size)
{
    const QScreen *screen = window.screen();
    const QRect area = screen ? screen->availableGeometry() : QRect();
    if (const auto error = context.webPageOpener().openWebPage(url, size, area))
        ErrorReporter(prompter).reportError(error->number, error->description, u"Update"_s);
}

void openUpdatePage(AppContext &context, Prompter &prompter, const QWidget &window,
                    bool fromLoadingWindow)
{
    open(context, prompter, window,
         WebPageOpener::updatePageUrl(WebPageOpener::webHost(context.settingsStore()),
                                      AppInfo::appVersion(),
                                      context.mainDatabase().databaseVersion(), fromLoadingWindow),
         WebPageOpener::UpdateWindowSize);
}

void openCoachingPage(AppContext &context, Prompter &prompter, const QWidget &window)
{
    open(context, prompter, window,
         WebPageOpener::coachingPageUrl(WebPageOpener::webHost(context.settingsStore()),
                                        WebPageOpener::siteName(context.settingsStore())),
         WebPageOpener::CoachingWindowSize);
}

} // namespace WebPages
