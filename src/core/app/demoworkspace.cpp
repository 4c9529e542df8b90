// Veltrix — KPI dashboard for small businesses.
#include "demoworkspace.h"

#include "common/fileoperations.h"
#include "common/settingsstore.h"

#include "common/settings.h"

#include "cipher/passwordcipher.h"
#include "database/sqliteconnection.h"
#include "sources/democompany.h"

#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QSqlError>
#include <QSqlQuery>
#include <QUrl>

using namespace Qt::StringLiterals;

namespace DemoWorkspace {

namespace {

// The lines of the given tabs, grouped by tab the way the users dialog writes them.
QString fieldsOfTabs(const QSqlDatabase &database, const QList<int> &tabs)
{
    QStringList groups;
    for (const int tab : tabs) {
        QSqlQuery query(database);
        query.prepare(u"SELECT ID FROM Fields WHERE Tab = ? AND Type <> 1 ORDER BY `Order`"_s);
        query.addBindValue(tab);
        QStringList ids;
        if (query.exec()) {
            while (query.next())
                ids << query.value(0).toString();
        }
        groups << ids.join(u',');
    }
    return groups.isEmpty() ? u"#"_s : groups.join(u'#');
}

std::optional<QString> fillMainDatabase(const QString &file)
{
    SqliteConnection connection;
    if (const auto error = connection.open(file))
        return error->description;
    const QSqlDatabase database = connection.database();
    QSqlQuery query(database);

    query.prepare(u"UPDATE Hours SET Value = ? WHERE ID = ?"_s);
    for (const auto &[id, rate] :
         {std::pair{1, DemoCompany::PanelRate}, std::pair{2, DemoCompany::PaintRate}}) {
        query.addBindValue(rate);
        query.addBindValue(id);
        if (!query.exec())
            return query.lastError().text();
    }

    const QString created = u"1 Dec 2026 9:00 AM"_s;
    for (const DemoUser &user : users()) {
        QSqlQuery insert(database);
        insert.prepare(u"INSERT INTO Users (UserName, Password, Type, DateCreated, Fields) "
                       u"VALUES (?, ?, ?, ?, ?)"_s);
        insert.addBindValue(user.name);
        insert.addBindValue(user.password);
        insert.addBindValue(user.type);
        insert.addBindValue(created);
        insert.addBindValue(fieldsOfTabs(database, user.tabs));
        if (!insert.exec())
            return insert.lastError().text();
    }
    return std::nullopt;
}

} // namespace

QList<DemoUser> users()
{
    return {
        {u"manager"_s, u"manager1"_s, 1, {1, 2, 3, 4, 5, 6}},
        {u"workshop"_s, u"panel1"_s, 0, {1, 2, 5}},
        {u"office"_s, u"ledger1"_s, 0, {3, 4, 6}},
    };
}

std::optional<QString> create(const QString &folder, const QString &templateFile)
{
    if (!QDir().mkpath(folder))
        return u"Cannot make the folder %1"_s.arg(folder);
    const QDir dir(folder);
    const QString mainDatabase = dir.filePath(u"main.db"_s);
    QFile::remove(mainDatabase);
    if (!FileOperations::copyFile(templateFile, mainDatabase, true))
        return u"Cannot copy the database template %1"_s.arg(templateFile);
    QFile::setPermissions(mainDatabase, QFile::permissions(mainDatabase) | QFileDevice::WriteOwner);
    if (auto problem = fillMainDatabase(mainDatabase))
        return problem;
    if (auto problem = DemoCompany::write(dir.filePath(CompanyFileName)))
        return problem;
    QFile::remove(dir.filePath(LedgerFileName));
    if (!QFile::copy(dir.filePath(CompanyFileName), dir.filePath(LedgerFileName)))
        return u"Cannot write %1"_s.arg(dir.filePath(LedgerFileName));

    SettingsStore settings(dir.filePath(SettingsFileName));
    configure(settings, folder);
    SettingsStore moneyWorks(dir.filePath(MoneyWorksSettingsFileName));
    configureMoneyWorks(moneyWorks, folder);
    return std::nullopt;
}

void configure(SettingsStore &store, const QString &folder)
{
    const QDir dir(folder);
    store.writeSetting(u"DBPath"_s, FileOperations::addTrailingSlash(dir.absolutePath()));
    store.writeSetting(u"AccPackage"_s, u"MYOB"_s);
    store.writeSetting(u"AccFilePath"_s, dir.absoluteFilePath(CompanyFileName));
    store.writeSetting(u"AccFileDriver"_s, u"SQLite"_s);
    store.writeSetting(u"AccFileUser"_s, u"Administrator"_s);
    store.writeSetting(u"AccFilePass"_s, QString());
    store.writeSetting(u"LastUser"_s, u"manager"_s);
    // The last whole financial year of the demo: July 2025 to June 2026.
    store.writeSetting(u"M1"_s, u"6"_s);
    store.writeSetting(u"Y1"_s, u"2025"_s);
    store.writeSetting(u"M2"_s, u"5"_s);
    store.writeSetting(u"Y2"_s, u"2026"_s);
}

void configureMoneyWorks(SettingsStore &store, const QString &folder)
{
    configure(store, folder);
    store.writeSetting(u"AccPackage"_s, u"MoneyWorks"_s);
    store.writeSetting(u"AccFilePath"_s,
                       u"http://127.0.0.1:%1/"_s.arg(MoneyWorksPort) +
                           QString::fromLatin1(QUrl::toPercentEncoding(LedgerFileName)));
    store.writeSetting(u"AccFileDriver"_s, QString());
    store.writeSetting(u"AccFileUser"_s, MoneyWorksUser);
    store.writeSetting(u"AccFilePass"_s,
                       PasswordCipher().encryptText(MoneyWorksPassword, Settings::PasswordKey));
}

} // namespace DemoWorkspace
