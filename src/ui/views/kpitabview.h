// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "views/gridmodel.h"

#include <QWidget>

class AppContext;
class GraphArea;
class GridView;
class QLabel;
class TooltipPanel;

// What the main window shows of one KPI tab: the caption, the bar graph (Summary tab only),
// the grid, and the explanation panel of a picked Field. Picking a bar selects its row.
class KpiTabView : public QWidget
{
    Q_OBJECT

public:
    explicit KpiTabView(AppContext &context, QWidget *parent = nullptr);

    // Rebuilds the grid for the tab, and the graph on the Summary tab.
    void showTab(int tab);
    int currentTab() const { return m_tab; }

    GridModel &grid() { return m_grid; }
    GridView *lstGrid() const { return m_gridView; }
    GraphArea *picGraph() const { return m_graph; }
    TooltipPanel *picTooltip() const { return m_tooltip; }
    QLabel *lblTab() const { return m_caption; }

    // Opens the explanation of the row's Field under its "Field" cell.
    void explainRow(int row);

private:
    void selectField(qint64 fieldId);

    AppContext &m_context;
    GridModel m_grid;
    int m_tab = 1;
    QLabel *m_caption;
    GraphArea *m_graph;
    GridView *m_gridView;
    TooltipPanel *m_tooltip;
};
