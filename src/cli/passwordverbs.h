// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

// Lets administrators provision the stored accounting password by script.
namespace PasswordVerbs {

// encrypt-password TEXT: prints the value to store.
int encryptPassword(const QStringList &arguments);
// decrypt-password STORED: prints the password, or the reason it cannot be read (exit 1).
int decryptPassword(const QStringList &arguments);

} // namespace PasswordVerbs
