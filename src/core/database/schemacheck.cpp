// Veltrix — KPI dashboard for small businesses.
#include "schemacheck.h"

#include <QSqlRecord>

using namespace Qt::StringLiterals;

namespace SchemaCheck {

QStringList missingColumns(const QSqlDatabase &database)
{
    struct Table
    {
        QString name;
        QStringList columns;
    };
    static const QList<Table> needed{
        {u"Config"_s, {u"ID"_s, u"Value"_s}},
        {u"Users"_s,
         {u"ID"_s, u"UserName"_s, u"Password"_s, u"Type"_s, u"DateCreated"_s, u"Fields"_s}},
        {u"Hours"_s, {u"ID"_s, u"Department"_s, u"Value"_s}},
        {u"Fields"_s,
         {u"ID"_s, u"Tab"_s, u"Order"_s, u"Hide"_s, u"Type"_s, u"Label"_s, u"tooltip"_s,
          u"Data"_s}},
    };
    const QStringList tables = database.tables();
    QStringList missing;
    for (const Table &table : needed) {
        if (!tables.contains(table.name, Qt::CaseInsensitive))
            continue;
        const QSqlRecord record = database.record(table.name);
        QStringList present;
        for (int i = 0; i < record.count(); ++i)
            present << record.fieldName(i);
        for (const QString &column : table.columns) {
            if (!present.contains(column, Qt::CaseInsensitive))
                missing << table.name + u'.' + column;
        }
    }
    return missing;
}

QString refusal(const QStringList &missing)
{
    return u"The main database lacks columns that Veltrix reads: %1. Another program may have "
           u"changed its tables; restore main.db from a backup."_s.arg(missing.join(u", "_s));
}

} // namespace SchemaCheck
