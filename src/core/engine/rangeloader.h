// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QDate>

class AccountingSource;
class BusyState;
class MainDatabase;
class NumberFormat;
class PeriodDataSet;
class Prompter;

// Fills the current period slot with every KPI figure of one date range: the account-mapped
// Fields summed from the accounting package, then the derived Fields of the formula table.
// Every step is contained: a failing account query counts as 0 and a formula that fails
// (a division by zero) leaves its Field out; the load always runs to the end.
class RangeLoader
{
public:
    // The source may be null (nothing reached yet): every account figure then counts as 0.
    RangeLoader(PeriodDataSet &data, MainDatabase &database, AccountingSource *source,
                Prompter &prompter, const NumberFormat &numbers, BusyState &busy);

    void loadDateRange(const QDate &start, const QDate &end);
    // Records the range as the slot's, makes the slot current and loads it.
    void loadSlot(int slot, const QDate &start, const QDate &end);

    // Days from start to end whose weekday is Monday to Friday, both ends included.
    static int workingDays(const QDate &start, const QDate &end);
    // The rate of the Hours record with that ID; 0 when there is none or it is empty.
    double hourlyRate(int recordId);

private:
    bool outOfRange(const QDate &start, const QDate &end);
    void loadAccountFigures(const QDate &start, const QDate &end);
    void computeFormulas(int daySpan, int workingDays, int jobs);

    PeriodDataSet &m_data;
    MainDatabase &m_database;
    AccountingSource *m_source;
    Prompter &m_prompter;
    const NumberFormat &m_numbers;
    BusyState &m_busy;
};
