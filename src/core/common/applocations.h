// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>
#include <QStringList>

// Where this copy of the program keeps its files. On Windows that is the program's own folder.
// Elsewhere the program folder is not writable, so the per-user data folder takes its place,
// and the read-only database template is looked for beside the executable and then in the
// installed data folder.
struct AppLocations
{
    QString appFolder;                 // ends in a separator
    QStringList newDatabaseCandidates; // first existing one wins
    // Working files (temporary folder, jobs.inf) in a folder of the process's own rather than
    // the program folder: for runs beside the desktop program, such as scheduled reports.
    bool privateWorkingFiles = false;

    static AppLocations forThisMachine();
    // Everything in one folder, as on Windows; used by tests and the demo workspace.
    static AppLocations inFolder(const QString &folder);

    QString newDatabaseFile() const;
};
