// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QSqlDatabase>

#include <optional>

// One transaction on a connection, rolled back when it goes unless it was committed. A read
// transaction sees one state of the file from its first statement to its end, however other
// copies write meanwhile; a write transaction takes the write lock at once, so that it never
// has to upgrade a read lock another writer is waiting on.
class DatabaseTransaction
{
public:
    enum class Kind { Read, Write };

    DatabaseTransaction(QSqlDatabase database, Kind kind);
    ~DatabaseTransaction();
    DatabaseTransaction(const DatabaseTransaction &) = delete;
    DatabaseTransaction &operator=(const DatabaseTransaction &) = delete;

    // Why the transaction could not begin; nothing when it did.
    const std::optional<DbError> &beginError() const { return m_beginError; }
    std::optional<DbError> commit();

private:
    std::optional<DbError> execute(const QString &statement);

    QSqlDatabase m_database;
    std::optional<DbError> m_beginError;
    bool m_open = false;
};
