// Veltrix — KPI dashboard for small businesses.
#include "usercounter.h"

#include "database/maindatabase.h"
#include "database/sqliteconnection.h"

#include <QSqlError>
#include <QSqlQuery>

using namespace Qt::StringLiterals;

namespace {
// The stored text read as a whole number; text that is not one counts as 0.
const auto Count = u"CAST(Value AS INTEGER)"_s;
} // namespace

std::optional<DbError> UserCounter::execute(const QString &sql)
{
    QSqlQuery query(m_database.database());
    if (!query.exec(sql))
        return SqliteConnection::errorFrom(query.lastError());
    return std::nullopt;
}

std::optional<DbError> UserCounter::increment()
{
    return execute(u"UPDATE Config SET Value = CAST("_s + Count + u" + 1 AS TEXT) WHERE ID = 4"_s);
}

std::optional<DbError> UserCounter::decrement()
{
    return execute(u"UPDATE Config SET Value = CASE WHEN "_s + Count + u" >= 1 THEN CAST("_s +
                   Count + u" - 1 AS TEXT) ELSE '0' END WHERE ID = 4 AND "_s + Count + u" <> 0"_s);
}

std::optional<DbError> UserCounter::reset()
{
    QSqlDatabase database = m_database.database();
    if (!database.transaction())
        return SqliteConnection::errorFrom(database.lastError());
    std::optional<DbError> error = execute(u"UPDATE Config SET Value = '0' WHERE ID = 4"_s);
    if (!error)
        error = execute(u"UPDATE Config SET Value = 'Logoff' WHERE ID = 5"_s);
    if (error) {
        database.rollback();
        return error;
    }
    if (!database.commit())
        return SqliteConnection::errorFrom(database.lastError());
    return std::nullopt;
}

QString UserCounter::loggedInText(const QString &count)
{
    if (count.trimmed() == u"1"_s)
        return count + u" user is logged in"_s;
    return count + u" users are logged in"_s;
}
