// Veltrix — KPI dashboard for small businesses.
#include "recordset.h"

#include "sqliteconnection.h"

#include <QRegularExpression>
#include <QSqlError>
#include <QSqlQuery>
#include <QSqlRecord>

using namespace Qt::StringLiterals;

namespace {

// The one table a query reads, when it reads exactly one; changes can only go back there.
QString singleTableOf(const QString &sql)
{
    static const QRegularExpression fromClause(
        uR"(^\s*SELECT\s.+?\sFROM\s+[`"\[]?(\w+)[`"\]]?\s*(?:$|WHERE\s|ORDER\s))"_s,
        QRegularExpression::CaseInsensitiveOption | QRegularExpression::DotMatchesEverythingOption);
    const QRegularExpressionMatch match = fromClause.match(sql);
    return match.hasMatch() ? match.captured(1) : QString();
}

QString quoted(const QString &identifier)
{
    return u'"' + QString(identifier).replace(u'"', u"\"\""_s) + u'"';
}

DbError noCurrentRecord()
{
    return {DbError::NoCurrentRecord,
            u"Either BOF or EOF is True, or the current record has been deleted. Requested "
            u"operation requires a current record."_s};
}

DbError closedRecordset()
{
    return {DbError::RecordsetClosed, u"Operation is not allowed when the object is closed."_s};
}

DbError rowNotFound(const QString &what)
{
    return {DbError::RowNotFound, u"Row cannot be located for %1. Some values may have been "
                                  u"changed since it was last read."_s.arg(what)};
}

} // namespace

RecordSet::RecordSet(QSqlDatabase database, QString sql, Access access, QVariantList bindings)
    : m_database(std::move(database))
    , m_sql(std::move(sql))
    , m_access(access)
    , m_bindings(std::move(bindings))
    , m_table(singleTableOf(m_sql))
{}

std::optional<DbError> RecordSet::open()
{
    close();
    if (!m_database.isOpen())
        return closedRecordset();
    QSqlQuery query(m_database);
    query.setForwardOnly(true);
    if (!query.prepare(m_sql))
        return SqliteConnection::errorFrom(query.lastError());
    for (const QVariant &binding : std::as_const(m_bindings))
        query.addBindValue(binding);
    if (!query.exec())
        return SqliteConnection::errorFrom(query.lastError());

    const QSqlRecord record = query.record();
    for (int i = 0; i < record.count(); ++i) {
        m_fields << record.fieldName(i);
        m_fieldIndex.insert(record.fieldName(i), i);
    }
    while (query.next()) {
        Row row;
        for (int i = 0; i < m_fields.size(); ++i)
            row.values << query.value(i);
        row.original = row.values;
        row.changed = QList<bool>(m_fields.size(), false);
        m_rows << row;
    }
    if (query.lastError().isValid())
        return SqliteConnection::errorFrom(query.lastError());
    m_open = true;
    m_position = 0;
    return std::nullopt;
}

void RecordSet::close()
{
    m_open = false;
    m_fields.clear();
    m_fieldIndex.clear();
    m_rows.clear();
    m_position = -1;
}

bool RecordSet::hasCurrentRecord() const
{
    return m_open && m_position >= 0 && m_position < recordCount();
}

std::optional<DbError> RecordSet::moveFirst()
{
    if (!m_open)
        return closedRecordset();
    if (m_rows.isEmpty())
        return noCurrentRecord();
    m_position = 0;
    return std::nullopt;
}

std::optional<DbError> RecordSet::moveNext()
{
    if (!m_open)
        return closedRecordset();
    if (eof())
        return noCurrentRecord();
    ++m_position;
    return std::nullopt;
}

std::optional<DbError> RecordSet::moveLast()
{
    if (!m_open)
        return closedRecordset();
    if (m_rows.isEmpty())
        return noCurrentRecord();
    m_position = recordCount() - 1;
    return std::nullopt;
}

std::optional<DbError> RecordSet::findId(qint64 id)
{
    if (!m_open)
        return closedRecordset();
    const int idColumn = fieldIndex(u"ID"_s);
    if (idColumn < 0)
        return DbError{3265, u"Item cannot be found in the collection corresponding to the "
                             u"requested name or ordinal."_s};
    if (m_position < 0)
        m_position = 0;
    for (; m_position < recordCount(); ++m_position) {
        bool ok = false;
        const qint64 rowId = m_rows[m_position].values[idColumn].toLongLong(&ok);
        if (ok && rowId == id)
            break;
    }
    return std::nullopt;
}

QVariant RecordSet::value(const QString &field) const
{
    const int column = fieldIndex(field);
    if (column < 0 || !hasCurrentRecord())
        return {};
    return m_rows[m_position].values[column];
}

std::optional<DbError> RecordSet::setValue(const QString &field, const QVariant &value)
{
    if (const auto error = requireWritable())
        return error;
    if (const auto error = requireCurrent())
        return error;
    const int column = fieldIndex(field);
    if (column < 0)
        return DbError{3265, u"Item cannot be found in the collection corresponding to the "
                             u"requested name or ordinal."_s};
    Row &row = m_rows[m_position];
    row.values[column] = value;
    row.changed[column] = true;
    return std::nullopt;
}

std::optional<DbError> RecordSet::addNew()
{
    if (const auto error = requireWritable())
        return error;
    Row row;
    row.values = QVariantList(m_fields.size());
    row.original = row.values;
    row.changed = QList<bool>(m_fields.size(), false);
    row.isNew = true;
    m_rows << row;
    m_position = recordCount() - 1;
    return std::nullopt;
}

std::optional<DbError> RecordSet::update()
{
    if (const auto error = requireWritable())
        return error;
    if (const auto error = requireCurrent())
        return error;
    Row &row = m_rows[m_position];
    return row.isNew ? insertRow(row) : updateRow(row);
}

void RecordSet::cancelUpdate()
{
    if (!hasCurrentRecord())
        return;
    Row &row = m_rows[m_position];
    if (row.isNew) {
        m_rows.removeAt(m_position);
        m_position = recordCount();
        return;
    }
    row.values = row.original;
    row.changed.fill(false);
}

std::optional<DbError> RecordSet::deleteCurrent()
{
    if (const auto error = requireWritable())
        return error;
    if (const auto error = requireCurrent())
        return error;
    Row &row = m_rows[m_position];
    if (!row.isNew) {
        const int idColumn = fieldIndex(u"ID"_s);
        QSqlQuery query(m_database);
        query.prepare(u"DELETE FROM "_s + quoted(m_table) + u" WHERE \"ID\" = ?"_s);
        query.addBindValue(row.original[idColumn]);
        if (!query.exec())
            return SqliteConnection::errorFrom(query.lastError());
        if (query.numRowsAffected() == 0)
            return rowNotFound(u"deleting"_s);
    }
    m_rows.removeAt(m_position);
    return std::nullopt;
}

int RecordSet::fieldIndex(const QString &name) const
{
    // Callers mostly spell a column as the table does; only the others need the slow search.
    if (const auto exact = m_fieldIndex.constFind(name); exact != m_fieldIndex.cend())
        return exact.value();
    for (int i = 0; i < m_fields.size(); ++i) {
        if (m_fields[i].compare(name, Qt::CaseInsensitive) == 0)
            return i;
    }
    return -1;
}

std::optional<DbError> RecordSet::requireCurrent() const
{
    if (!m_open)
        return closedRecordset();
    if (!hasCurrentRecord())
        return noCurrentRecord();
    return std::nullopt;
}

std::optional<DbError> RecordSet::requireWritable() const
{
    if (!m_open)
        return closedRecordset();
    if (m_access == Access::ReadOnly || m_table.isEmpty() || fieldIndex(u"ID"_s) < 0)
        return DbError{3251, u"Current Recordset does not support updating. This may be a "
                             u"limitation of the provider, or of the selected locktype."_s};
    return std::nullopt;
}

std::optional<DbError> RecordSet::insertRow(Row &row)
{
    QStringList columns;
    QVariantList values;
    for (int i = 0; i < m_fields.size(); ++i) {
        if (row.changed[i]) {
            columns << quoted(m_fields[i]);
            values << row.values[i];
        }
    }
    QSqlQuery query(m_database);
    const QString sql = columns.isEmpty()
                            ? u"INSERT INTO "_s + quoted(m_table) + u" DEFAULT VALUES"_s
                            : u"INSERT INTO "_s + quoted(m_table) + u" ("_s +
                                  columns.join(u", "_s) + u") VALUES ("_s +
                                  QStringList(columns.size(), u"?"_s).join(u", "_s) + u')';
    if (!query.prepare(sql))
        return SqliteConnection::errorFrom(query.lastError());
    for (const QVariant &value : std::as_const(values))
        query.addBindValue(value);
    if (!query.exec())
        return SqliteConnection::errorFrom(query.lastError());

    // Read the row back, so that defaults and the new ID show in the record set.
    const QVariant newId = query.lastInsertId();
    QSqlQuery reread(m_database);
    reread.prepare(u"SELECT * FROM "_s + quoted(m_table) + u" WHERE rowid = ?"_s);
    reread.addBindValue(newId);
    if (reread.exec() && reread.next()) {
        for (int i = 0; i < m_fields.size(); ++i) {
            const int column = reread.record().indexOf(m_fields[i]);
            if (column >= 0)
                row.values[i] = reread.value(column);
        }
    }
    row.original = row.values;
    row.changed.fill(false);
    row.isNew = false;
    return std::nullopt;
}

std::optional<DbError> RecordSet::updateRow(Row &row)
{
    QStringList assignments;
    QStringList checks{u"\"ID\" = ?"_s};
    QVariantList assignmentValues;
    QVariantList checkValues{row.original[fieldIndex(u"ID"_s)]};
    for (int i = 0; i < m_fields.size(); ++i) {
        if (!row.changed[i])
            continue;
        assignments << quoted(m_fields[i]) + u" = ?"_s;
        assignmentValues << row.values[i];
        checks << quoted(m_fields[i]) + u" IS ?"_s;
        checkValues << row.original[i];
    }
    if (assignments.isEmpty())
        return std::nullopt;

    QSqlQuery query(m_database);
    if (!query.prepare(u"UPDATE "_s + quoted(m_table) + u" SET "_s + assignments.join(u", "_s) +
                       u" WHERE "_s + checks.join(u" AND "_s)))
        return SqliteConnection::errorFrom(query.lastError());
    for (const QVariant &value : std::as_const(assignmentValues))
        query.addBindValue(value);
    for (const QVariant &value : std::as_const(checkValues))
        query.addBindValue(value);
    if (!query.exec())
        return SqliteConnection::errorFrom(query.lastError());
    if (query.numRowsAffected() == 0)
        return rowNotFound(u"updating"_s);
    row.original = row.values;
    row.changed.fill(false);
    return std::nullopt;
}
