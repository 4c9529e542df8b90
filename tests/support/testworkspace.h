// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "app/appcontext.h"
#include "app/mainconnector.h"
#include "app/settingsloader.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"
#include "database/sqliteconnection.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSqlQuery>
#include <QTemporaryDir>

#include <memory>

// A program folder, a shared database folder and a settings file of their own, with a fresh
// context over them, so that each test starts from nothing.
class TestWorkspace
{
public:
    explicit TestWorkspace(Clock clock = {})
    {
        QDir(m_root.path()).mkpath(QStringLiteral("app"));
        QDir(m_root.path()).mkpath(QStringLiteral("shared"));
        m_context = std::make_unique<AppContext>(
            std::make_unique<SettingsStore>(m_root.filePath(QStringLiteral("settings.ini"))),
            m_prompter, AppLocations::inFolder(appFolder()), std::move(clock));
    }

    QString appFolder() const { return m_root.filePath(QStringLiteral("app")) + u'/'; }
    QString sharedFolder() const { return m_root.filePath(QStringLiteral("shared")) + u'/'; }
    QString mainDatabase() const { return sharedFolder() + QStringLiteral("main.db"); }
    QString path(const QString &name) const { return m_root.filePath(name); }

    AppContext &context() { return *m_context; }
    RecordingPrompter &prompter() { return m_prompter; }
    SettingsStore &store() { return m_context->settingsStore(); }

    // Settings that pass every check, with main.db made from the template in the shared
    // folder.
    bool configure(const QString &package = QStringLiteral("MoneyWorks"))
    {
        store().writeSetting(QStringLiteral("DBPath"), sharedFolder());
        store().writeSetting(QStringLiteral("AccPackage"), package);
        store().writeSetting(QStringLiteral("AccFileDriver"), QStringLiteral("SQLite"));
        return QFile::copy(QStringLiteral(VELTRIX_NEW_DB), appFolder() + QStringLiteral("new.db"));
    }

    // main.db in place (made from the template) with one Config row changed, as another copy or
    // an administrator might have left it.
    bool setConfigRow(int id, const QString &value)
    {
        if (!QFileInfo::exists(mainDatabase())) {
            if (!QFile::copy(QStringLiteral(VELTRIX_NEW_DB), mainDatabase()))
                return false;
            QFile::setPermissions(mainDatabase(), QFileDevice::ReadOwner | QFileDevice::WriteOwner);
        }
        return exec(QStringLiteral("UPDATE Config SET Value = ? WHERE ID = ?"), {value, id});
    }

    // Starts up as the program does (settings, then main.db); the note about a new database
    // file is cleared, as it is not what a test is about.
    bool connect()
    {
        const bool connected =
            loadSettings(context()).isEmpty() && connectMainDatabase(context()).isEmpty();
        m_prompter.clearMessages();
        return connected;
    }

    // SQL run on main.db over a connection of its own, as another copy of the program would.
    bool exec(const QString &sql, const QVariantList &values = {})
    {
        SqliteConnection connection;
        QSqlQuery query = prepared(connection, sql, values);
        return query.exec();
    }
    QVariant value(const QString &sql, const QVariantList &values = {})
    {
        SqliteConnection connection;
        QSqlQuery query = prepared(connection, sql, values);
        return query.exec() && query.next() ? query.value(0) : QVariant();
    }

private:
    QSqlQuery prepared(SqliteConnection &connection, const QString &sql, const QVariantList &values)
    {
        connection.open(mainDatabase());
        QSqlQuery query(connection.database());
        query.prepare(sql);
        for (const QVariant &value : values)
            query.addBindValue(value);
        return query;
    }

    QTemporaryDir m_root;
    RecordingPrompter m_prompter;
    std::unique_ptr<AppContext> m_context;
};
