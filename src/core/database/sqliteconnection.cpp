// Veltrix — KPI dashboard for small businesses.
#include "sqliteconnection.h"

#include <QAtomicInt>
#include <QSqlDriver>
#include <QSqlError>
#include <QSqlQuery>
#include <QUrl>

#include <sqlite3.h>

using namespace Qt::StringLiterals;

namespace {

QString nextConnectionName()
{
    static QAtomicInt counter;
    return u"veltrix-sqlite-%1"_s.arg(counter.fetchAndAddRelaxed(1));
}

sqlite3 *handleOf(const QSqlDatabase &database)
{
    const QVariant handle = database.driver()->handle();
    if (!handle.isValid() || qstrcmp(handle.typeName(), "sqlite3*") != 0)
        return nullptr;
    return *static_cast<sqlite3 *const *>(handle.constData());
}

DbError errorFromCode(int code, const QString &description)
{
    switch (code & 0xFF) {
    case SQLITE_IOERR:
    case SQLITE_CANTOPEN:
        return {DbError::CommunicationFailure, description};
    default:
        return {code & 0xFF, description};
    }
}

} // namespace

SqliteConnection::SqliteConnection()
    : m_name(nextConnectionName())
{}

SqliteConnection::~SqliteConnection()
{
    close();
}

std::optional<DbError> SqliteConnection::open(const QString &file, Mode mode,
                                              const OpenHook &onOpened)
{
    close();
    m_file = file;
    QSqlDatabase database = QSqlDatabase::addDatabase(u"QSQLITE"_s, m_name);
    // A URI lets the open refuse a missing file instead of creating an empty database.
    QUrl uri = QUrl::fromLocalFile(file);
    switch (mode) {
    case Mode::ExistingFile:
        uri.setQuery(u"mode=rw"_s);
        break;
    case Mode::CreateFile:
        uri.setQuery(u"mode=rwc"_s);
        break;
    case Mode::ReadOnly:
        uri.setQuery(u"mode=ro"_s);
        break;
    }
    database.setDatabaseName(uri.toString(QUrl::FullyEncoded));
    database.setConnectOptions(u"QSQLITE_OPEN_URI;QSQLITE_BUSY_TIMEOUT=%1"_s.arg(m_busyTimeoutMs));
    if (!database.open())
        return errorFrom(database.lastError());
    if (onOpened)
        onOpened(handleOf(database));

    // The first statements touch the file: a file that is not a database fails here.
    QSqlQuery query(database);
    const QStringList pragmas =
        mode == Mode::ReadOnly
            ? QStringList{u"PRAGMA schema_version"_s}
            : QStringList{u"PRAGMA journal_mode=DELETE"_s, u"PRAGMA foreign_keys=ON"_s};
    for (const QString &pragma : pragmas) {
        if (!query.exec(pragma)) {
            const DbError error = errorFrom(query.lastError());
            query.finish();
            close();
            return error;
        }
    }
    return std::nullopt;
}

void SqliteConnection::close()
{
    if (!QSqlDatabase::contains(m_name))
        return;
    {
        QSqlDatabase database = QSqlDatabase::database(m_name, false);
        database.close();
    }
    QSqlDatabase::removeDatabase(m_name);
}

bool SqliteConnection::isOpen() const
{
    return QSqlDatabase::contains(m_name) && QSqlDatabase::database(m_name, false).isOpen();
}

QSqlDatabase SqliteConnection::database() const
{
    return QSqlDatabase::database(m_name, false);
}

sqlite3 *SqliteConnection::handle() const
{
    return isOpen() ? handleOf(database()) : nullptr;
}

std::optional<DbError> SqliteConnection::executeScript(const QString &sql)
{
    sqlite3 *handle = handleOf(database());
    if (!handle)
        return DbError{DbError::RecordsetClosed, u"The database is not open."_s};
    char *message = nullptr;
    const int code = sqlite3_exec(handle, sql.toUtf8().constData(), nullptr, nullptr, &message);
    if (code == SQLITE_OK)
        return std::nullopt;
    const QString description = QString::fromUtf8(message ? message : sqlite3_errstr(code));
    sqlite3_free(message);
    return errorFromCode(code, description);
}

DbError SqliteConnection::errorFrom(const QSqlError &error)
{
    bool numeric = false;
    const int code = error.nativeErrorCode().toInt(&numeric);
    const QString description =
        error.databaseText().isEmpty() ? error.text() : error.databaseText();
    // A failure must never carry the number 0, which the error report takes for no error: an
    // ODBC driver manager answers some failures with a native code of 0.
    if (!numeric || code == 0)
        return {DbError::CommunicationFailure, description};
    return errorFromCode(code, description);
}
