// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QAbstractTableModel>
#include <QIcon>
#include <QList>
#include <QPointer>

class GridModel;

// Shows a grid model in Qt's item views: texts, colours, fonts and alignment per cell.
// Hidden rows and columns are the view's business (GridView applies them).
class GridTableModel : public QAbstractTableModel
{
    Q_OBJECT

public:
    explicit GridTableModel(GridModel &grid, QObject *parent = nullptr);

    int rowCount(const QModelIndex &parent = {}) const override;
    int columnCount(const QModelIndex &parent = {}) const override;
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation,
                        int role = Qt::DisplayRole) const override;

    GridModel &grid() { return m_grid; }
    // The pictures a cell's icon number stands for.
    void setIcons(const QList<QIcon> &icons) { m_icons = icons; }

private:
    GridModel &m_grid;
    QList<QIcon> m_icons;
};
