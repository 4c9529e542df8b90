// Veltrix — KPI dashboard for small businesses.
#include "applocations.h"

#include "fileoperations.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

using namespace Qt::StringLiterals;

namespace {
const auto TemplateName = u"new.db"_s;
}

AppLocations AppLocations::forThisMachine()
{
    const QString programFolder = QCoreApplication::applicationDirPath();
#ifdef Q_OS_WIN
    return inFolder(programFolder);
#else
    AppLocations locations;
    QString dataFolder = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation);
    if (dataFolder.isEmpty())
        dataFolder = QDir::homePath() + u"/.local/share"_s;
    locations.appFolder = FileOperations::addTrailingSlash(dataFolder + u"/veltrix"_s);
    locations.newDatabaseCandidates
        << FileOperations::addTrailingSlash(programFolder) + TemplateName
        << FileOperations::addTrailingSlash(QStringLiteral(VELTRIX_INSTALL_DATADIR)) + TemplateName;
    return locations;
#endif
}

AppLocations AppLocations::inFolder(const QString &folder)
{
    AppLocations locations;
    locations.appFolder = FileOperations::addTrailingSlash(folder);
    locations.newDatabaseCandidates << locations.appFolder + TemplateName;
    return locations;
}

QString AppLocations::newDatabaseFile() const
{
    for (const QString &candidate : newDatabaseCandidates) {
        if (QFileInfo(candidate).isFile())
            return candidate;
    }
    return newDatabaseCandidates.value(0);
}
