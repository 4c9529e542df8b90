// Veltrix — KPI dashboard for small businesses.
#include "version.h"

#include <QLocale>

using namespace Qt::StringLiterals;

namespace AppInfo {

QString appVersion()
{
    return appVersionFrom(VELTRIX_VERSION_MAJOR, VELTRIX_VERSION_MINOR, VELTRIX_VERSION_PATCH);
}

QString appVersionFrom(int major, int minor, int revision)
{
    const QString digits = QString::number(minor) + QString::number(revision);
    const double number = (QString::number(major) + u'.' + digits).toDouble();
    return QLocale::c().toString(number, 'f', 2);
}

} // namespace AppInfo
