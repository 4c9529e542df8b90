// Veltrix — KPI dashboard for small businesses.
#include "maindatabase.h"

#include "databasetransaction.h"

#include <vector>

using namespace Qt::StringLiterals;

std::optional<DbError> MainDatabase::openStandingRecordsets()
{
    const QSqlDatabase db = database();
    m_config = RecordSet(db, u"SELECT * FROM Config"_s);
    m_users = RecordSet(db, u"SELECT * FROM Users"_s);
    m_hours = RecordSet(db, u"SELECT * FROM Hours"_s);
    m_fields = RecordSet(db, u"SELECT * FROM Fields WHERE Hide<>1 ORDER BY `Order`"_s);
    for (RecordSet *recordset : {&m_config, &m_users, &m_hours, &m_fields}) {
        if (const auto error = recordset->open())
            return error;
    }
    return std::nullopt;
}

std::optional<DbError> MainDatabase::openTabRecordsets()
{
    for (int tab = 1; tab <= TabCount; ++tab) {
        RecordSet &recordset = m_tabs.at(tab - 1);
        recordset = RecordSet(database(),
                              u"SELECT * FROM Fields WHERE Tab="_s + QString::number(tab) +
                                  u" AND `Hide`<>1 ORDER BY `Order`"_s,
                              RecordSet::Access::ReadOnly);
        if (const auto error = recordset.open())
            return error;
    }
    return std::nullopt;
}

void MainDatabase::requeryFields()
{
    m_fields.requery();
    for (RecordSet &tab : m_tabs)
        tab.requery();
}

std::optional<DbError> MainDatabase::rereadForProduce()
{
    // Fresh copies are read and only put in place once all of them are, so that a failure
    // leaves what the views show untouched. Record sets never opened stay so.
    std::vector<std::pair<RecordSet *, RecordSet>> fresh;
    for (RecordSet *standing : {&m_hours, &m_fields}) {
        if (!standing->sql().isEmpty())
            fresh.emplace_back(standing, RecordSet(database(), standing->sql()));
    }
    for (RecordSet &tab : m_tabs) {
        if (!tab.sql().isEmpty())
            fresh.emplace_back(&tab, RecordSet(database(), tab.sql(), RecordSet::Access::ReadOnly));
    }

    DatabaseTransaction snapshot(database(), DatabaseTransaction::Kind::Read);
    if (snapshot.beginError())
        return snapshot.beginError();
    for (auto &[standing, copy] : fresh) {
        if (const auto error = copy.open())
            return error;
    }
    if (const auto error = snapshot.commit())
        return error;
    for (auto &[standing, copy] : fresh)
        *standing = std::move(copy);
    return std::nullopt;
}

void MainDatabase::close()
{
    // The record sets hold the connection too; let go of them before it closes.
    for (RecordSet *recordset : {&m_config, &m_users, &m_hours, &m_fields})
        *recordset = RecordSet();
    for (RecordSet &tab : m_tabs)
        tab = RecordSet();
    m_connection.close();
}
