// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>
#include <QStringList>

class Prompter;
class SettingsStore;

// The connection settings as the configuration dialog edits them: read from the settings
// store, checked in a fixed order with a message for the first problem, and written only when
// every check passes. The running program keeps what it loaded; a change counts from the next
// start-up.
class SystemConfiguration
{
public:
    struct Values
    {
        QString dbPath;
        QString package; // "MYOB", "MoneyWorks", or whatever the store held
        QString accFilePath;
        QString driver;
        QString user;
        QString password; // plain
    };

    SystemConfiguration(SettingsStore &store, Prompter &prompter);

    // Without defaults: an empty store gives empty values.
    Values load() const;
    // Checks, and saves when every check passes. The database path comes back with its
    // closing separator, as it is stored.
    bool save(Values &values) const;

    // The drivers offered; "SQLite" is the built-in company-file engine.
    static QStringList driverNames();
    // A MoneyWorks document on a server (http:// or https://), which is not a file to check.
    static bool isServerAddress(const QString &path);
    // The file chooser's filter for the package's data files.
    static QString fileFilter(const QString &package);

private:
    SettingsStore &m_store;
    Prompter &m_prompter;
};
