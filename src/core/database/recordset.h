// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QHash>
#include <QList>
#include <QSqlDatabase>
#include <QString>
#include <QStringList>
#include <QVariant>
#include <QVariantList>

#include <optional>

// The rows of one query, held in memory and walked with a current position, the way the
// program's lists and dialogs expect: move first and next, test for before-first and
// past-last, find by ID, read and change fields by name in any case, add and delete rows and
// requery. Changes go back to the query's table optimistically: an update only applies when
// the changed columns still hold what this record set read, so another copy's change is never
// overwritten unseen.
class RecordSet
{
public:
    enum class Access { ReadOnly, Optimistic };

    RecordSet() = default;
    RecordSet(QSqlDatabase database, QString sql, Access access = Access::Optimistic,
              QVariantList bindings = {});

    std::optional<DbError> open();
    std::optional<DbError> requery() { return open(); }
    void close();
    bool isOpen() const { return m_open; }

    QString sql() const { return m_sql; }
    int recordCount() const { return int(m_rows.size()); }
    QStringList fieldNames() const { return m_fields; }
    bool hasField(const QString &name) const { return fieldIndex(name) >= 0; }

    // Before the first record, or past the last (both with no records).
    bool bof() const { return m_open && (m_position < 0 || m_rows.isEmpty()); }
    bool eof() const { return m_open && m_position >= recordCount(); }
    bool hasCurrentRecord() const;
    int position() const { return m_position; }

    std::optional<DbError> moveFirst();
    std::optional<DbError> moveNext();
    std::optional<DbError> moveLast();
    // From the current record forward: the first whose ID is the given one, else past the
    // last record.
    std::optional<DbError> findId(qint64 id);

    // Null when there is no current record or no such field.
    QVariant value(const QString &field) const;
    std::optional<DbError> setValue(const QString &field, const QVariant &value);

    // Starts a new record at the end; update() inserts it.
    std::optional<DbError> addNew();
    // Writes the changes of the current record.
    std::optional<DbError> update();
    // Throws away changes not yet written.
    void cancelUpdate();
    std::optional<DbError> deleteCurrent();

private:
    struct Row
    {
        QVariantList values;
        QVariantList original; // as read; the optimistic check compares with these
        QList<bool> changed;
        bool isNew = false;
    };

    int fieldIndex(const QString &name) const;
    std::optional<DbError> requireCurrent() const;
    std::optional<DbError> requireWritable() const;
    std::optional<DbError> insertRow(Row &row);
    std::optional<DbError> updateRow(Row &row);

    QSqlDatabase m_database;
    QString m_sql;
    Access m_access = Access::Optimistic;
    QVariantList m_bindings;
    QString m_table;
    QStringList m_fields;
    QHash<QString, int> m_fieldIndex; // by the names as the query gave them
    QList<Row> m_rows;
    int m_position = -1;
    bool m_open = false;
};
