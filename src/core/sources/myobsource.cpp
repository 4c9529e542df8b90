// Veltrix — KPI dashboard for small businesses.
#include "myobsource.h"

#include "companyfile.h"
#include "odbcdrivers.h"

#include "common/errorreporter.h"
#include "common/rounding.h"
#include "database/sqliteconnection.h"

#include <QAtomicInt>
#include <QLocale>
#include <QSqlError>
#include <QSqlQuery>

#include <sqlite3.h>

using namespace Qt::StringLiterals;

namespace {

constexpr int MaxJobs = 32767;

QString nextOdbcName()
{
    static QAtomicInt counter;
    return u"veltrix-myob-odbc-%1"_s.arg(counter.fetchAndAddRelaxed(1));
}

DbError closedConnection()
{
    return {DbError::RecordsetClosed, u"Operation is not allowed when the object is closed."_s};
}

DbError engineError(sqlite3 *handle)
{
    return {sqlite3_errcode(handle) & 0xFF, QString::fromUtf8(sqlite3_errmsg(handle))};
}

// Runs one of the fixed texts; the result is positioned on its first row when it has one.
std::optional<DbError> runQuery(QSqlQuery &query, const QString &sql)
{
    query.setForwardOnly(true);
    if (!query.exec(sql))
        return SqliteConnection::errorFrom(query.lastError());
    return std::nullopt;
}

// The driver manager would only say that a data source was not found, and Qt passes that on
// without an error number, so nothing would be shown: the missing driver is named instead.
std::optional<DbError> missingDriver(const QString &driver)
{
    const auto where = u" The driver is set in the System Configuration (Database Options, "
                       u"Driver; the AccFileDriver setting)."_s;
    if (!QSqlDatabase::isDriverAvailable(u"QODBC"_s)) {
        return DbError{MyobSource::DriverMissingError,
                       u"This computer cannot use ODBC drivers: the Qt ODBC plugin (QODBC) is "
                       u"not installed."_s +
                           where};
    }
    const std::optional<QStringList> installed = OdbcDrivers::installed();
    if (!installed || installed->contains(driver, Qt::CaseInsensitive))
        return std::nullopt;
    const QString known = installed->isEmpty() ? u"none"_s : installed->join(u", "_s);
    return DbError{
        MyobSource::DriverMissingError,
        u"The ODBC driver \"%1\" is not installed on this computer (installed: %2)."_s.arg(driver,
                                                                                           known) +
            where};
}

} // namespace

MyobSource::MyobSource(const Settings &settings, Prompter &prompter)
    : m_settings(settings)
    , m_prompter(prompter)
{}

MyobSource::~MyobSource()
{
    disconnect();
}

QString MyobSource::connectionText(const Settings &settings)
{
    return u"Driver={"_s + settings.accFileDriver + u"}; TYPE=MYOB; UID="_s + settings.accFileUser +
           u"; PWD="_s + settings.accFilePass + u"; DATABASE="_s + settings.accFilePath + u";"_s;
}

bool MyobSource::usesBuiltInEngine(const Settings &settings)
{
    return settings.accFileDriver.compare(u"SQLite"_s, Qt::CaseInsensitive) == 0;
}

QString MyobSource::sqlDate(const QDate &date)
{
    return QLocale::c().toString(date, u"d MMM yyyy"_s);
}

QSqlDatabase MyobSource::database() const
{
    if (m_companyFile)
        return m_companyFile->database();
    if (!m_odbcName.isEmpty())
        return QSqlDatabase::database(m_odbcName, false);
    return {};
}

bool MyobSource::isReachable()
{
    return database().isOpen();
}

std::optional<DbError> MyobSource::openDataFile()
{
    disconnect();
    if (usesBuiltInEngine(m_settings)) {
        if (!CompanyFile::isCompanyFile(m_settings.accFilePath)) {
            return DbError{53, u"The company file '"_s + m_settings.accFilePath +
                                   u"' does not exist, cannot be reached or is not a "
                                   u"company file."_s};
        }
        m_companyFile = std::make_unique<SqliteConnection>();
        if (const auto error = CompanyFile::open(*m_companyFile, m_settings.accFilePath)) {
            m_companyFile.reset();
            return error;
        }
        return std::nullopt;
    }
    if (const auto missing = missingDriver(m_settings.accFileDriver))
        return missing;
    m_odbcName = nextOdbcName();
    QSqlDatabase odbc = QSqlDatabase::addDatabase(u"QODBC"_s, m_odbcName);
    odbc.setDatabaseName(connectionText(m_settings));
    if (!odbc.open(QString(), QString())) {
        const DbError error = SqliteConnection::errorFrom(odbc.lastError());
        disconnect();
        return error;
    }
    return std::nullopt;
}

void MyobSource::disconnect()
{
    m_companyFile.reset();
    if (m_odbcName.isEmpty())
        return;
    {
        QSqlDatabase odbc = QSqlDatabase::database(m_odbcName, false);
        odbc.close();
    }
    QSqlDatabase::removeDatabase(m_odbcName);
    m_odbcName.clear();
}

MyobSource::FirstRow MyobSource::firstRow(const QString &sql, const QString &column) const
{
    // The built-in engine is SQLite itself: ask it directly, without converting every column
    // of the row on the way.
    if (sqlite3 *handle = m_companyFile ? m_companyFile->handle() : nullptr) {
        sqlite3_stmt *statement = nullptr;
        const QByteArray text = sql.toUtf8();
        if (sqlite3_prepare_v2(handle, text.constData(), int(text.size()), &statement, nullptr) !=
            SQLITE_OK) {
            return {std::nullopt, engineError(handle)};
        }
        FirstRow result;
        const int step = sqlite3_step(statement);
        if (step == SQLITE_ROW) {
            for (int i = 0; i < sqlite3_column_count(statement); ++i) {
                if (column.compare(QLatin1StringView(sqlite3_column_name(statement, i)),
                                   Qt::CaseInsensitive) != 0)
                    continue;
                switch (sqlite3_column_type(statement, i)) {
                case SQLITE_NULL:
                    result.value = QVariant();
                    break;
                case SQLITE_INTEGER:
                    result.value = QVariant(qlonglong(sqlite3_column_int64(statement, i)));
                    break;
                case SQLITE_FLOAT:
                    result.value = QVariant(sqlite3_column_double(statement, i));
                    break;
                default:
                    result.value = QVariant(QString::fromUtf8(
                        reinterpret_cast<const char *>(sqlite3_column_text(statement, i))));
                    break;
                }
                break;
            }
            if (!result.value)
                result.value = QVariant();
        } else if (step != SQLITE_DONE) {
            result.error = engineError(handle);
        }
        sqlite3_finalize(statement);
        return result;
    }

    QSqlQuery query(database());
    if (const auto error = runQuery(query, sql))
        return {std::nullopt, error};
    if (!query.next())
        return {};
    return {query.value(column), std::nullopt};
}

MyobSource::RowCount MyobSource::countRows(const QString &sql, int limit) const
{
    RowCount result;
    if (sqlite3 *handle = m_companyFile ? m_companyFile->handle() : nullptr) {
        sqlite3_stmt *statement = nullptr;
        const QByteArray text = sql.toUtf8();
        if (sqlite3_prepare_v2(handle, text.constData(), int(text.size()), &statement, nullptr) !=
            SQLITE_OK) {
            return {0, engineError(handle)};
        }
        int step = SQLITE_ROW;
        while (result.rows <= limit && (step = sqlite3_step(statement)) == SQLITE_ROW)
            ++result.rows;
        if (step != SQLITE_ROW && step != SQLITE_DONE)
            result.error = engineError(handle);
        sqlite3_finalize(statement);
        return result;
    }

    QSqlQuery query(database());
    if (const auto error = runQuery(query, sql))
        return {0, error};
    while (result.rows <= limit && query.next())
        ++result.rows;
    return result;
}

double MyobSource::accountMovement(const QString &accountCode, const QDate &from, const QDate &to)
{
    std::optional<DbError> error;
    double result = 0.0;
    if (!database().isOpen()) {
        error = closedConnection();
    } else {
        const FirstRow account =
            firstRow(u"SELECT * FROM Accounts WHERE AccountNumber LIKE '"_s + accountCode + u"'"_s,
                     u"AccountID"_s);
        error = account.error;
        if (account.value) {
            const qint32 accountId = account.value->toInt();
            const FirstRow total = firstRow(
                u"SELECT SUM(TaxExclusiveAmount) As Total FROM JournalRecords WHERE AccountID='"_s +
                    QString::number(accountId) + u"' AND TransactionDate BETWEEN '"_s +
                    sqlDate(from) + u"' AND '"_s + sqlDate(to) + u"'"_s,
                u"Total"_s);
            error = total.error;
            if (total.value) {
                bool numeric = false;
                const double sum = total.value->toDouble(&numeric);
                result = numeric ? Rounding::halfAwayFromZero(sum, 2) : 0.0;
            }
        }
    }
    if (error) {
        ErrorReporter(m_prompter)
            .reportError(error->number, error->description,
                         u"GetMYOBValue for Account "_s + accountCode);
        return 0.0;
    }
    return result;
}

qint16 MyobSource::jobsCount(const QDate &from, const QDate &to)
{
    RowCount count;
    if (!database().isOpen()) {
        count.error = closedConnection();
    } else {
        count = countRows(u"SELECT * FROM Sales WHERE Date BETWEEN '"_s + sqlDate(from) +
                              u"' AND '"_s + sqlDate(to) + u"'"_s,
                          MaxJobs);
        if (!count.error && count.rows > MaxJobs)
            count.error = DbError{6, u"Overflow: more than %1 sales in the range."_s.arg(MaxJobs)};
    }
    if (count.error) {
        ErrorReporter(m_prompter)
            .reportError(count.error->number, count.error->description, u"GetMYOBJobs"_s);
        return 0;
    }
    return qint16(count.rows);
}
