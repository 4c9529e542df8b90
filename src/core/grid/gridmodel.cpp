// Veltrix — KPI dashboard for small businesses.
#include "gridmodel.h"

#include <QDateTime>
#include <QLocale>

#include <algorithm>

GridModel::GridModel(QObject *parent)
    : QObject(parent)
{}

void GridModel::addColumn(const QString &key, const QString &header, int alignment, int width,
                          bool visible)
{
    m_columns.append({key, header, alignment, width, visible, SortText, {}, {}});
    for (Row &row : m_rows)
        row.cells.append(Cell());
    changed();
}

int GridModel::columnIndex(const QString &key) const
{
    for (int i = 0; i < m_columns.size(); ++i) {
        if (m_columns[i].key.compare(key, Qt::CaseInsensitive) == 0)
            return i + 1;
    }
    return 0;
}

void GridModel::clear()
{
    m_rows.clear();
    m_selectedRow = 0;
    changed();
}

int GridModel::addRow()
{
    m_rows.append({QList<Cell>(m_columns.size()), true});
    changed();
    return rowCount();
}

void GridModel::removeRow(int row)
{
    m_rows.removeAt(row - 1);
    if (m_selectedRow == row)
        m_selectedRow = 0;
    else if (m_selectedRow > row)
        --m_selectedRow;
    changed();
}

void GridModel::setRowVisible(int row, bool visible)
{
    m_rows[row - 1].visible = visible;
    changed();
}

GridModel::Cell &GridModel::editCell(int row, int column)
{
    changed();
    return m_rows[row - 1].cells[column - 1];
}

QString GridModel::cellText(int row, int column) const
{
    const QVariant &value = cell(row, column).value;
    return value.isNull() ? QString() : value.toString();
}

void GridModel::setCellText(int row, int column, const QVariant &value)
{
    editCell(row, column).value = value;
}

void GridModel::setSelectedRow(int row)
{
    if (row == m_selectedRow)
        return;
    m_selectedRow = row;
    Q_EMIT selectionChanged(row);
}

void GridModel::setRedraw(bool on)
{
    m_redraw = on;
    if (on && m_pendingChange) {
        m_pendingChange = false;
        Q_EMIT contentChanged();
    }
}

void GridModel::setColumnVisible(int index, bool visible)
{
    column(index).visible = visible;
    changed();
}

void GridModel::setColumnHeader(int index, const QString &header)
{
    column(index).header = header;
    changed();
}

void GridModel::setColumnWidth(int index, int width)
{
    column(index).width = width;
    changed();
}

void GridModel::changed()
{
    if (m_redraw)
        Q_EMIT contentChanged();
    else
        m_pendingChange = true;
}

namespace {

// A date cell holds a date, or the text the program wrote it as in the column's format
// ("5 Dec 2026 9:05 AM", English month names whatever the region).
QDateTime dateOf(const QVariant &value, const QString &format)
{
    if (value.metaType().id() == QMetaType::QDateTime || value.metaType().id() == QMetaType::QDate)
        return value.toDateTime();
    const QString text = value.toString().trimmed();
    const QDateTime written = QLocale::c().toDateTime(text, format);
    return written.isValid() ? written : QDateTime::fromString(text, Qt::ISODate);
}

} // namespace

void GridModel::sort(int column, bool ascending, int sortType)
{
    const auto key = [&](const Row &row) { return row.cells.at(column - 1).value; };
    const QString dateFormat = m_columns.at(column - 1).dateFormat;
    const auto less = [&](const Row &a, const Row &b) {
        const QVariant left = key(a);
        const QVariant right = key(b);
        switch (sortType) {
        case SortNumber:
            return left.toDouble() < right.toDouble();
        case SortDate:
            return dateOf(left, dateFormat) < dateOf(right, dateFormat);
        default:
            return left.toString().compare(right.toString(), Qt::CaseInsensitive) < 0;
        }
    };
    const int selected = m_selectedRow;
    const Row selectedRow = selected > 0 ? m_rows.at(selected - 1) : Row();
    std::stable_sort(m_rows.begin(), m_rows.end(), [&](const Row &a, const Row &b) {
        return ascending ? less(a, b) : less(b, a);
    });
    if (selected > 0) {
        // The selection follows its row.
        for (int i = 0; i < m_rows.size(); ++i) {
            if (m_rows[i].cells.constData() == selectedRow.cells.constData()) {
                m_selectedRow = i + 1;
                break;
            }
        }
    }
    changed();
}
