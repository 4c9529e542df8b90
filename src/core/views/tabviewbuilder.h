// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

class PeriodDataSet;
class MainDatabase;
class Prompter;
class NumberFormat;
class LoginState;
class GridModel;

// What a tab of the KPI views shows: its Fields as grid rows in order, numbered and styled,
// with one value column per period and only the lines the logged-in user may see.
class TabViewBuilder
{
public:
    static constexpr int TabCount = 7; // "All" and the six tabs of the Fields table
    static constexpr int SummaryTab = 1;
    static constexpr int FinancialTab = 6;

    TabViewBuilder(PeriodDataSet &data, MainDatabase &database, Prompter &prompter,
                   const NumberFormat &numbers, const LoginState &login, GridModel &grid);

    // "&All", "&Summary", ...
    static QStringList tabCaptions();
    // The columns of the main window's KPI grid.
    static void addMainColumns(GridModel &grid);
    // The columns of the comparison grid: the earlier periods' columns start hidden.
    static void addCompareColumns(GridModel &grid);

    // One bar of the graph: a percentage Field with data in the current slot, its signed value.
    struct GraphBar
    {
        qint64 fieldId = 0;
        QString benchmark;
        double value = 0.0;
        int slot = 0;
    };

    // The bars of the graph, from the grid's visible rows with a benchmark, in order; with earlier
    // periods each Field has one bar per period with data, the oldest first.
    QList<GraphBar> graphBars(const GridModel &grid, int pastCount = 0);

    // pastCount is 0 in the main window, 1 to 4 in the comparison window.
    void buildTabView(int tab, int pastCount);
    // The main window's view of one period slot other than 0, for tools that list slots one
    // after the other.
    void buildSlotView(int tab, int slot);

private:
    void fill(int tab);
    void numberAndStyleRows();
    void applyUsersLines();

    PeriodDataSet &m_data;
    MainDatabase &m_database;
    Prompter &m_prompter;
    const NumberFormat &m_numbers;
    const LoginState &m_login;
    GridModel &m_grid;
};
