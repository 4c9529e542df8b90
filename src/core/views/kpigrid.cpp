// Veltrix — KPI dashboard for small businesses.
#include "kpigrid.h"

#include "grid/gridoperations.h"
#include "kpievaluation.h"

#include "common/numberformat.h"
#include "common/prompter.h"
#include "database/maindatabase.h"
#include "database/recordoperations.h"
#include "engine/perioddataset.h"
#include "engine/usualsign.h"

using namespace Qt::StringLiterals;
using namespace GridOperations;

KpiGrid::KpiGrid(GridModel &grid, PeriodDataSet &data, MainDatabase &database, Prompter &prompter,
                 const NumberFormat &numbers)
    : m_grid(grid)
    , m_data(data)
    , m_database(database)
    , m_prompter(prompter)
    , m_numbers(numbers)
{}

QString KpiGrid::shownText(const QString &magnitude, bool unusualSign) const
{
    // Zero leaves the cell empty; a figure of the wrong sign for its Field keeps its minus.
    const double number = m_numbers.toNumber(magnitude);
    if (number == 0.0)
        return {};
    return unusualSign ? numberText(-std::fabs(number)) : magnitude;
}

QString KpiGrid::numberText(double value) const
{
    return m_numbers.locale().toString(value, 'g', QLocale::FloatingPointShortest);
}

void KpiGrid::fillValueColumn(const QString &valueKey, bool evaluate)
{
    m_valueColumn = m_grid.columnIndex(valueKey);
    const PeriodDataSet::Slot &slot = m_data.current();
    if (m_grid.rowCount() == 0 || slot.isEmpty() || m_valueColumn == 0)
        return;
    m_grid.setRedraw(false);
    const int benchmarkColumn = m_grid.columnIndex(u"benchmark"_s);
    const int typeColumn = m_grid.columnIndex(u"type"_s);
    const int variantColumn = m_grid.columnIndex(u"variant"_s);
    const int value = m_valueColumn;

    for (int row = 1; row <= m_grid.rowCount(); ++row) {
        m_grid.setRowVisible(row, false);
        const qint64 id = m_grid.cellText(row, 1).toLongLong();
        const double signedValue = m_data.getFieldValue(id);
        const bool unusualSign = UsualSign::isUnusual(id, signedValue);
        if (m_grid.cellText(row, 2) != u"1"_s) {
            const int pos = slot.findFieldPos(id);
            if (pos > 0)
                m_grid.setCellText(row, value, shownText(slot.fieldAbs.at(pos - 1), unusualSign));
        }
        const QString type = m_grid.cellText(row, typeColumn);
        if (type == u"2"_s && signedValue != 0.0)
            setCellStyle(m_grid, row, value, signedValue < 0 ? AccountBelow : AccountAbove, false);
        if (type == u"3"_s && benchmarkColumn)
            m_grid.setCellText(row, benchmarkColumn, m_grid.cellText(row, 3));
        m_grid.editCell(row, value).alignment = GridModel::CellLeft;

        if (type == u"1"_s) {
            m_grid.setRowVisible(row, true);
        } else if (type == u"2"_s) {
            m_grid.setCellText(row, value, m_numbers.formatMoney(m_grid.cellText(row, value)));
        } else if (type == u"3"_s) {
            if (evaluate) {
                evaluateGridRow(row, id);
                setCellStyle(m_grid, row, value, Percentage, true);
                if (benchmarkColumn) {
                    setCellStyle(m_grid, row, benchmarkColumn, Percentage, false);
                    m_grid.setCellText(
                        row, benchmarkColumn,
                        KpiEvaluation::benchmarkCellText(m_grid.cellText(row, benchmarkColumn)));
                }
                if (variantColumn && getCellNumber(m_grid, row, variantColumn, m_numbers) != 0.0) {
                    m_grid.setCellText(row, variantColumn,
                                       m_grid.cellText(row, variantColumn) + u'%');
                }
            }
            if (getCellNumber(m_grid, row, value, m_numbers) != 0.0)
                m_grid.setCellText(row, value, numberText(signedValue) + u'%');
            m_grid.editCell(row, value).alignment = GridModel::CellCentre;
        } else if (type == u"4"_s) {
            if (signedValue < 0)
                setCellStyle(m_grid, row, value, std::nullopt, true, NegativeText);
            const QString stored = m_grid.cellText(row, value);
            if (!stored.isEmpty())
                m_grid.setCellText(row, value, numberText(m_numbers.toNumber(stored)));
        } else {
            if (signedValue < 0)
                setCellStyle(m_grid, row, value, std::nullopt, true, NegativeText);
            m_grid.setCellText(row, value, m_numbers.formatMoney(m_grid.cellText(row, value)));
        }
        if (unusualSign)
            m_grid.editCell(row, value).back = Poor;
    }
    m_grid.setRedraw(true);
}

void KpiGrid::evaluateGridRow(int row, qint64 fieldId)
{
    const double actual = m_data.getFieldValue(fieldId);
    if (actual == 0.0)
        return;
    RecordSet &fields = m_database.fieldsRecordset();
    const qint64 id = m_grid.cellText(row, 1).toLongLong();
    if (!RecordOperations(m_database, m_prompter).findRecordById(fields, id)) {
        m_prompter.message(u"Could not find record with ID "_s + QString::number(id),
                           u"Benchmark Error"_s, Prompter::Icon::Exclamation);
        return;
    }
    const KpiEvaluation::Result result = KpiEvaluation::evaluateField(
        fieldId, fields.value(u"Data"_s).toString(), actual, m_numbers);
    const int variantColumn = m_grid.columnIndex(u"variant"_s);
    if (variantColumn == 0)
        return;
    const QColor colours[] = {Red, Yellow, Green};
    setCellStyle(m_grid, row, variantColumn, colours[std::min<int>(result.band, 2)], true);
    m_grid.setCellText(row, variantColumn, numberText(result.variant));
}

int KpiGrid::direction(int row, qint64 fieldId) const
{
    // A percentage whose benchmark asks for at most its optimal is better when lower; every
    // other figure is better when higher, a cost (negative) included: the smaller cost wins.
    if (UsualSign::of(fieldId) == UsualSign::Unknown)
        return 1;
    const QString optimal = m_grid.cellText(row, 3).split(u',').first();
    return optimal.contains(u'<') ? -1 : 1;
}

void KpiGrid::computeAverages(int lastSlot)
{
    const int averageColumn = m_grid.columnIndex(u"average"_s);
    const int typeColumn = m_grid.columnIndex(u"type"_s);
    for (int row = 1; row <= m_grid.rowCount(); ++row) {
        const qint64 id = m_grid.cellText(row, 1).toLongLong();
        // Averages and the best period are of signed figures: a loss month lowers the average
        // profit. A Field of unknown sign is compared by magnitude, as it is shown.
        const bool signKnown = UsualSign::of(id) != UsualSign::Unknown;
        const int better = direction(row, id);
        double sum = 0.0;
        int count = 0;
        double best = 0.0;
        int bestSlot = -1;
        for (int s = 0; s <= lastSlot; ++s) {
            m_data.setCurrentSlot(quint8(s));
            const double v = signKnown ? m_data.getFieldValue(id) : m_data.getFieldAbs(id);
            if (v == 0.0)
                continue;
            ++count;
            sum += v;
            if (bestSlot < 0 || better * v > better * best) {
                best = v;
                bestSlot = s;
            }
        }
        if (bestSlot >= 0) {
            const QString key = bestSlot == 0 ? u"value"_s : u"value"_s + QString::number(bestSlot);
            if (const int column = m_grid.columnIndex(key))
                m_grid.editCell(row, column).back = Highest;
        }
        if (averageColumn == 0)
            continue;
        m_grid.editCell(row, averageColumn).back = AverageBack;
        if (count == 0 || sum == 0.0)
            continue;
        const double average = sum / count;
        const int type = int(m_numbers.toNumber(m_grid.cellText(row, typeColumn)));
        m_grid.setCellText(row, averageColumn,
                           m_data.formatFieldValue(UsualSign::shown(id, average), type, false));
        if (UsualSign::isUnusual(id, average))
            m_grid.editCell(row, averageColumn).back = Poor;
    }
}
