// Veltrix — KPI dashboard for small businesses.
#include "appcontext.h"

#include "settingsstore.h"

AppContext::AppContext(std::unique_ptr<SettingsStore> store, Prompter &prompter,
                       AppLocations locations, Clock clock)
    : m_store(std::move(store))
    , m_prompter(prompter)
    , m_locations(std::move(locations))
    , m_clock(std::move(clock))
{}

AppContext::~AppContext() = default;
