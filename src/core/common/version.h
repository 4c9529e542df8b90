// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

namespace AppInfo {

// The name message boxes carry when nothing more specific fits.
inline const QString Title = QStringLiteral("Veltrix");

// The program's version as one decimal number with two places: 1.5.5 is 1.55. The database
// and the update page compare versions in this form.
QString appVersion();
// The same from its parts; the minor version and the revision are written one after the other.
QString appVersionFrom(int major, int minor, int revision);

} // namespace AppInfo
