// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QString>

#include <optional>

class MainDatabase;
class Prompter;

// The numbered values of the Config table, read fresh each time so that what other copies of
// the program wrote is seen.
class ConfigValues
{
public:
    enum Id : qint32 {
        DatabaseVersion = 1,
        RequiredVersion = 2,
        UserCount = 4,
        NetworkRequest = 5,
    };

    ConfigValues(MainDatabase &database, Prompter &prompter);

    // Empty when the row is missing (which is reported).
    QString getConfigValue(qint32 id) const;
    // A missing row is reported; a write that another copy's change overtook comes back as
    // an error for the caller to handle.
    std::optional<DbError> setConfigValue(qint32 id, const QString &value) const;

private:
    bool findRow(qint32 id) const;

    MainDatabase &m_database;
    Prompter &m_prompter;
};
