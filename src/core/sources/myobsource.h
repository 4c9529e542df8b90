// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "accountingsource.h"

#include "common/settings.h"

#include <QSqlDatabase>

#include <memory>

class Prompter;
class SqliteConnection;

// MYOB figures through SQL: the fixed query texts go to the MYOB ODBC driver, or, when the
// configured driver is "SQLite", to the built-in engine reading a company file.
class MyobSource final : public AccountingSource
{
public:
    MyobSource(const Settings &settings, Prompter &prompter);
    ~MyobSource() override;

    // The configured ODBC driver is not installed here.
    static constexpr qint32 DriverMissingError = 3706;

    // "Driver={...}; TYPE=MYOB; UID=...; PWD=...; DATABASE=...;"
    static QString connectionText(const Settings &settings);
    static bool usesBuiltInEngine(const Settings &settings);
    // "1 Jul 2006": the date form of the SQL texts.
    static QString sqlDate(const QDate &date);

    bool isReachable() override;
    std::optional<DbError> openDataFile() override;
    void disconnect() override;

    // The tax-exclusive movement of the first account whose number is LIKE the code, to two
    // decimals; 0 for no account, no records or an error (reported once per code).
    double accountMovement(const QString &accountCode, const QDate &from, const QDate &to) override;
    // The number of sales dated in the range; more than 32767 is reported, not wrapped.
    qint16 jobsCount(const QDate &from, const QDate &to) override;

    double getMYOBValue(const QString &accountCode, const QDate &from, const QDate &to)
    {
        return accountMovement(accountCode, from, to);
    }
    qint16 getMYOBJobs(const QDate &from, const QDate &to) { return jobsCount(from, to); }

private:
    // The first row's value of one column of a query, or nothing when there is no row.
    struct FirstRow
    {
        std::optional<QVariant> value;
        std::optional<DbError> error;
    };
    struct RowCount
    {
        int rows = 0;
        std::optional<DbError> error;
    };

    QSqlDatabase database() const;
    FirstRow firstRow(const QString &sql, const QString &column) const;
    // Stops counting past the limit.
    RowCount countRows(const QString &sql, int limit) const;

    const Settings &m_settings;
    Prompter &m_prompter;
    std::unique_ptr<SqliteConnection> m_companyFile;
    QString m_odbcName;
};
