// Veltrix — KPI dashboard for small businesses.
#include "userpoll.h"

#include "database/configvalues.h"

using namespace Qt::StringLiterals;

UserPoll::Result UserPoll::tick(const ConfigValues &config)
{
    Result result;
    result.activeUsers = config.getConfigValue(ConfigValues::UserCount);
    const QString request = config.getConfigValue(ConfigValues::NetworkRequest);
    if (request.isEmpty())
        return result;
    if (request != m_lastRequest) {
        m_lastRequest = request;
        if (request == u"Logoff"_s)
            result.action = Action::Logoff;
        else if (request == u"Shutdown"_s)
            result.action = Action::Shutdown;
        else if (request == u"Disconnect"_s)
            result.action = Action::Disconnect;
        return result;
    }
    m_lastRequest.clear();
    config.setConfigValue(ConfigValues::NetworkRequest, QString());
    return result;
}
