// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "setuplist.h"

#include "grid/gridmodel.h"

class MainDatabase;
class Prompter;
class NumberFormat;

// The Labour Hours list: one hourly rate per department, kept in the Hours table and read by
// the formulas that cost labour.
class HourlyRates
{
public:
    static constexpr int RateColumn = 3;
    static constexpr int RateWidth = 100;

    HourlyRates(MainDatabase &database, Prompter &prompter, const NumberFormat &numbers);

    // Reads the departments and their rates; the rate cells are marked editable.
    void load();
    GridModel &grid() { return m_grid; }
    // A finished edit of a row's rate: a number is shown as money ("1,234.50") and an empty
    // box as 0.00; anything else is refused with a message and the rate stays as it was.
    bool commitEdit(int row, const QString &text);
    // Writes every rate; false when a failure stopped it (reported under "Save Labour Hours").
    bool save();

private:
    MainDatabase &m_database;
    Prompter &m_prompter;
    const NumberFormat &m_numbers;
    GridModel m_grid;
    SetupList m_list;
};
