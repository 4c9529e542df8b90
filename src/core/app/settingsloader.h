// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class AppContext;

// The first step of start-up: derives the program's paths, reads and checks the connection
// settings into the context's settings record and makes sure the main database file exists,
// creating it from the template on first use. Returns the message that stops start-up, or
// empty text when the program may go on.
QString loadSettings(AppContext &context);

inline const QString DatabasePathTooLong = QStringLiteral(
    "The database path in your settings is longer than 1000 characters, so it was not used and "
    "no database was opened or created. Set the database path again in the System "
    "Configuration.");

inline const QString NoWorkingFolder =
    QStringLiteral("Veltrix found no folder for the working files of this run (the report page, "
                   "the graph's picture and the MoneyWorks export). Make room on the disk or "
                   "check the rights on the temporary folder.");
