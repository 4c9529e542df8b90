// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class AppContext;

// What start-up came to: nothing to say (go on to the main window), or the message that
// stopped it, and whether the way out is a newer program or database rather than new settings.
struct StartupOutcome
{
    QString message;
    bool failed = false;
    bool updateNeeded = false;
};

// Settings first, then the main database. A failed start leaves no connection open.
StartupOutcome runStartupSequence(AppContext &context);
