// Veltrix — KPI dashboard for small businesses.
#include "databaseverbs.h"

#include "database/schemascript.h"

#include <QTextStream>

namespace DatabaseVerbs {

int createDatabase(const QStringList &arguments)
{
    if (arguments.size() != 2) {
        QTextStream(stderr) << "usage: veltrix-cli create-database SCRIPT OUTPUT" << Qt::endl;
        return 2;
    }
    if (const auto problem = createDatabaseFromScript(arguments[0], arguments[1])) {
        QTextStream(stderr) << *problem << Qt::endl;
        return 1;
    }
    return 0;
}

} // namespace DatabaseVerbs
