// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QHash>
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
    void setIcons(const QList<QIcon> &icons);
    // With cell editing on, typed characters, Enter and F2 ask to edit the current cell
    // instead of searching the list.
    void setCellEditing(bool on) { m_cellEditing = on; }
    // The column (1-based) that takes whatever width the other columns leave, as the view
    // is resized; 0 for none.
    void setFittedColumn(int column);
    // Column widths, hidden columns and rows as the grid model now has them.
    void applyLayout();
    // The cell's rectangle in the view's coordinates, for panels opened under it.
    QRect cellRect(int row, int column) const;

Q_SIGNALS:
    void headerClicked(int column);
    void cellPicked(int row, int column);
    // A click, a typed character (key) or Enter/F2 (no key) on a cell asks to edit it.
    void editRequested(int row, int column, QChar key);

protected:
    void keyPressEvent(QKeyEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;

private:
    GridModel &m_grid;
    GridTableModel *m_model;
    bool m_cellEditing = false;
    bool m_gridAlive = true;
    // Widths the user dragged a column to, by column: they hold when the grid is filled again
    // (another tab), never narrower than the column's contents.
    QHash<int, int> m_userWidths;
    bool m_layingOut = false;
    int m_fittedColumn = 0;

    void fitColumn();
};
