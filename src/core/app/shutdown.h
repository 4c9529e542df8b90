// Veltrix — KPI dashboard for small businesses.
#pragma once

class AppContext;

// The orderly end of a run: keeps slot 0's figures for the next start, takes a logged-in user
// off the shared counter, closes the browser window it opened, disconnects and removes the
// temporary folder. No step's failure stops the ones after it. Ending the process is left to
// the caller.
void shutDown(AppContext &context);
// After shutDown: flushes the settings and ends the process there and then, so that no
// dialog or window still open gets another event over a closed database.
[[noreturn]] void endProgramNow(AppContext &context);
