// Veltrix — KPI dashboard for small businesses.
#include "loginservice.h"

#include "database/maindatabase.h"
#include "database/recordoperations.h"

using namespace Qt::StringLiterals;

namespace LoginService {

std::optional<LoginState> checkCredentials(MainDatabase &database, const QString &userName,
                                           const QString &password)
{
    if (userName == BuiltInUser && password == BuiltInUser)
        return LoginState{true, BuiltInUser, 1, QString()};

    // The name is matched without regard to case but literally: "manag%" is nobody's name.
    RecordSet users(database.database(),
                    u"SELECT * FROM Users WHERE `Username`"_s +
                        RecordOperations::likeLiteralClause(),
                    RecordSet::Access::ReadOnly, {RecordOperations::likeLiteral(userName)});
    if (users.open() || users.recordCount() != 1)
        return std::nullopt;
    if (users.value(u"Password"_s).toString() != password)
        return std::nullopt;
    return LoginState{true, users.value(u"UserName"_s).toString(), users.value(u"Type"_s).toInt(),
                      users.value(u"Fields"_s).toString()};
}

bool maySee(const LoginState &login, qint64 fieldId, int fieldType)
{
    if (fieldType == 1 || login.currentUser.toLower() == BuiltInUser)
        return true;
    const QString id = QString::number(fieldId);
    const QStringList groups = login.currentUserFields.split(u'#');
    for (const QString &group : groups) {
        const QStringList ids = group.split(u',');
        for (const QString &allowed : ids) {
            if (allowed.trimmed().compare(id, Qt::CaseInsensitive) == 0)
                return true;
        }
    }
    return false;
}

} // namespace LoginService
