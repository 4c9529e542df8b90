// Veltrix — KPI dashboard for small businesses.
#pragma once

// The accounting package the figures come from, as the rest of the program sees it.
class AccountingSource
{
public:
    virtual ~AccountingSource() = default;

    // Lets go of the package: closes the data file's connection or releases the running
    // application. Safe to call when nothing is open.
    virtual void disconnect() = 0;
};
