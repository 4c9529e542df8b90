// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

// Who is logged in on this copy of the program.
struct LoginState
{
    bool loggedIn = false;
    QString currentUser;
    int currentUserType = 0;   // 0 standard user, 1 administrator
    QString currentUserFields; // the Field IDs the user may see
};
