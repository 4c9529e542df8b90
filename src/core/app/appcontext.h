// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/applocations.h"
#include "common/busystate.h"
#include "common/clock.h"
#include "common/numberformat.h"
#include "common/settings.h"
#include "common/workingfolder.h"

#include "database/maindatabase.h"
#include "engine/perioddataset.h"
#include "users/loginstate.h"
#include "web/webpageopener.h"

#include <memory>

class AccountingSource;
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
    WorkingFolder &workingFolder() { return m_workingFolder; }
    const Clock &clock() const { return m_clock; }
    const NumberFormat &numberFormat() const { return m_numberFormat; }
    void setNumberFormat(const NumberFormat &format) { m_numberFormat = format; }

    Settings &settings() { return m_settings; }
    const Settings &settings() const { return m_settings; }

    MainDatabase &mainDatabase() { return m_mainDatabase; }
    PeriodDataSet &periodDataSet() { return m_periodDataSet; }
    const PeriodDataSet &periodDataSet() const { return m_periodDataSet; }
    LoginState &loginState() { return m_loginState; }
    WebPageOpener &webPageOpener() { return m_webPageOpener; }

    // The accounting package in use, once one has been reached; may be null.
    AccountingSource *accountingSource() const { return m_accountingSource.get(); }
    void setAccountingSource(std::unique_ptr<AccountingSource> source);

    // Whether a produce or a load is under way: requests from other copies wait for its end.
    BusyState &busyState() { return m_busy; }
    bool isBusy() const { return m_busy.isBusy(); }

    // The height of a horizontal scroll bar on this desktop; the windows set it, since only
    // they know the style in use.
    void setPlatformScrollBarHeight(int pixels) { m_platformScrollBarHeight = pixels; }
    int platformScrollBarHeight() const { return m_platformScrollBarHeight; }

private:
    std::unique_ptr<SettingsStore> m_store;
    Prompter &m_prompter;
    AppLocations m_locations;
    WorkingFolder m_workingFolder{m_locations.privateWorkingFiles ? WorkingFolder::Kind::Private
                                                                  : WorkingFolder::Kind::Shared};
    Clock m_clock;
    NumberFormat m_numberFormat;
    Settings m_settings;
    MainDatabase m_mainDatabase;
    PeriodDataSet m_periodDataSet{m_numberFormat};
    LoginState m_loginState;
    WebPageOpener m_webPageOpener;
    std::unique_ptr<AccountingSource> m_accountingSource;
    int m_platformScrollBarHeight = 16;
    BusyState m_busy;
};
