// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "applocations.h"
#include "clock.h"
#include "numberformat.h"
#include "settings.h"

#include <memory>

class Prompter;
class SettingsStore;

// The state of one run of the program, owned in one place and handed to whatever needs it.
// The program and each command-line verb make one; every test makes a fresh one.
class AppContext
{
public:
    AppContext(std::unique_ptr<SettingsStore> store, Prompter &prompter, AppLocations locations,
               Clock clock = {});
    ~AppContext();
    AppContext(const AppContext &) = delete;
    AppContext &operator=(const AppContext &) = delete;

    SettingsStore &settingsStore() { return *m_store; }
    Prompter &prompter() { return m_prompter; }
    const AppLocations &locations() const { return m_locations; }
    const Clock &clock() const { return m_clock; }
    const NumberFormat &numberFormat() const { return m_numberFormat; }
    void setNumberFormat(const NumberFormat &format) { m_numberFormat = format; }

    Settings &settings() { return m_settings; }
    const Settings &settings() const { return m_settings; }

    // The height of a horizontal scroll bar on this desktop; the windows set it, since only
    // they know the style in use.
    void setPlatformScrollBarHeight(int pixels) { m_platformScrollBarHeight = pixels; }
    int platformScrollBarHeight() const { return m_platformScrollBarHeight; }

private:
    std::unique_ptr<SettingsStore> m_store;
    Prompter &m_prompter;
    AppLocations m_locations;
    Clock m_clock;
    NumberFormat m_numberFormat;
    Settings m_settings;
    int m_platformScrollBarHeight = 16;
};
