// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "grid/gridmodel.h"

#include <QWidget>

class AppContext;
class GraphArea;
class GridView;
class QHBoxLayout;
class QLabel;
class TooltipPanel;

// What a KPI window shows of one tab: the caption, the bar graph (Summary tab only), the grid,
// and the explanation panel of a picked Field. Picking a bar selects its row. With earlier
// periods (the comparison window) the grid has a column per period and an average, and the
// graph a bar per Field and period.
class KpiTabView : public QWidget
{
    Q_OBJECT

public:
    explicit KpiTabView(AppContext &context, QWidget *parent = nullptr, int pastCount = 0);
    ~KpiTabView() override;

    // Rebuilds the grid for the tab, and the graph on the Summary tab.
    void showTab(int tab);
    // Shows nothing: no rows, no bars, no explanation.
    void clear();
    int currentTab() const { return m_tab; }
    int pastCount() const { return m_pastCount; }

    GridModel &grid() { return m_grid; }
    const GridModel &grid() const { return m_grid; }
    GridView *lstGrid() const { return m_gridView; }
    GraphArea *picGraph() const { return m_graph; }
    TooltipPanel *picTooltip() const { return m_tooltip; }
    QLabel *lblTab() const { return m_caption; }

    // Puts a widget at the right of the caption's line (the main window's colour legend).
    void setCaptionCompanion(QWidget *widget);
    // Opens the explanation of the row's Field under its "Field" cell.
    void explainRow(int row);
    // The months of a period slot as the comparison's legend and tips name them:
    // "Jul 2024 – Jun 2025".
    QString periodName(int slot) const;

private:
    void selectField(qint64 fieldId);

    AppContext &m_context;
    const int m_pastCount;
    GridModel m_grid;
    int m_tab = 1;
    QLabel *m_caption;
    QHBoxLayout *m_captionRow;
    GraphArea *m_graph;
    GridView *m_gridView;
    TooltipPanel *m_tooltip;
};
