// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "formula.h"

#include <QList>

// The fixed KPI definitions: which Field each step computes, from what, and how the result is
// stored. Steps run in order; later steps read what earlier ones stored, already rounded.
namespace FormulaTable {

struct Step
{
    int number;
    int field;
    Formula formula;
    int typeCode; // the storage rounding of the period data set
};

const QList<Step> &steps();

} // namespace FormulaTable
