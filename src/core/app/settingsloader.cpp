// Veltrix — KPI dashboard for small businesses.
#include "settingsloader.h"

#include "appcontext.h"
#include "cipher/passwordcipher.h"
#include "common/fileoperations.h"
#include "common/prompter.h"
#include "common/settingsstore.h"

#include <QDir>
#include <QFile>

using namespace Qt::StringLiterals;

namespace {

void deriveProgramPaths(Settings &settings, const AppLocations &locations)
{
    settings.appFolder = FileOperations::addTrailingSlash(locations.appFolder);
    settings.newDatabaseFile = locations.newDatabaseFile();
    settings.cacheFile = settings.appFolder + u"data.db"_s;
}

// The files only this run may touch, in the folder the working folder gives it.
void deriveWorkingPaths(Settings &settings, const QString &workingFolder)
{
    settings.jobsFile = workingFolder + u"jobs.inf"_s;
    settings.tempFolder = workingFolder + u"temp"_s + QDir::separator();
    settings.tempHtmlFile = settings.tempFolder + u"tmp.html"_s;
    settings.tempGifFile = settings.tempFolder + u"tmp.gif"_s;
    settings.tempBmpFile = settings.tempFolder + u"tmp.bmp"_s;
}

QString checkSettings(const QString &dbPath, const Settings &settings)
{
    if (!FileOperations::folderExists(dbPath))
        return u"The database path must be configured!"_s;
    if (settings.accPackage != u"MYOB"_s && settings.accPackage != u"MoneyWorks"_s)
        return u"Your accounting package must be specified!"_s;
    if (settings.accPackage == u"MYOB"_s && settings.accFileDriver.isEmpty())
        return u"The MYOB database driver must be specified!"_s;
    return {};
}

} // namespace

QString loadSettings(AppContext &context)
{
    Settings &settings = context.settings();
    SettingsStore &store = context.settingsStore();

    deriveProgramPaths(settings, context.locations());
    // The per-user folder stands in for the program folder and may not exist on first start.
    QDir().mkpath(settings.appFolder);
    const QString workingFolder = context.workingFolder().folderFor(settings.appFolder);
    if (workingFolder.isEmpty())
        return NoWorkingFolder;
    deriveWorkingPaths(settings, workingFolder);
    FileOperations::folderExists(settings.tempFolder, true);

    // A location the settings cannot hold must not quietly become the program folder, where
    // a new empty database would be made and used instead of the shop's.
    if (store.isTooLong(u"DBPath"_s))
        return DatabasePathTooLong;
    const QString dbPath = store.readSetting(u"DBPath"_s, {}, settings.appFolder);
    settings.accPackage = store.readSetting(u"AccPackage"_s);
    settings.accFilePath = store.readSetting(u"AccFilePath"_s);
    settings.accFileDriver = store.readSetting(u"AccFileDriver"_s);
    settings.accFileUser = store.readSetting(u"AccFileUser"_s);
    const int timeout = store.readSetting(u"MWTimeout"_s).toInt();
    settings.moneyWorksTimeoutSeconds = timeout > 0 ? timeout : 15;
    const QString storedPassword = store.readSetting(u"AccFilePass"_s);
    settings.accFilePass =
        storedPassword.isEmpty()
            ? QString()
            : PasswordCipher().decryptText(storedPassword, Settings::PasswordKey);

    if (const QString problem = checkSettings(dbPath, settings); !problem.isEmpty())
        return problem;

    settings.mainDatabaseFile = FileOperations::addTrailingSlash(dbPath) + u"main.db"_s;
    if (!FileOperations::fileExists(settings.mainDatabaseFile) &&
        FileOperations::fileExists(settings.newDatabaseFile) &&
        FileOperations::copyFile(settings.newDatabaseFile, settings.mainDatabaseFile, false)) {
        context.prompter().message(u"A new database file has been created!"_s, u"New Database"_s,
                                   Prompter::Icon::Information);
    }

    if (!FileOperations::fileExists(settings.mainDatabaseFile))
        return u"The main database file is missing or inaccessible!"_s;
    settings.scrollBarHeight = static_cast<qint16>(context.platformScrollBarHeight());
    settings.currentYear = context.clock().today().year();
    return {};
}
