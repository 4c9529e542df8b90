// Veltrix — KPI dashboard for small businesses.
#include "setuplist.h"

#include "common/errorreporter.h"
#include "database/databasetransaction.h"
#include "database/maindatabase.h"
#include "database/recordoperations.h"

#include <QSqlQuery>

using namespace Qt::StringLiterals;

SetupList::SetupList(GridModel &grid, Columns columns)
    : m_grid(grid)
    , m_columns(columns)
{}

bool SetupList::isHeading(int row) const
{
    return m_columns.type > 0 && m_grid.cellText(row, m_columns.type) == u"1"_s;
}

namespace {

// Whether the row is still in the table; a failed look-up counts as present, so that the
// failure is reported rather than passed over.
bool rowExists(MainDatabase &database, const QString &table, qint64 id)
{
    QSqlQuery query(database.database());
    query.prepare(u"SELECT COUNT(*) FROM \""_s + table + u"\" WHERE ID = ?"_s);
    query.addBindValue(id);
    return !query.exec() || !query.next() || query.value(0).toInt() > 0;
}

} // namespace

bool SetupList::saveInto(MainDatabase &database, Prompter &prompter, RecordSet &records,
                         const QString &table, const QString &field, const Conversion &conversion,
                         const QString &errorContext) const
{
    const RecordOperations operations(database, prompter);
    for (int row = 1; row <= m_grid.rowCount(); ++row) {
        if (isHeading(row))
            continue;
        const QString text = m_grid.cellText(row, m_columns.editable);
        const auto shown = m_shownTexts.constFind(m_grid.cellText(row, 1));
        if (shown != m_shownTexts.cend() && *shown == text)
            continue;
        const qint64 id = m_grid.cellText(row, 1).toLongLong();
        if (!operations.findRecordById(records, id))
            continue;
        const QVariant value = conversion(text);
        if (records.value(field) == value)
            continue;
        std::optional<DbError> failure = records.setValue(field, value);
        if (!failure)
            failure = records.update();
        if (!failure)
            continue;
        records.cancelUpdate();
        if (failure->number == DbError::RowNotFound && !rowExists(database, table, id))
            continue;
        ErrorReporter(prompter).reportError(failure->number, failure->description, errorContext);
        return false;
    }
    return true;
}

bool SetupList::saveTogether(MainDatabase &database, Prompter &prompter,
                             const QString &errorContext, const std::function<bool()> &saves)
{
    DatabaseTransaction transaction(database.database(), DatabaseTransaction::Kind::Write);
    const bool saved = !transaction.beginError() && saves();
    if (const std::optional<DbError> failure = transaction.commit()) {
        ErrorReporter(prompter).reportError(failure->number, failure->description, errorContext);
        return false;
    }
    return saved;
}

void SetupList::rememberShownTexts()
{
    m_shownTexts.clear();
    for (int row = 1; row <= m_grid.rowCount(); ++row) {
        if (!isHeading(row))
            m_shownTexts.insert(m_grid.cellText(row, 1), m_grid.cellText(row, m_columns.editable));
    }
}
