// Veltrix — KPI dashboard for small businesses.
#include "producecommand.h"

#include "app/contextwiring.h"
#include "engine/rangeloader.h"

#include "appcontext.h"
#include "common/errorreporter.h"
#include "common/prompter.h"
#include "common/settingsstore.h"
#include "sources/sourcefactory.h"

using namespace Qt::StringLiterals;

ProduceCommand::ProduceCommand(AppContext &context)
    : m_context(context)
{}

QDate ProduceCommand::rangeStart(const Selection &selection)
{
    return QDate(selection.firstYear, selection.firstMonth, 1);
}

QDate ProduceCommand::rangeEnd(const Selection &selection)
{
    const QDate first(selection.lastYear, selection.lastMonth, 1);
    return first.isValid() ? first.addMonths(1).addDays(-1) : QDate();
}

ProduceCommand::Outcome ProduceCommand::produce(const Selection &selection, Remember remember)
{
    const BusyState::Scope busy(m_context.busyState());
    const Settings &settings = m_context.settings();
    if (!m_context.accountingSource())
        m_context.setAccountingSource(
            createAccountingSource(settings, m_context.prompter(), m_context.numberFormat()));
    AccountingSource *source = m_context.accountingSource();
    if (!source) {
        ErrorReporter(m_context.prompter())
            .reportError(429,
                         u"The accounting package \""_s + settings.accPackage +
                             u"\" cannot be read by this copy of Veltrix."_s,
                         u"Produce"_s);
        return Outcome::Failed;
    }

    const bool sourceMissing = !source->isReachable();
    if (settings.accFilePath.isEmpty() && sourceMissing) {
        m_context.prompter().message(
            u"There is no running instance of "_s + settings.accPackage +
                u" and your primary Account data file has not been specified!\r\n\r\n"_s +
                u"You can specify your primary Accounting file in the System Configuration."_s,
            u"Cannot Produce KPI's"_s, Prompter::Icon::Exclamation);
        return Outcome::NoSource;
    }
    if (!settings.accFilePath.isEmpty() && sourceMissing) {
        std::optional<DbError> error;
        {
            const BusyPointer busy(m_context.prompter());
            error = source->openDataFile();
        }
        if (error) {
            ErrorReporter(m_context.prompter())
                .reportError(error->number, error->description, u"Produce"_s);
            return Outcome::Failed;
        }
    }

    const QDate start = rangeStart(selection);
    const QDate end = rangeEnd(selection);
    PeriodDataSet &data = m_context.periodDataSet();
    data.setRange(0, {start, end});
    if (!start.isValid() || !end.isValid() || start > end) {
        m_context.prompter().message(u"The selected date range is invalid! Make sure the second "
                                     u"date is the same or later than the first."_s,
                                     u"Invalid Date Range"_s, Prompter::Icon::Exclamation);
        return Outcome::InvalidRange;
    }

    // Another copy may have changed the rates or the Fields since this one last read them.
    if (const auto error = m_context.mainDatabase().rereadForProduce()) {
        ErrorReporter(m_context.prompter())
            .reportError(error->number, error->description, u"Produce"_s);
        return Outcome::Failed;
    }
    data.setCurrentSlot(0);
    ContextWiring::rangeLoader(m_context).loadDateRange(start, end);

    if (remember == Remember::Nothing)
        return Outcome::Produced;
    SettingsStore &store = m_context.settingsStore();
    store.writeSetting(u"M1"_s, QString::number(selection.firstMonth - 1));
    store.writeSetting(u"M2"_s, QString::number(selection.lastMonth - 1));
    store.writeSetting(u"Y1"_s, QString::number(selection.firstYear));
    store.writeSetting(u"Y2"_s, QString::number(selection.lastYear));
    return Outcome::Produced;
}
