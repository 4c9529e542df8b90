// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class ConfigValues;

// The regular look at the shared Config rows: how many users are logged in, and whether a
// network request asks every copy to log off, shut down or disconnect. A copy acts on a
// request once; the first copy that sees the same request on two ticks in a row withdraws it.
class UserPoll
{
public:
    enum class Action { None, Logoff, Shutdown, Disconnect };

    struct Result
    {
        QString activeUsers;
        Action action = Action::None;
    };

    static constexpr int IntervalMs = 3000;

    // While the copy is busy (a load waits for its source) the request is still taken in and
    // withdrawn on time, but its action is held back and given by the first tick after.
    Result tick(const ConfigValues &config, bool busy = false);
    QString lastRequest() const { return m_lastRequest; }

private:
    QString m_lastRequest;
    Action m_pending = Action::None;
};
