// Veltrix — KPI dashboard for small businesses.
#include "odbcdrivers.h"

#ifdef VELTRIX_HAVE_ODBC
#ifdef Q_OS_WIN
#include <windows.h>
#endif
#include <sql.h>
#include <sqlext.h>
#endif

namespace OdbcDrivers {

std::optional<QStringList> installed()
{
#ifdef VELTRIX_HAVE_ODBC
    SQLHENV environment = SQL_NULL_HENV;
    if (!SQL_SUCCEEDED(SQLAllocHandle(SQL_HANDLE_ENV, SQL_NULL_HANDLE, &environment)))
        return std::nullopt;
    SQLSetEnvAttr(environment, SQL_ATTR_ODBC_VERSION,
                  reinterpret_cast<SQLPOINTER>(static_cast<quintptr>(SQL_OV_ODBC3)), 0);
    QStringList names;
    SQLCHAR name[256];
    SQLCHAR attributes[1024];
    SQLSMALLINT nameLength = 0;
    SQLSMALLINT attributesLength = 0;
    SQLUSMALLINT direction = SQL_FETCH_FIRST;
    while (SQL_SUCCEEDED(SQLDrivers(environment, direction, name, SQLSMALLINT(sizeof name),
                                    &nameLength, attributes, SQLSMALLINT(sizeof attributes),
                                    &attributesLength))) {
        names << QString::fromLocal8Bit(reinterpret_cast<const char *>(name));
        direction = SQL_FETCH_NEXT;
    }
    SQLFreeHandle(SQL_HANDLE_ENV, environment);
    return names;
#else
    return std::nullopt;
#endif
}

} // namespace OdbcDrivers
