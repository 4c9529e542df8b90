// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QSqlDatabase>
#include <QString>

#include <functional>
#include <optional>

class QSqlError;
struct sqlite3;

// One connection to a SQLite database file, closed and removed when the object goes. Each
// object has its own connection name, so two of them may open the same file, as two copies of
// the program on different machines do.
class SqliteConnection
{
public:
    enum class Mode { ExistingFile, CreateFile, ReadOnly };
    // Runs on the raw handle right after opening, before any statement: the place to
    // register collations that the file's tables name.
    using OpenHook = std::function<void(sqlite3 *)>;

    SqliteConnection();
    ~SqliteConnection();
    SqliteConnection(const SqliteConnection &) = delete;
    SqliteConnection &operator=(const SqliteConnection &) = delete;

    // Opens the file, waiting up to the busy timeout for other copies' locks. The file is
    // kept in rollback-journal mode, which works on network shares where WAL does not.
    std::optional<DbError> open(const QString &file, Mode mode = Mode::ExistingFile,
                                const OpenHook &onOpened = {});
    void close();
    bool isOpen() const;

    QSqlDatabase database() const;
    // The SQLite handle under the Qt connection; null when closed.
    sqlite3 *handle() const;
    QString fileName() const { return m_file; }

    // Runs several statements separated by semicolons, such as a schema script.
    std::optional<DbError> executeScript(const QString &sql);

    static DbError errorFrom(const QSqlError &error);

    // How long a statement waits for another copy's lock before it fails.
    static constexpr int DefaultBusyTimeoutMs = 10000;
    void setBusyTimeout(int milliseconds) { m_busyTimeoutMs = milliseconds; }

private:
    int m_busyTimeoutMs = DefaultBusyTimeoutMs;
    QString m_name;
    QString m_file;
};
