// Veltrix — KPI dashboard for small businesses.
#include "loginsession.h"

#include "loginservice.h"
#include "usercounter.h"

#include "app/appcontext.h"
#include "app/errorreporter.h"
#include "database/configvalues.h"

using namespace Qt::StringLiterals;

std::optional<QString> LoginSession::login(const QString &userName, const QString &password)
{
    MainDatabase &database = m_context.mainDatabase();
    const std::optional<LoginState> login =
        LoginService::checkCredentials(database, userName, password);
    if (!login) {
        m_context.loginState() = LoginState();
        return std::nullopt;
    }
    if (login->currentUser != LoginService::BuiltInUser)
        UserCounter(database).increment();
    m_context.loginState() = *login;
    return ConfigValues(database, m_context.prompter()).getConfigValue(ConfigValues::UserCount);
}

bool LoginSession::logoff(bool reset)
{
    // Every copy but the built-in account's takes one off, even one that was not logged in,
    // so that a "Logoff" request brings a count left too high back down.
    if (m_context.loginState().currentUser != LoginService::BuiltInUser) {
        if (const auto error = UserCounter(m_context.mainDatabase()).decrement()) {
            ErrorReporter(m_context.prompter())
                .reportError(error->number, error->description, u"Logoff"_s);
            return false;
        }
    }
    if (reset)
        m_context.loginState() = LoginState();
    return true;
}
