// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <optional>

class AppContext;

// Logging in and off on this copy, with the shared count of logged-in users kept in step.
// The built-in account is never counted.
class LoginSession
{
public:
    explicit LoginSession(AppContext &context)
        : m_context(context)
    {}

    // The users logged in afterwards, as the counter reads; nothing when the credentials do
    // not let anyone in (the login state is then cleared).
    std::optional<QString> login(const QString &userName, const QString &password);
    // Takes this copy's user off the count. With reset the login state is cleared as well.
    // False when the count could not be written (reported); the user is then still logged in.
    bool logoff(bool reset);

private:
    AppContext &m_context;
};
