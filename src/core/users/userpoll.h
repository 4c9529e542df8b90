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

    Result tick(const ConfigValues &config);
    QString lastRequest() const { return m_lastRequest; }

private:
    QString m_lastRequest;
};
