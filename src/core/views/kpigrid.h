// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "grid/gridmodel.h"

#include <QColor>

class MainDatabase;
class NumberFormat;
class PeriodDataSet;
class Prompter;

// Fills a KPI grid's value columns from the period data set and judges the percentages
// against their benchmarks. The grid's first three columns are "id", "type" and "data"; the
// others are found by key.
class KpiGrid
{
public:
    KpiGrid(GridModel &grid, PeriodDataSet &data, MainDatabase &database, Prompter &prompter,
            const NumberFormat &numbers);

    // One pass over the current slot into the column with the given key ("value",
    // "value1", ...). Rows are hidden except headings; the caller shows the user's lines.
    // With nothing in the slot the pass leaves the grid as it is.
    void fillValueColumn(const QString &valueKey, bool evaluate);
    // Colours and fills the row's variant cell from its Field's benchmark.
    void evaluateGridRow(int row, qint64 fieldId);
    // Highlights each row's best period in the Field's own direction and writes its average
    // over slots 0 to lastSlot.
    void computeAverages(int lastSlot);

    static inline const QColor Green = QColor(0xA2, 0xE1, 0x1B);
    static inline const QColor Yellow = QColor(0xF4, 0xDA, 0x64);
    static inline const QColor Red = QColor(0xE1, 0x83, 0x74);
    // A figure whose sign is opposite to its Field's usual one is marked as poor.
    static inline const QColor Poor = Red;
    static inline const QColor AccountAbove = QColor(0xDD, 0xFF, 0xDD);
    static inline const QColor AccountBelow = QColor(0xFF, 0xE3, 0xDD);
    static inline const QColor Percentage = QColor(0xD3, 0xED, 0xF7);
    static inline const QColor NegativeText = QColor(0xC0, 0x29, 0x00);
    static inline const QColor Highest = QColor(0xFF, 0xE9, 0x80);
    static inline const QColor AverageBack = QColor(0xF0, 0xF0, 0xF0);

private:
    QString shownText(const QString &magnitude, bool unusualSign) const;
    QString numberText(double value) const;
    // 1 when a higher figure is the better one, -1 when a lower one is.
    int direction(int row, qint64 fieldId) const;

    GridModel &m_grid;
    PeriodDataSet &m_data;
    MainDatabase &m_database;
    Prompter &m_prompter;
    const NumberFormat &m_numbers;
    int m_valueColumn = 0;
};
