// Veltrix — KPI dashboard for small businesses.
#include "gridoperations.h"

#include "common/numberformat.h"
#include "database/recordset.h"

#include <QDateTime>

using namespace Qt::StringLiterals;

namespace GridOperations {

void setupGrid(GridModel &grid)
{
    static const QStringList NumberKeys = {u"length"_s, u"width"_s, u"order"_s,
                                           u"total"_s,  u"price"_s, u"amount"_s,
                                           u"cost"_s,   u"quant"_s, u"id"_s};
    for (int c = 1; c <= grid.columnCount(); ++c) {
        GridModel::Column &column = grid.column(c);
        const QString key = column.key.toLower();
        const bool number = std::any_of(NumberKeys.cbegin(), NumberKeys.cend(),
                                        [&](const QString &word) { return key.contains(word); });
        if (number) {
            column.sortType = GridModel::SortNumber;
        } else if (key.contains(u"date"_s)) {
            column.sortType = GridModel::SortDate;
            column.dateFormat = u"d MMM yyyy h:mm AP"_s;
        } else {
            column.sortType = GridModel::SortText;
        }
    }
}

void fillGrid(GridModel &grid, RecordSet &records, bool dates)
{
    grid.setRedraw(false);
    grid.clear();
    if (!records.moveFirst()) {
        for (; !records.eof(); records.moveNext()) {
            const int row = grid.addRow();
            for (int c = 1; c <= grid.columnCount(); ++c) {
                const GridModel::Column &column = grid.column(c);
                const QString field = column.key.toLower();
                QVariant value = records.hasField(field) ? records.value(field) : QVariant();
                GridModel::Cell &cell = grid.editCell(row, c);
                if (!(dates && field.contains(u"date"_s) && value.canConvert<QDateTime>() &&
                      value.toDateTime().isValid()))
                    value = value.isNull() ? QString() : value.toString();
                cell.value = value;
                cell.alignment =
                    column.alignment == GridModel::AlignCentre
                        ? GridModel::CellCentre
                        : (column.alignment == GridModel::AlignRight ? GridModel::CellRight
                                                                     : GridModel::CellLeft);
            }
        }
    }
    grid.setRedraw(true);
}

void formatSetupList(GridModel &grid, int column)
{
    for (int row = 1; row <= grid.rowCount(); ++row) {
        if (grid.cellText(row, 2) == u"1"_s) {
            if (row > 1 && grid.cellText(row - 1, 2) == u"1"_s) {
                grid.removeRow(row - 1);
                --row;
            }
            setHeadingStyle(grid, row, 3);
        } else {
            grid.editCell(row, column).back = EditableBack;
        }
    }
}

int fitColumn(GridModel &grid, int column, int gridWidthPixels, int scrollBarSize, bool hasBorder)
{
    int others = 0;
    for (int c = 1; c <= grid.columnCount(); ++c) {
        if (c != column && grid.column(c).visible)
            others += grid.column(c).width;
    }
    int available = gridWidthPixels - others - scrollBarSize - (hasBorder ? 4 : 0);
    available = std::max(available, 16);
    grid.column(column).width = available;
    return available;
}

void sortGrid(GridModel &grid, int column, bool ascending)
{
    GridModel::Column &sorted = grid.column(column);
    sorted.tag = ascending ? u"ASCEND"_s : QString();
    grid.sort(column, ascending, sorted.sortType);
}

void selectRowById(GridModel &grid, qint64 id)
{
    if (grid.rowCount() == 0)
        return;
    int selected = 1;
    if (id >= 1) {
        for (int row = 1; row <= grid.rowCount(); ++row) {
            if (grid.cellText(row, 1) == QString::number(id)) {
                selected = row;
                break;
            }
        }
    }
    grid.setSelectedRow(selected);
}

int findGridRow(const GridModel &grid, int column, const QString &text)
{
    for (int row = 1; row <= grid.rowCount(); ++row) {
        if (grid.cellText(row, column).compare(text, Qt::CaseInsensitive) == 0)
            return row;
    }
    return 0;
}

void setCellStyle(GridModel &grid, int row, int column, std::optional<QColor> back, bool bold,
                  std::optional<QColor> fore)
{
    GridModel::Cell &cell = grid.editCell(row, column);
    if (back)
        cell.back = back;
    if (fore)
        cell.fore = fore;
    if (bold)
        cell.font = GridModel::Font{grid.font().family, grid.font().pointSize, true};
}

void setHeadingStyle(GridModel &grid, int row, int column)
{
    GridModel::Cell &cell = grid.editCell(row, column);
    cell.font = GridModel::Font{grid.font().family, grid.font().pointSize + 1, true};
    cell.fore = QColor(Qt::white);
    cell.back = HeadingBack;
}

QString getCellText(const GridModel &grid, int row, int column)
{
    return grid.cellText(row, column);
}

double getCellNumber(const GridModel &grid, int row, int column, const NumberFormat &numbers)
{
    return numbers.toNumber(grid.cellText(row, column));
}

} // namespace GridOperations
