// Veltrix — KPI dashboard for small businesses.
#include "startupsequence.h"

#include "appcontext.h"
#include "settingsloader.h"

#include "mainconnector.h"

using namespace Qt::StringLiterals;

StartupOutcome runStartupSequence(AppContext &context)
{
    StartupOutcome outcome;
    outcome.message = loadSettings(context);
    if (outcome.message.isEmpty()) {
        outcome.message = connectMainDatabase(context);
        outcome.updateNeeded = outcome.message.contains(u"update"_s);
    }
    outcome.failed = !outcome.message.isEmpty();
    if (outcome.failed && context.mainDatabase().isConnected())
        disconnectMainDatabase(context);
    return outcome;
}
