// Veltrix — KPI dashboard for small businesses.
#include "schemascript.h"

#include "sqliteconnection.h"

#include <QFile>

using namespace Qt::StringLiterals;

std::optional<QString> createDatabaseFromScript(const QString &scriptFile,
                                                const QString &databaseFile)
{
    QFile script(scriptFile);
    if (!script.open(QIODevice::ReadOnly))
        return u"Cannot read %1: %2"_s.arg(scriptFile, script.errorString());
    const QString sql = QString::fromUtf8(script.readAll());

    const QString partial = databaseFile + u".part"_s;
    QFile::remove(partial);
    {
        SqliteConnection connection;
        if (const auto error = connection.open(partial, SqliteConnection::Mode::CreateFile))
            return u"Cannot create %1: %2"_s.arg(partial, error->description);
        if (const auto error = connection.executeScript(sql)) {
            connection.close();
            QFile::remove(partial);
            return u"%1: %2"_s.arg(scriptFile, error->description);
        }
    }
    QFile::remove(databaseFile);
    if (!QFile::rename(partial, databaseFile))
        return u"Cannot move the new database to %1"_s.arg(databaseFile);
    return std::nullopt;
}
