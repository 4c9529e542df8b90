// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QSqlDatabase>
#include <QStringList>

// The columns of the shared database that the program reads and writes. Another tool may
// rename or drop one; the program would then read every figure, rate or login as empty, so
// such a database is refused at connect with what is missing named.
namespace SchemaCheck {

// "Table.Column" for every column the program needs that a present table lacks. A table that
// is missing altogether fails when it is opened, as a damaged file does.
QStringList missingColumns(const QSqlDatabase &database);

// The start-up message that refuses a database lacking the given columns.
QString refusal(const QStringList &missing);

} // namespace SchemaCheck
