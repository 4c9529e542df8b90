// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QTableView>

class GridModel;
class GridTableModel;

// A table view of a grid model: applies the grid's hidden rows and columns, column widths and
// selected row, and reports header clicks and picked cells by the grid's 1-based numbers.
class GridView : public QTableView
{
    Q_OBJECT

public:
    explicit GridView(GridModel &grid, QWidget *parent = nullptr);

    GridModel &grid() { return m_grid; }
    // The cell's rectangle in the view's coordinates, for panels opened under it.
    QRect cellRect(int row, int column) const;

Q_SIGNALS:
    void headerClicked(int column);
    void cellPicked(int row, int column);

private:
    void applyLayout();

    GridModel &m_grid;
    GridTableModel *m_model;
};
