// Veltrix — KPI dashboard for small businesses.
#include "mainconnector.h"

#include "database/configvalues.h"
#include "database/maindatabase.h"
#include "database/schemacheck.h"

#include "appcontext.h"
#include "common/errorreporter.h"
#include "common/numberformat.h"
#include "common/version.h"
#include "engine/cachefile.h"
#include "engine/perioddataset.h"
#include "sources/accountingsource.h"

using namespace Qt::StringLiterals;

namespace {

// Fills slot 0 from the cache, then opens the per-tab record sets.
std::optional<DbError> openStandingRecordsets(AppContext &context)
{
    MainDatabase &database = context.mainDatabase();
    if (const auto error = database.openStandingRecordsets())
        return error;
    PeriodDataSet::Slot &cached = context.periodDataSet().slot(0);
    cached = PeriodDataSet::Slot();
    const QString &cacheFile = context.settings().cacheFile;
    if (const auto problem = CacheFile::read(cacheFile, cached)) {
        cached = PeriodDataSet::Slot();
        QString description = problem->description;
        // Said once: a damaged cache would otherwise stop every start until someone deleted it
        // by hand. It only holds figures a produce makes again.
        if (problem->damaged) {
            if (const auto kept = CacheFile::setAside(cacheFile, context.clock().now())) {
                description += u" It has been kept as '%1'; the next start begins without the "
                               u"figures of the last run."_s.arg(*kept);
            }
        }
        return DbError{1, description};
    }
    return database.openTabRecordsets();
}

} // namespace

QString checkVersions(const QString &requiredVersion, const QString &databaseVersion,
                      const QString &appVersion, const NumberFormat &numbers)
{
    if (numbers.toNumber(requiredVersion) > numbers.toNumber(appVersion))
        return u"You must update Veltrix to work with the new database!"_s;
    if (numbers.toNumber(databaseVersion) < 1.5)
        return u"You must update the database to work with this version of Veltrix!"_s;
    return {};
}

QString connectMainDatabase(AppContext &context)
{
    MainDatabase &database = context.mainDatabase();
    database.close();
    database.setDatabaseVersion({});

    std::optional<DbError> error = database.connection().open(context.settings().mainDatabaseFile);
    if (!error && !database.isConnected())
        return u"Failed to connect to the main database!"_s;
    if (!error) {
        if (const QStringList missing = SchemaCheck::missingColumns(database.database());
            !missing.isEmpty())
            return SchemaCheck::refusal(missing);
    }
    if (!error) {
        if (const auto failure = openStandingRecordsets(context))
            error = DbError{1, failure->description};
    }
    if (error) {
        ErrorReporter(context.prompter())
            .reportError(error->number, error->description, u"Connection"_s);
        return u"Database connection failed!"_s;
    }

    const ConfigValues config(database, context.prompter());
    database.setDatabaseVersion(config.getConfigValue(ConfigValues::DatabaseVersion));
    return checkVersions(config.getConfigValue(ConfigValues::RequiredVersion),
                         database.databaseVersion(), AppInfo::appVersion(), context.numberFormat());
}

void disconnectMainDatabase(AppContext &context)
{
    context.mainDatabase().close();
    if (AccountingSource *source = context.accountingSource())
        source->disconnect();
}
