// Veltrix — KPI dashboard for small businesses.
#include "gridview.h"

#include "gridtablemodel.h"

#include "grid/gridmodel.h"
#include "grid/gridoperations.h"

#include <QHeaderView>
#include <QKeyEvent>
#include <QScopedValueRollback>

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
    // A window may destroy its grid before the view that shows it (members go before child
    // widgets); from then on the view shows nothing rather than reading a grid that is gone.
    connect(&m_grid, &QObject::destroyed, this, [this] {
        m_gridAlive = false;
        setModel(nullptr);
    });
    connect(horizontalHeader(), &QHeaderView::sectionResized, this,
            [this](int section, int, int width) {
                if (!m_layingOut && section + 1 != m_fittedColumn)
                    m_userWidths.insert(section + 1, width);
            });
    connect(horizontalHeader(), &QHeaderView::sectionClicked, this,
            [this](int section) { Q_EMIT headerClicked(section + 1); });
    connect(this, &QTableView::clicked, this, [this](const QModelIndex &index) {
        m_grid.setSelectedRow(index.row() + 1);
        Q_EMIT cellPicked(index.row() + 1, index.column() + 1);
        Q_EMIT editRequested(index.row() + 1, index.column() + 1, QChar());
    });
    // Moving with the keyboard selects as a click does.
    connect(selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            [this](const QModelIndex &current) {
                if (current.isValid() && current.row() + 1 != m_grid.selectedRow())
                    m_grid.setSelectedRow(current.row() + 1);
            });
    connect(&m_grid, &GridModel::selectionChanged, this, [this](int row) {
        if (row > 0)
            selectRow(row - 1);
        else
            clearSelection();
    });
    applyLayout();
}

void GridView::setIcons(const QList<QIcon> &icons)
{
    m_model->setIcons(icons);
    viewport()->update();
}

void GridView::keyPressEvent(QKeyEvent *event)
{
    if (!m_cellEditing) {
        QTableView::keyPressEvent(event);
        return;
    }
    const QModelIndex current = currentIndex();
    const int row = current.isValid() ? current.row() + 1 : m_grid.selectedRow();
    const int column = current.isValid() ? current.column() + 1 : 1;
    const QString typed = event->text();
    if (row > 0 && (event->key() == Qt::Key_F2 || event->key() == Qt::Key_Return ||
                    event->key() == Qt::Key_Enter)) {
        Q_EMIT editRequested(row, column, QChar());
        return;
    }
    if (row > 0 && typed.size() == 1 && typed.at(0).isPrint() &&
        !(event->modifiers() & (Qt::ControlModifier | Qt::AltModifier))) {
        Q_EMIT editRequested(row, column, typed.at(0));
        return;
    }
    QTableView::keyPressEvent(event);
}

void GridView::setFittedColumn(int column)
{
    m_fittedColumn = column;
    fitColumn();
}

void GridView::resizeEvent(QResizeEvent *event)
{
    QTableView::resizeEvent(event);
    fitColumn();
}

void GridView::fitColumn()
{
    if (!m_gridAlive || m_fittedColumn < 1 || m_fittedColumn > m_grid.columnCount())
        return;
    const QScopedValueRollback layingOut(m_layingOut, true);
    // The viewport already leaves out the scroll bar and the frame; columns widened beyond
    // the grid's widths for their contents take their extra from the fitted column.
    int widened = 0;
    for (int c = 1; c <= m_grid.columnCount(); ++c) {
        if (c != m_fittedColumn && !isColumnHidden(c - 1))
            widened += std::max(0, columnWidth(c - 1) - m_grid.column(c).width);
    }
    const int width =
        GridOperations::fitColumn(m_grid, m_fittedColumn, viewport()->width() - widened, 0, false);
    setColumnWidth(m_fittedColumn - 1, width);
}

QRect GridView::cellRect(int row, int column) const
{
    return visualRect(m_model->index(row - 1, column - 1));
}

void GridView::applyLayout()
{
    if (!m_gridAlive)
        return;
    const QScopedValueRollback layingOut(m_layingOut, true);
    for (int c = 1; c <= m_grid.columnCount(); ++c) {
        const GridModel::Column &column = m_grid.column(c);
        const bool hidden = !column.visible || column.width == 0;
        setColumnHidden(c - 1, hidden);
        // No value is ever cut short: a column is at least as wide as its widest cell and its
        // header, whatever width the grid gives it.
        const bool fitsContents = !hidden && c != m_fittedColumn;
        setColumnWidth(c - 1, fitsContents ? std::max({m_userWidths.value(c, column.width),
                                                       sizeHintForColumn(c - 1),
                                                       horizontalHeader()->sectionSizeHint(c - 1)})
                                           : column.width);
    }
    for (int r = 1; r <= m_grid.rowCount(); ++r)
        setRowHidden(r - 1, !m_grid.isRowVisible(r));
    if (m_grid.selectedRow() > 0)
        selectRow(m_grid.selectedRow() - 1);
    fitColumn();
}
