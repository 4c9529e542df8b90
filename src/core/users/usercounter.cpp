// Veltrix — KPI dashboard for small businesses.
#include "usercounter.h"

#include "database/databasetransaction.h"
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
    return execute(QStringList{sql});
}

std::optional<DbError> UserCounter::execute(const QStringList &statements)
{
    // Many copies logging in at once may keep the file locked longer than one wait allows;
    // the count is tried again before a copy gives up and says so.
    constexpr int Attempts = 3;
    constexpr int Busy = 5;
    std::optional<DbError> error;
    for (int attempt = 0; attempt < Attempts; ++attempt) {
        error = executeOnce(statements);
        if (!error || error->number != Busy)
            break;
    }
    return error;
}

std::optional<DbError> UserCounter::executeOnce(const QStringList &statements)
{
    // The write lock is taken before the count is read: a statement that read first and then
    // asked to write could meet another copy waiting to write, and the engine gives one of
    // them up at once ("database is locked") rather than let them wait on each other.
    DatabaseTransaction transaction(m_database.database(), DatabaseTransaction::Kind::Write);
    if (transaction.beginError())
        return transaction.beginError();
    for (const QString &sql : statements) {
        QSqlQuery query(m_database.database());
        if (!query.exec(sql))
            return SqliteConnection::errorFrom(query.lastError());
    }
    return transaction.commit();
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
    return execute(QStringList{u"UPDATE Config SET Value = '0' WHERE ID = 4"_s,
                               u"UPDATE Config SET Value = 'Logoff' WHERE ID = 5"_s});
}

QString UserCounter::loggedInText(const QString &count)
{
    if (count.trimmed() == u"1"_s)
        return count + u" user is logged in"_s;
    return count + u" users are logged in"_s;
}
