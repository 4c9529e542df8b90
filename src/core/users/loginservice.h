// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "loginstate.h"

#include <optional>

class MainDatabase;

// Who may log in, and which KPI lines they may see.
namespace LoginService {

// The built-in account; it needs no Users row and sees every line.
inline const QString BuiltInUser = QStringLiteral("sysop");

// The login state for these credentials, or nothing when they do not let anyone in: the name
// must match exactly one user (letters in any case) and the password exactly.
std::optional<LoginState> checkCredentials(MainDatabase &database, const QString &userName,
                                           const QString &password);

// Whether the user may see the Field's line. Headings are always shown.
bool maySee(const LoginState &login, qint64 fieldId, int fieldType);

inline const QString LoginFailedMessage =
    QStringLiteral("Login failed! Ensure your username and password are correct!");

} // namespace LoginService
