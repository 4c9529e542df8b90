// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "setuplist.h"

#include "grid/gridmodel.h"

class MainDatabase;
class Prompter;

// The Program Setup lists: the accounting codes of every account field ("Account Code
// Mapping") and the benchmark of every KPI field ("Benchmark Percentages"), both kept in the
// Data column of the Fields table.
class ProgramSetup
{
public:
    static constexpr int TypeColumn = 2;
    static constexpr int LabelColumn = 3;
    static constexpr int DataColumn = 4;
    enum List { Mapping = 0, Benchmarks = 1 };

    ProgramSetup(MainDatabase &database, Prompter &prompter);

    void load();
    GridModel &grid(List list) { return list == Mapping ? m_mapping : m_benchmarks; }
    bool isHeading(List list, int row) const;
    // A finished edit: the text without its surrounding blanks; headings are never changed.
    void commitEdit(List list, int row, const QString &text);
    // Writes both lists and reads the Fields again for every view; false when a failure
    // stopped it (reported under "Save Program Setup").
    bool save();

private:
    MainDatabase &m_database;
    Prompter &m_prompter;
    GridModel m_mapping;
    GridModel m_benchmarks;
    SetupList m_mappingList;
    SetupList m_benchmarkList;
};
