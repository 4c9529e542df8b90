// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QString>

#include <optional>

class MainDatabase;

// The number of users logged in on all copies, kept as a whole number in Config row 4. Each
// change is one statement in the database, so copies that log in or off at the same moment
// never lose a count; the count never goes below 0.
class UserCounter
{
public:
    explicit UserCounter(MainDatabase &database)
        : m_database(database)
    {}

    std::optional<DbError> increment();
    // One less when above 0; a negative count becomes 0; 0 stays.
    std::optional<DbError> decrement();
    // The counter to 0 and a "Logoff" request to every copy, together.
    std::optional<DbError> reset();

    // The status bar's text for the count as read: "3 users are logged in", "1 user is logged
    // in".
    static QString loggedInText(const QString &count);

private:
    std::optional<DbError> execute(const QString &sql);
    std::optional<DbError> execute(const QStringList &statements);
    std::optional<DbError> executeOnce(const QStringList &statements);

    MainDatabase &m_database;
};
