// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QList>
#include <QString>

#include <optional>

class SettingsStore;

// A complete workspace to try Veltrix with: a main database with demo users and hourly rates,
// the company file of a demo panel-and-paint shop, and a settings file pointing at both.
namespace DemoWorkspace {

struct DemoUser
{
    QString name;
    QString password;
    int type;        // 1 administrator, 0 standard user
    QList<int> tabs; // the tabs whose lines the user may see
};

QList<DemoUser> users();

inline const QString CompanyFileName = QStringLiteral("Harbour Panel & Paint.myo");
inline const QString SettingsFileName = QStringLiteral("settings.ini");
// The same shop as a MoneyWorks document for veltrix-mw-sim, and settings that reach it.
inline const QString LedgerFileName = QStringLiteral("Harbour Panel & Paint.moneyworks");
inline const QString MoneyWorksSettingsFileName = QStringLiteral("settings-moneyworks.ini");
inline const QString MoneyWorksUser = QStringLiteral("Admin");
inline const QString MoneyWorksPassword = QStringLiteral("demo");
inline constexpr int MoneyWorksPort = 6710;

// Writes the workspace into the folder (made when missing), from the database template.
std::optional<QString> create(const QString &folder, const QString &templateFile);

// Points a settings store at the workspace, as the configuration dialog would.
void configure(SettingsStore &store, const QString &folder);
// The same, reading the shop through MoneyWorks (veltrix-mw-sim on the demo port).
void configureMoneyWorks(SettingsStore &store, const QString &folder);

} // namespace DemoWorkspace
