// Veltrix — KPI dashboard for small businesses.
#include "systemconfiguration.h"

#include "common/fileoperations.h"
#include "common/prompter.h"
#include "common/settings.h"
#include "common/settingsstore.h"

#include "cipher/passwordcipher.h"
#include "cipher/windows1252.h"

using namespace Qt::StringLiterals;

bool SystemConfiguration::isServerAddress(const QString &path)
{
    return path.startsWith(u"http://"_s, Qt::CaseInsensitive) ||
           path.startsWith(u"https://"_s, Qt::CaseInsensitive);
}

SystemConfiguration::SystemConfiguration(SettingsStore &store, Prompter &prompter)
    : m_store(store)
    , m_prompter(prompter)
{}

SystemConfiguration::Values SystemConfiguration::load() const
{
    Values values;
    values.dbPath = m_store.readSetting(u"DBPath"_s);
    values.package = m_store.readSetting(u"AccPackage"_s);
    values.accFilePath = m_store.readSetting(u"AccFilePath"_s);
    values.driver = m_store.readSetting(u"AccFileDriver"_s);
    values.user = m_store.readSetting(u"AccFileUser"_s);
    const QString stored = m_store.readSetting(u"AccFilePass"_s);
    values.password =
        stored.isEmpty() ? QString() : PasswordCipher().decryptText(stored, Settings::PasswordKey);
    return values;
}

bool SystemConfiguration::save(Values &values) const
{
    values.dbPath = FileOperations::addTrailingSlash(values.dbPath);
    const bool myob = values.package == u"MYOB"_s;
    const std::optional<QString> unheld = Windows1252::firstUnheldCharacter(values.password);

    struct Check
    {
        bool failed;
        QString text;
        QString title;
    };
    const Check checks[] = {
        {!FileOperations::folderExists(values.dbPath),
         u"The remote path you specified does not exist or is inacessible!"_s,
         u"Invalid Folder Path"_s},
        {myob && values.accFilePath.isEmpty(),
         u"You must specify the path to the MYOB data file!"_s,
         u"MYOB Data File Path Not Specified"_s},
        {myob && values.driver.isEmpty(), u"You must specify the MYOB database driver!"_s,
         u"MYOB ODBC Driver Not Specified"_s},
        {!values.accFilePath.isEmpty() && !isServerAddress(values.accFilePath) &&
             !FileOperations::fileExists(values.accFilePath),
         u"The account data file path you specified does not exist or is inacessible!"_s,
         u"Invalid File Path"_s},
        // The password is stored in the Western European code page; anything else would be
        // stored as "?" and the accounting login would later fail without a hint.
        {unheld.has_value(),
         u"The password cannot contain the character \"%1\". Passwords may use letters, digits "
         u"and the symbols of Western European keyboards."_s.arg(unheld.value_or(QString())),
         u"Invalid Password"_s},
    };
    for (const Check &check : checks) {
        if (check.failed) {
            m_prompter.message(check.text, check.title, Prompter::Icon::Exclamation);
            return false;
        }
    }

    m_store.writeSetting(u"DBPath"_s, values.dbPath);
    m_store.writeSetting(u"AccPackage"_s, values.package);
    m_store.writeSetting(u"AccFilePath"_s, values.accFilePath);
    m_store.writeSetting(u"AccFileDriver"_s, values.driver);
    m_store.writeSetting(u"AccFileUser"_s, values.user);
    m_store.writeSetting(u"AccFilePass"_s,
                         PasswordCipher().encryptText(values.password, Settings::PasswordKey));
    return true;
}

QStringList SystemConfiguration::driverNames()
{
    return {u"MYOAU0901"_s, u"MYOAU0801"_s, u"MYONZ0901"_s, u"MYONZ0801"_s, u"SQLite"_s};
}

QString SystemConfiguration::fileFilter(const QString &package)
{
    if (package == u"MoneyWorks"_s)
        return u"MoneyWorks Files (*.mwd3 *.mwd4 *.mwd5);;All Files (*)"_s;
    if (package == u"MYOB"_s)
        return u"MYOB Files (*.myo *.myb *.dat *.pls *.prm);;All Files (*)"_s;
    return {};
}
