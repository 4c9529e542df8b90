// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QLineEdit>

#include <functional>

class GridView;

// The edit box of the setup lists, laid over one cell of a grid. Enter, leaving the box and
// the Up and Down arrows finish the edit (the arrows then move the selection on); Escape
// abandons it. One box may serve several grids.
class CellEditor : public QLineEdit
{
    Q_OBJECT

public:
    explicit CellEditor(QWidget *parent);

    // Opens the box over the cell. A key that opened it becomes the text, with the caret at
    // its end; without one the cell's text is shown, all selected. Escape opens nothing.
    void openCell(GridView *grid, int row, int column, QChar key = {});
    GridView *grid() const { return m_grid; }
    int row() const { return m_row; }
    bool isOpen() const { return m_grid != nullptr; }
    // Ends an open edit as Enter would.
    void commit() { close(true); }

Q_SIGNALS:
    // The edit ended by the user's choice: the text is to be stored in the row's cell.
    void finished(GridView *grid, int row, const QString &text);

protected:
    void keyPressEvent(QKeyEvent *event) override;
    void focusOutEvent(QFocusEvent *event) override;

private:
    void close(bool store, int move = 0);

    GridView *m_grid = nullptr;
    int m_row = 0;
};
