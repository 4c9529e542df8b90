// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <functional>

class AppContext;

// The orderly end of a run: keeps slot 0's figures for the next start, logs the user off the
// shared counter (through the given step, which the login code supplies), closes the browser
// window it opened, disconnects and removes the temporary folder. No step's failure stops the
// ones after it. Ending the process is left to the caller.
void shutDown(AppContext &context, const std::function<void()> &logOffCurrentUser = {});
