// Veltrix — KPI dashboard for small businesses.
#include "gridview.h"

#include "gridtablemodel.h"

#include "views/gridmodel.h"

#include <QHeaderView>

GridView::GridView(GridModel &grid, QWidget *parent)
    : QTableView(parent)
    , m_grid(grid)
    , m_model(new GridTableModel(grid, this))
{
    setModel(m_model);
    setSelectionBehavior(QAbstractItemView::SelectRows);
    setSelectionMode(QAbstractItemView::SingleSelection);
    setEditTriggers(QAbstractItemView::NoEditTriggers);
    verticalHeader()->hide();
    verticalHeader()->setDefaultSectionSize(20);
    horizontalHeader()->setHighlightSections(false);
    // The picked row must stand out over the cells' own colours.
    setStyleSheet(
        QStringLiteral("QTableView::item:selected { background: #FFCC43; color: black; }"));

    connect(m_model, &QAbstractItemModel::modelReset, this, &GridView::applyLayout);
    connect(horizontalHeader(), &QHeaderView::sectionClicked, this,
            [this](int section) { Q_EMIT headerClicked(section + 1); });
    connect(this, &QTableView::clicked, this, [this](const QModelIndex &index) {
        m_grid.setSelectedRow(index.row() + 1);
        Q_EMIT cellPicked(index.row() + 1, index.column() + 1);
    });
    connect(&m_grid, &GridModel::selectionChanged, this, [this](int row) {
        if (row > 0)
            selectRow(row - 1);
        else
            clearSelection();
    });
    applyLayout();
}

QRect GridView::cellRect(int row, int column) const
{
    return visualRect(m_model->index(row - 1, column - 1));
}

void GridView::applyLayout()
{
    for (int c = 1; c <= m_grid.columnCount(); ++c) {
        const GridModel::Column &column = m_grid.column(c);
        setColumnHidden(c - 1, !column.visible || column.width == 0);
        setColumnWidth(c - 1, column.width);
    }
    for (int r = 1; r <= m_grid.rowCount(); ++r)
        setRowHidden(r - 1, !m_grid.isRowVisible(r));
    if (m_grid.selectedRow() > 0)
        selectRow(m_grid.selectedRow() - 1);
}
