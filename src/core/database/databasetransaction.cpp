// Veltrix — KPI dashboard for small businesses.
#include "databasetransaction.h"

#include "sqliteconnection.h"

#include <QSqlError>
#include <QSqlQuery>

using namespace Qt::StringLiterals;

DatabaseTransaction::DatabaseTransaction(QSqlDatabase database, Kind kind)
    : m_database(std::move(database))
{
    m_beginError = execute(kind == Kind::Read ? u"BEGIN"_s : u"BEGIN IMMEDIATE"_s);
    m_open = !m_beginError;
}

DatabaseTransaction::~DatabaseTransaction()
{
    if (m_open)
        execute(u"ROLLBACK"_s);
}

std::optional<DbError> DatabaseTransaction::commit()
{
    if (!m_open)
        return m_beginError;
    if (const auto error = execute(u"COMMIT"_s))
        return error; // still open: the destructor rolls it back
    m_open = false;
    return std::nullopt;
}

std::optional<DbError> DatabaseTransaction::execute(const QString &statement)
{
    if (!m_database.isOpen())
        return DbError{DbError::RecordsetClosed, u"The database is not open."_s};
    QSqlQuery query(m_database);
    if (!query.exec(statement))
        return SqliteConnection::errorFrom(query.lastError());
    return std::nullopt;
}
