// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "accountingsource.h"

#include <memory>

class NumberFormat;
class Prompter;
struct Settings;

// The source for the configured accounting package, or nothing for a package this build
// cannot read.
std::unique_ptr<AccountingSource>
createAccountingSource(const Settings &settings, Prompter &prompter, const NumberFormat &numbers);
