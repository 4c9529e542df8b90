// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QByteArrayView>
#include <QString>

#include <optional>

class SqliteConnection;
struct sqlite3;

// The SQLite company file: a stand-in for the MYOB driver laid out like the tables the fixed
// SQL texts read (Accounts, JournalRecords, Sales). Its date columns carry the MYOBDATE
// collation, which compares "YYYY-MM-DD" and "D MMM YYYY" texts as calendar dates, so that the
// SQL texts' literals such as '1 Jul 2006' select the right rows and the indexes serve them.
namespace CompanyFile {

inline constexpr char CollationName[] = "MYOBDATE";

// True when the file starts with the SQLite header.
bool isCompanyFile(const QString &path);

// Registers MYOBDATE on the connection; every connection to a company file needs it before
// its first statement.
void registerMyobDate(sqlite3 *handle);

// The collation itself: dates in calendar order, after every text that is not a date (those
// compare by their bytes).
int compareMyobDates(QByteArrayView left, QByteArrayView right);
// The date as YYYYMMDD, or 0 when the text is neither date form.
int dateKey(QByteArrayView text);

// The page cache of a company file connection.
inline constexpr int PageCacheKiB = 65536;

// Opens a company file read-only with the collation in place.
std::optional<DbError> open(SqliteConnection &connection, const QString &path);

// The tables and indexes of an empty company file.
QString schemaSql();

} // namespace CompanyFile
