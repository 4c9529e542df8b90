// Veltrix — KPI dashboard for small businesses.
#include "companyfilewriter.h"

#include "companyfile.h"

#include <QFile>

#include <sqlite3.h>

using namespace Qt::StringLiterals;

namespace {

QByteArray isoDate(const QDate &date)
{
    return date.toString(Qt::ISODate).toLatin1();
}

} // namespace

CompanyFileWriter::~CompanyFileWriter()
{
    close();
}

std::optional<QString> CompanyFileWriter::failure(const char *what)
{
    const QString problem = u"%1: %2"_s.arg(
        QLatin1StringView(what), QString::fromUtf8(m_db ? sqlite3_errmsg(m_db) : "out of memory"));
    close();
    return problem;
}

std::optional<QString> CompanyFileWriter::create(const QString &path)
{
    close();
    QFile::remove(path);
    if (sqlite3_open_v2(QFile::encodeName(path).constData(), &m_db,
                        SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, nullptr) != SQLITE_OK)
        return failure("cannot create the company file");
    CompanyFile::registerMyobDate(m_db);
    const QByteArray schema = CompanyFile::schemaSql().toUtf8();
    if (sqlite3_exec(m_db, "PRAGMA journal_mode=DELETE; PRAGMA synchronous=OFF;", nullptr, nullptr,
                     nullptr) != SQLITE_OK ||
        sqlite3_exec(m_db, schema.constData(), nullptr, nullptr, nullptr) != SQLITE_OK ||
        sqlite3_exec(m_db, "BEGIN", nullptr, nullptr, nullptr) != SQLITE_OK)
        return failure("cannot lay out the company file");
    if (sqlite3_prepare_v2(m_db, "INSERT INTO Accounts (AccountNumber, AccountName) VALUES (?, ?)",
                           -1, &m_account, nullptr) != SQLITE_OK ||
        sqlite3_prepare_v2(m_db,
                           "INSERT INTO JournalRecords (AccountID, TransactionDate, "
                           "TaxExclusiveAmount, Memo) VALUES (?, ?, ?, ?)",
                           -1, &m_journal, nullptr) != SQLITE_OK ||
        sqlite3_prepare_v2(m_db, "INSERT INTO Sales (Date, InvoiceNumber) VALUES (?, ?)", -1,
                           &m_sale, nullptr) != SQLITE_OK)
        return failure("cannot prepare the company file");
    return std::nullopt;
}

qint64 CompanyFileWriter::addAccount(const QString &number, const QString &name)
{
    if (!m_db)
        return 0;
    const QByteArray numberText = number.toUtf8();
    const QByteArray nameText = name.toUtf8();
    sqlite3_bind_text(m_account, 1, numberText.constData(), int(numberText.size()),
                      SQLITE_TRANSIENT);
    sqlite3_bind_text(m_account, 2, nameText.constData(), int(nameText.size()), SQLITE_TRANSIENT);
    if (sqlite3_step(m_account) != SQLITE_DONE && m_problem.isEmpty())
        m_problem = QString::fromUtf8(sqlite3_errmsg(m_db));
    sqlite3_reset(m_account);
    return sqlite3_last_insert_rowid(m_db);
}

void CompanyFileWriter::addJournalLine(qint64 accountId, const QDate &date, double amount,
                                       const QString &memo)
{
    if (!m_db)
        return;
    const QByteArray day = isoDate(date);
    const QByteArray memoText = memo.toUtf8();
    sqlite3_bind_int64(m_journal, 1, accountId);
    sqlite3_bind_text(m_journal, 2, day.constData(), int(day.size()), SQLITE_TRANSIENT);
    sqlite3_bind_double(m_journal, 3, amount);
    sqlite3_bind_text(m_journal, 4, memoText.constData(), int(memoText.size()), SQLITE_TRANSIENT);
    if (sqlite3_step(m_journal) != SQLITE_DONE && m_problem.isEmpty())
        m_problem = QString::fromUtf8(sqlite3_errmsg(m_db));
    sqlite3_reset(m_journal);
}

void CompanyFileWriter::addSale(const QDate &date, const QString &invoiceNumber)
{
    if (!m_db)
        return;
    const QByteArray day = isoDate(date);
    const QByteArray invoice = invoiceNumber.toUtf8();
    sqlite3_bind_text(m_sale, 1, day.constData(), int(day.size()), SQLITE_TRANSIENT);
    sqlite3_bind_text(m_sale, 2, invoice.constData(), int(invoice.size()), SQLITE_TRANSIENT);
    if (sqlite3_step(m_sale) != SQLITE_DONE && m_problem.isEmpty())
        m_problem = QString::fromUtf8(sqlite3_errmsg(m_db));
    sqlite3_reset(m_sale);
}

std::optional<QString> CompanyFileWriter::finish()
{
    if (!m_db)
        return u"The company file is not open."_s;
    if (!m_problem.isEmpty()) {
        const QString problem = m_problem;
        close();
        return problem;
    }
    if (sqlite3_exec(m_db, "COMMIT; ANALYZE;", nullptr, nullptr, nullptr) != SQLITE_OK)
        return failure("cannot complete the company file");
    close();
    return std::nullopt;
}

void CompanyFileWriter::close()
{
    for (sqlite3_stmt **statement : {&m_account, &m_journal, &m_sale}) {
        sqlite3_finalize(*statement);
        *statement = nullptr;
    }
    if (m_db)
        sqlite3_close(m_db);
    m_db = nullptr;
    m_problem.clear();
}
