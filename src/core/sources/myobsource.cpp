// Veltrix — KPI dashboard for small businesses.
#include "myobsource.h"

#include "companyfile.h"

#include "app/errorreporter.h"
#include "database/sqliteconnection.h"
#include "engine/rounding.h"

#include <QAtomicInt>
#include <QLocale>
#include <QSqlError>
#include <QSqlQuery>

using namespace Qt::StringLiterals;

namespace {

constexpr int MaxJobs = 32767;

QString nextOdbcName()
{
    static QAtomicInt counter;
    return u"veltrix-myob-odbc-%1"_s.arg(counter.fetchAndAddRelaxed(1));
}

// Runs one of the fixed texts; the result is positioned on its first row when it has one.
std::optional<DbError> runQuery(QSqlQuery &query, const QString &sql)
{
    query.setForwardOnly(true);
    if (!query.exec(sql))
        return SqliteConnection::errorFrom(query.lastError());
    return std::nullopt;
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
    return u"Driver={"_s + settings.accFileDriver + u"}; TYPE=MYOB; UID="_s + settings.accFileUser
           + u"; PWD="_s + settings.accFilePass + u"; DATABASE="_s + settings.accFilePath + u";"_s;
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
        m_companyFile = std::make_unique<SqliteConnection>();
        if (const auto error = CompanyFile::open(*m_companyFile, m_settings.accFilePath)) {
            m_companyFile.reset();
            return error;
        }
        return std::nullopt;
    }
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

double MyobSource::accountMovement(const QString &accountCode, const QDate &from, const QDate &to)
{
    const QSqlDatabase db = database();
    QSqlQuery query(db);
    std::optional<DbError> error;
    double result = 0.0;
    if (!db.isOpen()) {
        error = DbError{DbError::RecordsetClosed,
                        u"Operation is not allowed when the object is closed."_s};
    } else if (!(error = runQuery(query, u"SELECT * FROM Accounts WHERE AccountNumber LIKE '"_s
                                             + accountCode + u"'"_s))) {
        if (query.next()) {
            const qint32 accountId = query.value(u"AccountID"_s).toInt();
            QSqlQuery total(db);
            error = runQuery(total,
                             u"SELECT SUM(TaxExclusiveAmount) As Total FROM JournalRecords WHERE "
                             u"AccountID='"_s
                                 + QString::number(accountId)
                                 + u"' AND TransactionDate BETWEEN '"_s + sqlDate(from)
                                 + u"' AND '"_s + sqlDate(to) + u"'"_s);
            if (!error && total.next()) {
                bool numeric = false;
                const double sum = total.value(0).toDouble(&numeric);
                result = numeric ? Rounding::halfAwayFromZero(sum, 2) : 0.0;
            }
        }
    }
    if (error) {
        ErrorReporter(m_prompter).reportError(error->number, error->description,
                                              u"GetMYOBValue for Account "_s + accountCode);
        return 0.0;
    }
    return result;
}

qint16 MyobSource::jobsCount(const QDate &from, const QDate &to)
{
    const QSqlDatabase db = database();
    QSqlQuery query(db);
    std::optional<DbError> error;
    int count = 0;
    if (!db.isOpen()) {
        error = DbError{DbError::RecordsetClosed,
                        u"Operation is not allowed when the object is closed."_s};
    } else if (!(error = runQuery(query, u"SELECT * FROM Sales WHERE Date BETWEEN '"_s
                                             + sqlDate(from) + u"' AND '"_s + sqlDate(to)
                                             + u"'"_s))) {
        while (query.next()) {
            if (++count > MaxJobs) {
                error = DbError{6, u"Overflow: more than %1 sales in the range."_s.arg(MaxJobs)};
                break;
            }
        }
    }
    if (error) {
        ErrorReporter(m_prompter).reportError(error->number, error->description,
                                              u"GetMYOBJobs"_s);
        return 0;
    }
    return qint16(count);
}
