// Veltrix — KPI dashboard for small businesses.
#include "tabviewbuilder.h"

#include "grid/gridoperations.h"
#include "kpigrid.h"

#include "common/numberformat.h"
#include "common/prompter.h"
#include "database/maindatabase.h"
#include "database/recordoperations.h"
#include "engine/perioddataset.h"
#include "users/loginservice.h"
#include "users/loginstate.h"

using namespace Qt::StringLiterals;
using namespace GridOperations;

namespace {
const QColor RowBack(0xC0, 0xC0, 0xC0);
const QColor LabelBack(0xF0, 0xF0, 0xF0);
} // namespace

TabViewBuilder::TabViewBuilder(PeriodDataSet &data, MainDatabase &database, Prompter &prompter,
                               const NumberFormat &numbers, const LoginState &login,
                               GridModel &grid)
    : m_data(data)
    , m_database(database)
    , m_prompter(prompter)
    , m_numbers(numbers)
    , m_login(login)
    , m_grid(grid)
{}

QStringList TabViewBuilder::tabCaptions()
{
    return {u"&All"_s,   u"&Summary"_s,       u"&Labour"_s,   u"&Parts"_s,
            u"Pai&nt"_s, u"&Repair Orders"_s, u"&Financial"_s};
}

namespace {

// The Field's ID, type and data (hidden), its number and its label: every KPI grid starts so.
void addFieldColumns(GridModel &grid)
{
    grid.addColumn(u"id"_s, QString(), GridModel::AlignLeft, 0, true);
    grid.addColumn(u"type"_s, QString(), GridModel::AlignLeft, 80, false);
    grid.addColumn(u"data"_s, QString(), GridModel::AlignLeft, 80, false);
    grid.addColumn(u"row"_s, u"Row"_s, GridModel::AlignLeft, 45, true);
    grid.addColumn(u"label"_s, u"Field"_s, GridModel::AlignLeft, 250, true);
}

} // namespace

void TabViewBuilder::addMainColumns(GridModel &grid)
{
    addFieldColumns(grid);
    grid.addColumn(u"value"_s, u"Value"_s, GridModel::AlignCentre, 100, true);
    grid.addColumn(u"benchmark"_s, u"Optimal %"_s, GridModel::AlignCentre, 80, true);
    grid.addColumn(u"variant"_s, u"Variant"_s, GridModel::AlignCentre, 80, true);
    setupGrid(grid);
}

void TabViewBuilder::addCompareColumns(GridModel &grid)
{
    addFieldColumns(grid);
    for (int slot = PeriodDataSet::SlotCount - 1; slot >= 1; --slot) {
        grid.addColumn(u"value"_s + QString::number(slot), u"Value "_s + QString::number(slot + 1),
                       GridModel::AlignCentre, 110, false);
    }
    grid.addColumn(u"value"_s, u"Value"_s, GridModel::AlignCentre, 110, true);
    grid.addColumn(u"benchmark"_s, u"Optimal %"_s, GridModel::AlignCentre, 0, false);
    grid.addColumn(u"average"_s, u"Average"_s, GridModel::AlignRight, 100, true);
    setupGrid(grid);
}

void TabViewBuilder::fill(int tab)
{
    MainDatabase &database = m_database;
    RecordSet &records = tab == 0 ? database.fieldsRecordset() : database.tabRecordset(tab);
    fillGrid(m_grid, records, false);
    numberAndStyleRows();
}

void TabViewBuilder::buildSlotView(int tab, int slot)
{
    const BusyPointer busy(m_prompter);
    fill(tab);
    PeriodDataSet &data = m_data;
    data.setCurrentSlot(quint8(slot));
    KpiGrid(m_grid, data, m_database, m_prompter, m_numbers).fillValueColumn(u"value"_s, true);
    applyUsersLines();
}

void TabViewBuilder::buildTabView(int tab, int pastCount)
{
    const BusyPointer busy(m_prompter);
    fill(tab);
    PeriodDataSet &data = m_data;
    KpiGrid kpis(m_grid, data, m_database, m_prompter, m_numbers);
    for (int p = 0; p <= pastCount; ++p) {
        data.setCurrentSlot(quint8(p));
        kpis.fillValueColumn(p == 0 ? u"value"_s : u"value"_s + QString::number(p), pastCount == 0);
    }
    applyUsersLines();
}

QList<TabViewBuilder::GraphBar> TabViewBuilder::graphBars(const GridModel &grid, int pastCount)
{
    QList<GraphBar> bars;
    PeriodDataSet &data = m_data;
    MainDatabase &database = m_database;
    const RecordOperations records(database, m_prompter);
    const int benchmarkColumn = grid.columnIndex(u"benchmark"_s);
    for (int row = 1; benchmarkColumn && row <= grid.rowCount(); ++row) {
        // A line the user may not see has no bar either.
        if (!grid.isRowVisible(row) || grid.cellText(row, benchmarkColumn).isEmpty())
            continue;
        const qint64 id = grid.cellText(row, 1).toLongLong();
        // A Field without a record has no benchmark to draw against in any period.
        if (!records.findRecordById(database.fieldsRecordset(), id))
            continue;
        const QString benchmark = database.fieldsRecordset().value(u"Data"_s).toString();
        for (int slot = pastCount; slot >= 0; --slot) {
            data.setCurrentSlot(quint8(slot));
            if (data.current().findFieldPos(id) != 0)
                bars << GraphBar{id, benchmark, data.getFieldValue(id), slot};
        }
    }
    data.setCurrentSlot(0);
    return bars;
}

void TabViewBuilder::numberAndStyleRows()
{
    const int rowColumn = m_grid.columnIndex(u"row"_s);
    const int labelColumn = m_grid.columnIndex(u"label"_s);
    const int typeColumn = m_grid.columnIndex(u"type"_s);
    int counter = 0;
    for (int row = 1; row <= m_grid.rowCount(); ++row) {
        ++counter;
        setCellStyle(m_grid, row, rowColumn, RowBack, true);
        setCellStyle(m_grid, row, labelColumn, LabelBack, false);
        if (m_grid.cellText(row, typeColumn) == u"1"_s) {
            setHeadingStyle(m_grid, row, rowColumn);
            setHeadingStyle(m_grid, row, labelColumn);
            m_grid.setCellText(row, labelColumn, m_grid.cellText(row, labelColumn).toUpper());
            --counter;
        } else {
            m_grid.setCellText(row, rowColumn, QString::number(counter));
        }
    }
}

void TabViewBuilder::applyUsersLines()
{
    const LoginState &login = m_login;
    if (login.currentUser.toLower() == LoginService::BuiltInUser) {
        for (int row = 1; row <= m_grid.rowCount(); ++row)
            m_grid.setRowVisible(row, true);
        return;
    }
    const QStringList groups = login.currentUserFields.split(u'#');
    for (const QString &group : groups) {
        const QStringList ids = group.split(u',');
        for (const QString &id : ids) {
            if (const int row = findGridRow(m_grid, 1, id.trimmed()); row > 0)
                m_grid.setRowVisible(row, true);
        }
    }
}
