// Veltrix — KPI dashboard for small businesses.
#include "celleditor.h"

#include "grid/gridmodel.h"
#include "views/gridview.h"

#include <QKeyEvent>

CellEditor::CellEditor(QWidget *parent)
    : QLineEdit(parent)
{
    setObjectName(QStringLiteral("txtEdit"));
    setFrame(false);
    hide();
}

void CellEditor::openCell(GridView *grid, int row, int column, QChar key)
{
    if (key == QChar(0x1B) || !grid || row < 1 || row > grid->grid().rowCount())
        return;
    m_grid = grid;
    m_row = row;
    const GridModel &model = grid->grid();
    const QRect cell = grid->cellRect(row, column);
    setGeometry(QRect(grid->viewport()->mapTo(parentWidget(), cell.topLeft()), cell.size()));
    if (const std::optional<GridModel::Font> &font = model.cell(row, column).font) {
        QFont cellFont(font->family);
        cellFont.setPointSizeF(font->pointSize);
        cellFont.setBold(font->bold);
        setFont(cellFont);
    } else {
        setFont(grid->font());
    }
    const int alignment = model.column(column).alignment;
    setAlignment(alignment == GridModel::AlignCentre
                     ? Qt::AlignHCenter
                     : (alignment == GridModel::AlignRight ? Qt::AlignRight : Qt::AlignLeft));
    show();
    setFocus(Qt::OtherFocusReason);
    if (!key.isNull()) {
        setText(QString(key));
        end(false);
    } else {
        setText(model.cellText(row, column));
        selectAll();
    }
    raise();
}

void CellEditor::keyPressEvent(QKeyEvent *event)
{
    switch (event->key()) {
    case Qt::Key_Return:
    case Qt::Key_Enter:
        close(true);
        return;
    case Qt::Key_Up:
        close(true, -1);
        return;
    case Qt::Key_Down:
        close(true, 1);
        return;
    case Qt::Key_Escape:
        close(false);
        return;
    default:
        QLineEdit::keyPressEvent(event);
    }
}

void CellEditor::focusOutEvent(QFocusEvent *event)
{
    QLineEdit::focusOutEvent(event);
    if (isOpen())
        close(true);
}

void CellEditor::close(bool store, int move)
{
    GridView *grid = m_grid;
    const int row = m_row;
    if (!grid)
        return;
    // Closed first, so that the focus moving back to the grid does not finish it twice.
    m_grid = nullptr;
    m_row = 0;
    hide();
    if (store)
        Q_EMIT finished(grid, row, text());
    grid->setFocus(Qt::OtherFocusReason);
    if (move != 0) {
        GridModel &model = grid->grid();
        const int next = row + move;
        if (next >= 1 && next <= model.rowCount())
            model.setSelectedRow(next);
    }
}
