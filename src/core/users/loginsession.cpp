// Veltrix — KPI dashboard for small businesses.
#include "loginsession.h"

#include "loginservice.h"
#include "usercounter.h"

#include "loginstate.h"

#include "common/errorreporter.h"
#include "database/configvalues.h"

using namespace Qt::StringLiterals;

std::optional<QString> LoginSession::login(const QString &userName, const QString &password)
{
    MainDatabase &database = m_database;
    const std::optional<LoginState> login =
        LoginService::checkCredentials(database, userName, password);
    if (!login) {
        m_login = LoginState();
        return std::nullopt;
    }
    if (login->currentUser != LoginService::BuiltInUser)
        UserCounter(database).increment();
    m_login = *login;
    return ConfigValues(database, m_prompter).getConfigValue(ConfigValues::UserCount);
}

bool LoginSession::logoff(bool reset)
{
    // Every copy but the built-in account's takes one off, even one that was not logged in,
    // so that a "Logoff" request brings a count left too high back down.
    if (m_login.currentUser != LoginService::BuiltInUser) {
        if (const auto error = UserCounter(m_database).decrement()) {
            ErrorReporter(m_prompter).reportError(error->number, error->description, u"Logoff"_s);
            return false;
        }
    }
    if (reset)
        m_login = LoginState();
    return true;
}
