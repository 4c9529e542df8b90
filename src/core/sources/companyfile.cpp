// Veltrix — KPI dashboard for small businesses.
#include "companyfile.h"

#include "database/sqliteconnection.h"

#include <QFile>
#include <QSqlQuery>

#include <sqlite3.h>

#include <cstring>

using namespace Qt::StringLiterals;

namespace CompanyFile {

namespace {

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

int digits(QByteArrayView text, qsizetype from, qsizetype count)
{
    int value = 0;
    for (qsizetype i = from; i < from + count; ++i) {
        if (!isDigit(text[i]))
            return -1;
        value = value * 10 + (text[i] - '0');
    }
    return value;
}

int monthNumber(QByteArrayView name)
{
    static constexpr char Months[] = "janfebmaraprmayjunjulaugsepoctnovdec";
    if (name.size() != 3)
        return 0;
    char lower[3];
    for (int i = 0; i < 3; ++i) {
        const char c = name[i];
        lower[i] = (c >= 'A' && c <= 'Z') ? char(c - 'A' + 'a') : c;
    }
    for (int month = 0; month < 12; ++month) {
        if (std::memcmp(Months + month * 3, lower, 3) == 0)
            return month + 1;
    }
    return 0;
}

int keyOf(int year, int month, int day)
{
    if (year < 0 || month < 1 || month > 12 || day < 1 || day > 31)
        return 0;
    return year * 10000 + month * 100 + day;
}

int collate(void *, int leftSize, const void *left, int rightSize, const void *right)
{
    return compareMyobDates(QByteArrayView(static_cast<const char *>(left), leftSize),
                            QByteArrayView(static_cast<const char *>(right), rightSize));
}

} // namespace

int dateKey(QByteArrayView text)
{
    // YYYY-MM-DD, the form the file stores.
    if (text.size() == 10 && text[4] == '-' && text[7] == '-')
        return keyOf(digits(text, 0, 4), digits(text, 5, 2), digits(text, 8, 2));
    // D MMM YYYY or DD MMM YYYY, the form of the SQL texts' literals.
    const qsizetype firstSpace = text.indexOf(' ');
    if ((firstSpace == 1 || firstSpace == 2) && text.size() == firstSpace + 9 &&
        text[firstSpace + 4] == ' ') {
        const int day = digits(text, 0, firstSpace);
        const int month = monthNumber(text.sliced(firstSpace + 1, 3));
        const int year = digits(text, firstSpace + 5, 4);
        return keyOf(year, month, day);
    }
    return 0;
}

int compareMyobDates(QByteArrayView left, QByteArrayView right)
{
    const int leftKey = dateKey(left);
    const int rightKey = dateKey(right);
    if (leftKey && rightKey)
        return leftKey < rightKey ? -1 : (leftKey > rightKey ? 1 : 0);
    if (leftKey)
        return 1;
    if (rightKey)
        return -1;
    const int common =
        std::memcmp(left.data(), right.data(), size_t(std::min(left.size(), right.size())));
    if (common != 0)
        return common < 0 ? -1 : 1;
    return left.size() < right.size() ? -1 : (left.size() > right.size() ? 1 : 0);
}

bool isCompanyFile(const QString &path)
{
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return false;
    return file.read(16) == QByteArray("SQLite format 3\0", 16);
}

void registerMyobDate(sqlite3 *handle)
{
    if (handle)
        sqlite3_create_collation(handle, CollationName, SQLITE_UTF8, nullptr, collate);
}

std::optional<DbError> open(SqliteConnection &connection, const QString &path)
{
    if (auto error = connection.open(path, SqliteConnection::Mode::ReadOnly, registerMyobDate))
        return error;
    // A load reads the same pages again for every period it compares; keep them in memory
    // rather than asking the file system each time.
    QSqlQuery(connection.database()).exec(u"PRAGMA cache_size=-%1"_s.arg(PageCacheKiB));
    return std::nullopt;
}

QString schemaSql()
{
    return uR"(
CREATE TABLE Accounts (
  AccountID     INTEGER PRIMARY KEY,
  AccountNumber TEXT NOT NULL,
  AccountName   TEXT NOT NULL DEFAULT ''
);
CREATE TABLE JournalRecords (
  JournalRecordID    INTEGER PRIMARY KEY,
  AccountID          INTEGER NOT NULL REFERENCES Accounts(AccountID),
  TransactionDate    TEXT NOT NULL COLLATE MYOBDATE,
  TaxExclusiveAmount REAL NOT NULL,
  Memo               TEXT NOT NULL DEFAULT ''
);
CREATE TABLE Sales (
  SaleID        INTEGER PRIMARY KEY,
  Date          TEXT NOT NULL COLLATE MYOBDATE,
  InvoiceNumber TEXT NOT NULL DEFAULT ''
);
CREATE INDEX JournalByAccountDate ON JournalRecords(AccountID, TransactionDate);
CREATE INDEX SalesByDate ON Sales(Date);
-- Not needed by readers, but it lets a movement total come from the index alone, without
-- visiting the journal rows scattered through the table.
CREATE INDEX JournalByAccountDateAmount
  ON JournalRecords(AccountID, TransactionDate, TaxExclusiveAmount);
)"_s;
}

} // namespace CompanyFile
