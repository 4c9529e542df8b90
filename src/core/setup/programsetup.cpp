// Veltrix — KPI dashboard for small businesses.
#include "programsetup.h"

#include "common/errorreporter.h"
#include "common/prompter.h"
#include "database/maindatabase.h"
#include "database/recordoperations.h"
#include "grid/gridoperations.h"

using namespace Qt::StringLiterals;

namespace {

void addColumns(GridModel &grid, const QString &labelHeader, const QString &dataHeader,
                int dataWidth)
{
    grid.addColumn(u"id"_s, QString(), GridModel::AlignLeft, 0, true);
    grid.addColumn(u"type"_s, QString(), GridModel::AlignLeft, 0, false);
    grid.addColumn(u"label"_s, labelHeader, GridModel::AlignLeft, 100, true);
    grid.addColumn(u"data"_s, dataHeader, GridModel::AlignLeft, dataWidth, true);
    GridOperations::setupGrid(grid);
}

} // namespace

ProgramSetup::ProgramSetup(MainDatabase &database, Prompter &prompter)
    : m_database(database)
    , m_prompter(prompter)
    , m_mappingList(m_mapping, {DataColumn, TypeColumn})
    , m_benchmarkList(m_benchmarks, {DataColumn, TypeColumn})
{}

void ProgramSetup::load()
{
    addColumns(m_mapping, u"Account"_s, u"Code/s"_s, 120);
    addColumns(m_benchmarks, u"Field"_s, u"Optimal %"_s, 65);
    MainDatabase &database = m_database;
    const ErrorReporter errors(m_prompter);
    // Read the standing Fields again, so that the save compares with what these lists show.
    database.requeryFields();
    const RecordOperations operations(database, m_prompter);
    // In catalogue order, so that every heading stands above its fields; the IDs do not
    // follow it.
    const std::pair<GridModel *, QString> lists[] = {
        {&m_mapping, u"Type=1 OR Type=2 ORDER BY `Order`"_s},
        {&m_benchmarks, u"Type=1 OR Type=3 ORDER BY `Order`"_s}};
    for (const auto &[grid, filter] : lists) {
        RecordOperations::Query query = operations.openQuery(u"Fields"_s, filter, true);
        if (query.error) {
            errors.reportError(query.error->number, query.error->description, u"Program Setup"_s);
            continue;
        }
        GridOperations::fillGrid(*grid, query.records, false);
        GridOperations::formatSetupList(*grid, DataColumn);
    }
}

bool ProgramSetup::isHeading(List list, int row) const
{
    return (list == Mapping ? m_mappingList : m_benchmarkList).isHeading(row);
}

void ProgramSetup::commitEdit(List list, int row, const QString &text)
{
    GridModel &target = grid(list);
    if (row < 1 || row > target.rowCount() || isHeading(list, row))
        return;
    target.setCellText(row, DataColumn, text.trimmed());
}

bool ProgramSetup::save()
{
    MainDatabase &database = m_database;
    const auto asText = [](const QString &text) { return QVariant(text); };
    const QString context = u"Save Program Setup"_s;
    const bool saved = SetupList::saveTogether(m_database, m_prompter, context, [&] {
        return m_mappingList.saveInto(m_database, m_prompter, database.fieldsRecordset(),
                                      u"Fields"_s, u"Data"_s, asText, context) &&
               m_benchmarkList.saveInto(m_database, m_prompter, database.fieldsRecordset(),
                                        u"Fields"_s, u"Data"_s, asText, context);
    });
    database.requeryFields();
    return saved;
}
