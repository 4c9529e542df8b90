// Veltrix — KPI dashboard for small businesses.
#include "shutdown.h"

#include "app/contextwiring.h"
#include "appcontext.h"
#include "common/fileoperations.h"
#include "common/settingsstore.h"

#include "engine/cachefile.h"
#include "mainconnector.h"
#include "users/loginsession.h"
#include "web/webpageopener.h"

#include <cstdlib>

void shutDown(AppContext &context)
{
    const PeriodDataSet::Slot &slot0 = context.periodDataSet().slot(0);
    if (!slot0.isEmpty() && !context.periodDataSet().isFilling(0) &&
        !context.settings().cacheFile.isEmpty())
        CacheFile::write(context.settings().cacheFile, slot0);

    if (context.loginState().loggedIn && context.mainDatabase().isConnected())
        ContextWiring::loginSession(context).logoff(false);

    context.webPageOpener().closeWindow();
    disconnectMainDatabase(context);

    if (!context.settings().tempFolder.isEmpty())
        FileOperations::clearFolder(context.settings().tempFolder);
    // The program ends without running destructors: a private folder goes now, with the lock.
    context.workingFolder().release();
}

void endProgramNow(AppContext &context)
{
    context.settingsStore().sync();
    std::_Exit(0);
}
