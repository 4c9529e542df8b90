// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

#include <optional>

// The ODBC drivers installed on this computer, as the driver manager lists them.
namespace OdbcDrivers {

// Their names, or nothing when the list cannot be had (no driver manager).
std::optional<QStringList> installed();

} // namespace OdbcDrivers
