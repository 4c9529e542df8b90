// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class AppContext;

// Opens the shared database for the run: the connection, the record sets that stay open, the
// figures cached from the last run, and the check that program and database fit each other.
// Returns the message that stops start-up, or empty text.
QString connectMainDatabase(AppContext &context);

// Closes the database and lets go of the accounting package. Errors are reported, never
// passed on.
void disconnectMainDatabase(AppContext &context);

// The version rule on its own: the message for the given versions, or empty text.
QString checkVersions(const QString &requiredVersion, const QString &databaseVersion,
                      const QString &appVersion, const class NumberFormat &numbers);
