// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QColor>
#include <QList>
#include <QObject>
#include <QString>
#include <QVariant>

#include <optional>

// What every list of the program shows: columns addressed by key, rows that can be hidden,
// cells with a value, alignment, colours, font and icon, one selected row. Rows and columns
// count from 1. Changes made while drawing is suspended are announced once when it resumes.
class GridModel : public QObject
{
    Q_OBJECT

public:
    enum Alignment { AlignLeft = 0, AlignRight = 1, AlignCentre = 2 };  // columns
    enum CellAlignment { CellLeft = 0, CellCentre = 1, CellRight = 2 }; // cells
    enum SortType { SortNumber = 100, SortDate = 254, SortText = 103 };

    struct Font
    {
        QString family;
        double pointSize = 9.0;
        bool bold = false;
    };

    struct Column
    {
        QString key;
        QString header;
        int alignment = AlignLeft;
        int width = 80;
        bool visible = true;
        int sortType = SortText;
        QString dateFormat;
        QString tag;
    };

    struct Cell
    {
        QVariant value;
        int alignment = CellLeft;
        std::optional<QColor> back;
        std::optional<QColor> fore;
        std::optional<Font> font;
        int icon = -1;
    };

    explicit GridModel(QObject *parent = nullptr);

    void addColumn(const QString &key, const QString &header, int alignment, int width,
                   bool visible);
    int columnCount() const { return int(m_columns.size()); }
    const Column &column(int index) const { return m_columns.at(index - 1); }
    Column &column(int index) { return m_columns[index - 1]; }
    // Column changes that the views show at once.
    void setColumnVisible(int index, bool visible);
    void setColumnHeader(int index, const QString &header);
    void setColumnWidth(int index, int width);
    // 0 when no column has the key.
    int columnIndex(const QString &key) const;

    // Removes the rows; the columns stay.
    void clear();
    int addRow();
    void removeRow(int row);
    int rowCount() const { return int(m_rows.size()); }
    bool isRowVisible(int row) const { return m_rows.at(row - 1).visible; }
    void setRowVisible(int row, bool visible);

    const Cell &cell(int row, int column) const { return m_rows.at(row - 1).cells.at(column - 1); }
    // Changes one cell; every change goes through here so that it is announced.
    Cell &editCell(int row, int column);
    QString cellText(int row, int column) const;
    void setCellText(int row, int column, const QVariant &value);

    int selectedRow() const { return m_selectedRow; }
    void setSelectedRow(int row);

    const Font &font() const { return m_font; }
    void setFont(const Font &font) { m_font = font; }
    // The colours of cells that have none of their own.
    QColor foreground() const { return m_foreground; }
    void setForeground(const QColor &colour) { m_foreground = colour; }
    QColor background() const { return m_background; }
    void setBackground(const QColor &colour) { m_background = colour; }

    // Drawing switch: off suspends the announcements until it is on again.
    void setRedraw(bool on);
    bool redraw() const { return m_redraw; }

    // Stable sort by one column, comparing by the given sort type.
    void sort(int column, bool ascending, int sortType);

Q_SIGNALS:
    void contentChanged();
    void selectionChanged(int row);

private:
    struct Row
    {
        QList<Cell> cells;
        bool visible = true;
    };

    void changed();

    QList<Column> m_columns;
    QList<Row> m_rows;
    Font m_font{QStringLiteral("Sans Serif"), 9.0, false};
    QColor m_foreground = QColor(0, 0, 0);
    QColor m_background = QColor(0xFF, 0xFF, 0xFF);
    int m_selectedRow = 0;
    bool m_redraw = true;
    bool m_pendingChange = false;
};
