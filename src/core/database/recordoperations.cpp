// Veltrix — KPI dashboard for small businesses.
#include "recordoperations.h"

#include "maindatabase.h"

#include "common/errorreporter.h"
#include "common/prompter.h"

using namespace Qt::StringLiterals;

namespace {

QString backQuoted(const QString &identifier)
{
    return u'`' + QString(identifier).remove(u'`') + u'`';
}

} // namespace

RecordOperations::RecordOperations(MainDatabase &database, Prompter &prompter)
    : m_database(database)
    , m_prompter(prompter)
{}

RecordOperations::Query RecordOperations::openQuery(const QString &table, const QString &filter,
                                                    bool open, const QVariantList &bindings) const
{
    QString sql = u"SELECT * FROM "_s + table;
    if (!filter.isEmpty())
        sql += u" WHERE "_s + filter;
    Query query{RecordSet(m_database.database(), sql, RecordSet::Access::Optimistic, bindings),
                std::nullopt};
    if (open)
        query.error = query.records.open();
    return query;
}

bool RecordOperations::findRecordById(RecordSet &records, qint64 id) const
{
    std::optional<DbError> error = records.moveFirst();
    if (!error)
        error = records.findId(id);
    if (error) {
        ErrorReporter(m_prompter).reportError(error->number, error->description, u"Find Record"_s);
        return false;
    }
    if (records.bof() || records.eof())
        return false;
    return records.value(u"ID"_s).toLongLong() == id;
}

bool RecordOperations::deleteRecordById(RecordSet &records, qint64 id) const
{
    const Prompter::Answer answer = m_prompter.message(
        u"Are you sure you want to delete the record with ID "_s + QString::number(id) + u'?',
        u"Delete Record"_s, Prompter::Icon::Exclamation, Prompter::Buttons::YesNo);
    if (answer != Prompter::Answer::Yes || !findRecordById(records, id))
        return false;
    if (const auto error = records.deleteCurrent()) {
        // Another copy may have removed it first; either way the list must show the truth.
        records.requery();
        ErrorReporter(m_prompter)
            .reportError(error->number, error->description, u"Delete Record"_s);
        return false;
    }
    records.requery();
    return true;
}

QString RecordOperations::likeLiteralClause()
{
    return u" LIKE ? ESCAPE '\\'"_s;
}

QString RecordOperations::likeLiteral(const QString &text)
{
    QString literal = text;
    literal.replace(u'\\', u"\\\\"_s).replace(u'%', u"\\%"_s).replace(u'_', u"\\_"_s);
    return literal;
}

std::optional<bool> RecordOperations::valueExists(const QString &table, const QString &column,
                                                  const QString &value, DbError *error) const
{
    RecordSet records(m_database.database(),
                      u"SELECT "_s + column + u" FROM "_s + table + u" WHERE "_s +
                          backQuoted(column) + likeLiteralClause(),
                      RecordSet::Access::ReadOnly, {likeLiteral(value)});
    if (const auto failure = records.open()) {
        if (error)
            *error = *failure;
        return std::nullopt;
    }
    return records.recordCount() >= 1;
}

void RecordOperations::loadList(ListContent &list, const QString &table, const QString &column,
                                const QString &filter, bool warn) const
{
    QString sql = u"SELECT ID,"_s + column + u" FROM "_s + table;
    if (!filter.isEmpty())
        sql += u" WHERE "_s + filter;
    RecordSet records(m_database.database(), sql, RecordSet::Access::ReadOnly);
    if (!records.open() && records.recordCount() > 0) {
        list.items.clear();
        list.ids.clear();
        for (records.moveFirst(); !records.eof(); records.moveNext()) {
            list.items << records.value(column).toString();
            list.ids << records.value(u"ID"_s).toString();
        }
    }
    if (warn && list.items.isEmpty()) {
        m_prompter.message(u"Unable to retrieve data records from the table '"_s + table + u'.' +
                               column + u'\'',
                           u"Load List Failed"_s, Prompter::Icon::Exclamation);
    }
}

bool RecordOperations::hasRecords(const RecordSet &records)
{
    return records.isOpen() && !records.bof() && !records.eof();
}
