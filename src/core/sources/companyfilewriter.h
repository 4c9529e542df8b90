// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QDate>
#include <QString>

#include <optional>

struct sqlite3;
struct sqlite3_stmt;

// Writes a company file in one transaction: accounts, journal lines and sales. Used to make
// the demo company, test ledgers and benchmark files; the program itself only reads them.
class CompanyFileWriter
{
public:
    CompanyFileWriter() = default;
    ~CompanyFileWriter();
    CompanyFileWriter(const CompanyFileWriter &) = delete;
    CompanyFileWriter &operator=(const CompanyFileWriter &) = delete;

    // Replaces any file at the path with an empty company file.
    std::optional<QString> create(const QString &path);

    // The new account's ID.
    qint64 addAccount(const QString &number, const QString &name);
    // Debits positive, credits negative.
    void addJournalLine(qint64 accountId, const QDate &date, double amount,
                        const QString &memo = {});
    void addSale(const QDate &date, const QString &invoiceNumber);

    // Commits and closes; the file is complete only after this.
    std::optional<QString> finish();

private:
    std::optional<QString> failure(const char *what);
    void close();

    sqlite3 *m_db = nullptr;
    sqlite3_stmt *m_account = nullptr;
    sqlite3_stmt *m_journal = nullptr;
    sqlite3_stmt *m_sale = nullptr;
    QString m_problem;
};
