// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <optional>

class MainDatabase;
class Prompter;
struct LoginState;

// Logging in and off on this copy, with the shared count of logged-in users kept in step.
// The built-in account is never counted.
class LoginSession
{
public:
    LoginSession(MainDatabase &database, Prompter &prompter, LoginState &login)
        : m_database(database)
        , m_prompter(prompter)
        , m_login(login)
    {}

    // The users logged in afterwards, as the counter reads; nothing when the credentials do
    // not let anyone in (the login state is then cleared).
    std::optional<QString> login(const QString &userName, const QString &password);
    // Takes this copy's user off the count. With reset the login state is cleared as well.
    // False when the count could not be written (reported); the user is then still logged in.
    bool logoff(bool reset);

private:
    MainDatabase &m_database;
    Prompter &m_prompter;
    LoginState &m_login;
};
