// Veltrix — KPI dashboard for small businesses.
#include "hourlyrates.h"

#include "common/errorreporter.h"
#include "common/numberformat.h"
#include "common/prompter.h"
#include "database/maindatabase.h"
#include "database/recordoperations.h"
#include "grid/gridoperations.h"

using namespace Qt::StringLiterals;

HourlyRates::HourlyRates(MainDatabase &database, Prompter &prompter, const NumberFormat &numbers)
    : m_database(database)
    , m_prompter(prompter)
    , m_numbers(numbers)
    , m_list(m_grid, {RateColumn, 0})
{}

void HourlyRates::load()
{
    m_grid.addColumn(u"id"_s, QString(), GridModel::AlignLeft, 0, true);
    m_grid.addColumn(u"department"_s, u"Department"_s, GridModel::AlignLeft, 200, true);
    m_grid.addColumn(u"value"_s, u"Rate $/hour"_s, GridModel::AlignLeft, RateWidth, true);
    GridOperations::setupGrid(m_grid);

    MainDatabase &database = m_database;
    // The standing record set is read again too, so that the save compares with what this
    // list shows and not with what was there when the program started.
    if (const std::optional<DbError> failure = database.hoursRecordset().requery()) {
        ErrorReporter(m_prompter)
            .reportError(failure->number, failure->description, u"Labour Hours"_s);
    }
    RecordOperations::Query query =
        RecordOperations(database, m_prompter).openQuery(u"Hours"_s, QString(), true);
    if (query.error) {
        ErrorReporter(m_prompter)
            .reportError(query.error->number, query.error->description, u"Labour Hours"_s);
        return;
    }
    GridOperations::fillGrid(m_grid, query.records, false);
    m_grid.setRedraw(false);
    for (int row = 1; row <= m_grid.rowCount(); ++row) {
        m_grid.editCell(row, RateColumn).back = GridOperations::EditableBack;
        // Stored rates are shown as money too, the way an edited rate is; an empty rate
        // stays empty. The list holds them as the database wrote them, in C notation.
        bool isNumber = false;
        const double rate = QLocale::c().toDouble(m_grid.cellText(row, RateColumn), &isNumber);
        if (isNumber)
            m_grid.setCellText(row, RateColumn, m_numbers.formatMoney(rate, false));
    }
    m_grid.setRedraw(true);
    m_list.rememberShownTexts();
}

bool HourlyRates::commitEdit(int row, const QString &text)
{
    if (row < 1 || row > m_grid.rowCount())
        return false;
    const NumberFormat &numbers = m_numbers;
    // An emptied box clears the rate.
    const std::optional<double> rate =
        text.trimmed().isEmpty() ? std::optional<double>(0.0) : numbers.parseNumber(text);
    if (!rate) {
        m_prompter.message(
            u"\"%1\" is not an hourly rate. Type the rate in dollars, for example %2.\r\n\r\n"
            u"The rate of %3 has not been changed."_s.arg(
                text.trimmed(), numbers.formatMoney(65.5, false),
                m_grid.cellText(row, m_grid.columnIndex(u"department"_s))),
            u"Invalid Rate"_s, Prompter::Icon::Exclamation);
        return false;
    }
    m_grid.setCellText(row, RateColumn, numbers.formatMoney(*rate, false));
    return true;
}

bool HourlyRates::save()
{
    MainDatabase &database = m_database;
    const NumberFormat &numbers = m_numbers;
    const QString errorContext = u"Save Labour Hours"_s;
    const bool saved = SetupList::saveTogether(m_database, m_prompter, errorContext, [&] {
        return m_list.saveInto(
            m_database, m_prompter, database.hoursRecordset(), u"Hours"_s, u"Value"_s,
            [&numbers](const QString &text) { return QVariant(numbers.toNumber(text)); },
            errorContext);
    });
    database.hoursRecordset().requery();
    return saved;
}
