// Veltrix — KPI dashboard for small businesses.
#include "appcontext.h"

#include "common/settingsstore.h"

#include "sources/accountingsource.h"

AppContext::AppContext(std::unique_ptr<SettingsStore> store, Prompter &prompter,
                       AppLocations locations, Clock clock)
    : m_store(std::move(store))
    , m_prompter(prompter)
    , m_locations(std::move(locations))
    , m_clock(std::move(clock))
    , m_webPageOpener(m_locations.appFolder + QStringLiteral("browser"))
{}

AppContext::~AppContext() = default;

void AppContext::setAccountingSource(std::unique_ptr<AccountingSource> source)
{
    m_accountingSource = std::move(source);
}
