// Veltrix — KPI dashboard for small businesses.
#include "rangeloader.h"

#include "formulatable.h"
#include "perioddataset.h"

#include "common/busystate.h"
#include "common/numberformat.h"
#include "common/prompter.h"
#include "database/maindatabase.h"
#include "database/recordoperations.h"
#include "sources/accountingsource.h"

using namespace Qt::StringLiterals;

RangeLoader::RangeLoader(PeriodDataSet &data, MainDatabase &database, AccountingSource *source,
                         Prompter &prompter, const NumberFormat &numbers, BusyState &busy)
    : m_data(data)
    , m_database(database)
    , m_source(source)
    , m_prompter(prompter)
    , m_numbers(numbers)
    , m_busy(busy)
{}

int RangeLoader::workingDays(const QDate &start, const QDate &end)
{
    int count = 0;
    for (QDate day = start; day.isValid() && day <= end; day = day.addDays(1)) {
        if (day.dayOfWeek() <= 5)
            ++count;
    }
    return count;
}

double RangeLoader::hourlyRate(int recordId)
{
    RecordSet &hours = m_database.hoursRecordset();
    if (!RecordOperations(m_database, m_prompter).findRecordById(hours, recordId))
        return 0.0;
    const QVariant rate = hours.value(u"Value"_s);
    return rate.isNull() ? 0.0 : m_numbers.toNumber(rate);
}

void RangeLoader::loadSlot(int slot, const QDate &start, const QDate &end)
{
    PeriodDataSet &data = m_data;
    data.setRange(slot, {start, end});
    data.setCurrentSlot(quint8(slot));
    loadDateRange(start, end);
}

void RangeLoader::loadDateRange(const QDate &start, const QDate &end)
{
    const BusyPointer busyPointer(m_prompter);
    const BusyState::Scope busy(m_busy);
    const int daySpan = int(start.daysTo(end));
    const int working = workingDays(start, end);
    const bool beyondPeriod = outOfRange(start, end);

    PeriodDataSet &data = m_data;
    const int slot = data.currentSlot();
    data.clearCurrent();
    data.setFilling(slot, true);
    if (!beyondPeriod)
        loadAccountFigures(start, end);

    AccountingSource *source = m_source;
    const int jobs = source ? source->jobsCount(start, end) : 0;
    computeFormulas(daySpan, working, jobs);
    data.setFilling(slot, false);
}

bool RangeLoader::outOfRange(const QDate &start, const QDate &end)
{
    AccountingSource *source = m_source;
    if (!source)
        return false;
    const std::optional<QDate> periodEnd = source->currentPeriodEnd();
    if (!periodEnd)
        return false;
    // A period end that cannot be read counts as the earliest date: nothing is in range.
    if (periodEnd->isValid() && end <= *periodEnd)
        return false;
    const QLocale &locale = m_numbers.locale();
    const auto shortDate = [&](const QDate &date) {
        return date.isValid() ? locale.toString(date, QLocale::ShortFormat) : QString();
    };
    const QString range =
        u"The selected date range "_s + shortDate(start) + u" to "_s + shortDate(end);
    m_prompter.message(
        periodEnd->isValid()
            ? range + u" exceeds the\r\naccounting period of your MoneyWorks file which ends "_s +
                  shortDate(*periodEnd) + u"!"_s
            : range + u" cannot be checked against the\r\naccounting period of your MoneyWorks "_s +
                  u"file, whose end could not be read!"_s,
        u"Data Out Of Range"_s, Prompter::Icon::Exclamation);
    return true;
}

void RangeLoader::loadAccountFigures(const QDate &start, const QDate &end)
{
    RecordSet &fields = m_database.fieldsRecordset();
    if (fields.moveFirst())
        return;
    AccountingSource *source = m_source;
    PeriodDataSet &data = m_data;
    // A record set closed under the load (a disconnect) has no current record: the loop ends.
    for (; fields.hasCurrentRecord(); fields.moveNext()) {
        const int type = fields.value(u"Type"_s).toInt();
        if (type != 2)
            continue;
        double total = 0.0;
        const QStringList codes = fields.value(u"Data"_s).toString().split(u'+');
        for (const QString &code : codes) {
            const QString trimmed = code.trimmed();
            if (!trimmed.isEmpty() && source)
                total += source->accountMovement(trimmed, start, end);
        }
        data.storeAccountFigure(fields.value(u"ID"_s).toLongLong(), total, type);
    }
}

void RangeLoader::computeFormulas(int daySpan, int workingDays, int jobs)
{
    PeriodDataSet &data = m_data;
    Formula::Inputs inputs;
    inputs.value = [&](int id) { return data.getFieldValue(id); };
    inputs.magnitude = [&](int id) { return data.getFieldAbs(id); };
    inputs.sum = [&](int first, int last) { return data.sumFieldValues(first, last); };
    inputs.hourlyRate = [&](int id) { return hourlyRate(id); };
    inputs.daySpan = daySpan;
    inputs.workingDays = workingDays;
    inputs.jobs = jobs;

    for (const FormulaTable::Step &step : FormulaTable::steps()) {
        if (const std::optional<double> value = step.formula.evaluate(inputs))
            data.storeFieldValue(step.field, *value, step.typeCode);
    }
}
