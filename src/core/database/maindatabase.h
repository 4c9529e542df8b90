// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "recordset.h"
#include "sqliteconnection.h"

#include <array>
#include <optional>

// The shared database of the run: its one connection and the record sets that stay open from
// start-up to shut-down.
class MainDatabase
{
public:
    static constexpr int TabCount = 6;

    bool isConnected() const { return m_connection.isOpen(); }
    QSqlDatabase database() const { return m_connection.database(); }
    SqliteConnection &connection() { return m_connection; }

    QString databaseVersion() const { return m_databaseVersion; }
    void setDatabaseVersion(const QString &version) { m_databaseVersion = version; }

    RecordSet &configRecordset() { return m_config; }
    RecordSet &usersRecordset() { return m_users; }
    RecordSet &hoursRecordset() { return m_hours; }
    RecordSet &fieldsRecordset() { return m_fields; }
    // Tabs count from 1.
    RecordSet &tabRecordset(int tab) { return m_tabs.at(tab - 1); }

    // Opens Config, Users, Hours and Fields; the first failure stops it.
    std::optional<DbError> openStandingRecordsets();
    std::optional<DbError> openTabRecordsets();
    // After the Fields table changed, so that every view sees the change.
    void requeryFields();
    // Reads Hours, Fields and the tabs again, all from one state of the file, so that a
    // produce sees every change another copy saved and never half of one. On failure the
    // record sets stay as they were.
    std::optional<DbError> rereadForProduce();
    void close();

private:
    SqliteConnection m_connection;
    QString m_databaseVersion;
    RecordSet m_config;
    RecordSet m_users;
    RecordSet m_hours;
    RecordSet m_fields;
    std::array<RecordSet, TabCount> m_tabs;
};
