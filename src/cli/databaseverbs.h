// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

namespace DatabaseVerbs {

// create-database SCRIPT OUTPUT: makes a database file from a SQL script (the build makes
// new.db this way).
int createDatabase(const QStringList &arguments);

} // namespace DatabaseVerbs
