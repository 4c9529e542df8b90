// Veltrix — KPI dashboard for small businesses.
#include "userpoll.h"

#include "database/configvalues.h"

using namespace Qt::StringLiterals;

UserPoll::Result UserPoll::tick(const ConfigValues &config, bool busy)
{
    Result result;
    result.activeUsers = config.getConfigValue(ConfigValues::UserCount);
    const QString request = config.getConfigValue(ConfigValues::NetworkRequest);
    if (!request.isEmpty() && request != m_lastRequest) {
        m_lastRequest = request;
        Action action = Action::None;
        if (request == u"Logoff"_s)
            action = Action::Logoff;
        else if (request == u"Shutdown"_s)
            action = Action::Shutdown;
        else if (request == u"Disconnect"_s)
            action = Action::Disconnect;
        // A shutdown held back for a load outranks whatever request follows it.
        if (action != Action::None && m_pending != Action::Shutdown)
            m_pending = action;
    } else if (!request.isEmpty()) {
        m_lastRequest.clear();
        config.setConfigValue(ConfigValues::NetworkRequest, QString());
    }
    if (!busy) {
        result.action = m_pending;
        m_pending = Action::None;
    }
    return result;
}
