// Veltrix — KPI dashboard for small businesses.
#include "gridtablemodel.h"

#include "grid/gridmodel.h"

#include <QFont>

GridTableModel::GridTableModel(GridModel &grid, QObject *parent)
    : QAbstractTableModel(parent)
    , m_grid(grid)
{
    // The grid announces whole batches of changes; the views redraw once per batch.
    connect(&m_grid, &GridModel::contentChanged, this, [this] {
        beginResetModel();
        endResetModel();
    });
}

int GridTableModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : m_grid.rowCount();
}

int GridTableModel::columnCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : m_grid.columnCount();
}

QVariant GridTableModel::data(const QModelIndex &index, int role) const
{
    if (!index.isValid())
        return {};
    const int row = index.row() + 1;
    const int column = index.column() + 1;
    const GridModel::Cell &cell = m_grid.cell(row, column);
    switch (role) {
    case Qt::DisplayRole:
        return m_grid.cellText(row, column);
    case Qt::DecorationRole:
        return cell.icon >= 0 && cell.icon < m_icons.size() ? QVariant(m_icons.at(cell.icon))
                                                            : QVariant();
    case Qt::BackgroundRole:
        return cell.back ? QVariant(*cell.back) : QVariant();
    case Qt::ForegroundRole:
        return cell.fore ? QVariant(*cell.fore) : QVariant();
    case Qt::FontRole: {
        if (!cell.font)
            return {};
        QFont font(cell.font->family);
        font.setPointSizeF(cell.font->pointSize);
        font.setBold(cell.font->bold);
        return font;
    }
    case Qt::TextAlignmentRole: {
        const Qt::Alignment horizontal =
            cell.alignment == GridModel::CellCentre
                ? Qt::AlignHCenter
                : (cell.alignment == GridModel::CellRight ? Qt::AlignRight : Qt::AlignLeft);
        return QVariant::fromValue(horizontal | Qt::AlignVCenter);
    }
    default:
        return {};
    }
}

QVariant GridTableModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation == Qt::Horizontal && role == Qt::DisplayRole && section < m_grid.columnCount())
        return m_grid.column(section + 1).header;
    return QAbstractTableModel::headerData(section, orientation, role);
}
