// Veltrix — KPI dashboard for small businesses.
#include "demoverb.h"

#include "app/demoworkspace.h"
#include "common/applocations.h"
#include "common/settingsstore.h"

#include <QDir>
#include <QFileInfo>
#include <QTextStream>

using namespace Qt::StringLiterals;

namespace DemoVerb {

int makeDemo(const QStringList &arguments)
{
    QStringList rest = arguments;
    const bool use = rest.removeAll(u"--use"_s) > 0;
    if (rest.size() != 1) {
        QTextStream(stderr) << "usage: veltrix-cli make-demo DIR [--use]" << Qt::endl;
        return 2;
    }
    const QString folder = QDir(rest.first()).absolutePath();
    const QString templateFile = AppLocations::forThisMachine().newDatabaseFile();
    if (const auto problem = DemoWorkspace::create(folder, templateFile)) {
        QTextStream(stderr) << *problem << Qt::endl;
        return 1;
    }
    QTextStream out(stdout);
    out << "Demo workspace written to " << folder << '\n';
    if (use) {
        SettingsStore own;
        if (own.readSetting(u"AccPackage"_s).isEmpty()) {
            DemoWorkspace::configure(own, folder);
            out << "Your settings now point at it (" << own.fileName() << ").\n";
        } else {
            out << "Your settings already name an accounting package; they were left alone.\n";
        }
    }
    out << "Log in as:";
    for (const DemoWorkspace::DemoUser &user : DemoWorkspace::users())
        out << "  " << user.name << " / " << user.password;
    out << Qt::endl;
    return 0;
}

int useDemo(const QStringList &arguments)
{
    const QString package = arguments.value(1, u"myob"_s).toLower();
    if (arguments.isEmpty() || arguments.size() > 2 ||
        (package != u"myob"_s && package != u"moneyworks"_s)) {
        QTextStream(stderr) << "usage: veltrix-cli use-demo DIR [myob|moneyworks]" << Qt::endl;
        return 2;
    }
    const QString folder = QDir(arguments.first()).absolutePath();
    if (!QFileInfo::exists(QDir(folder).filePath(u"main.db"_s))) {
        QTextStream(stderr) << "No demo workspace in " << folder
                            << "; make one with veltrix-cli make-demo" << Qt::endl;
        return 1;
    }
    SettingsStore own;
    if (package == u"moneyworks"_s)
        DemoWorkspace::configureMoneyWorks(own, folder);
    else
        DemoWorkspace::configure(own, folder);
    QTextStream(stdout) << "Your settings (" << own.fileName() << ") now read the demo shop "
                        << (package == u"moneyworks"_s ? "through MoneyWorks" : "as MYOB") << "."
                        << Qt::endl;
    return 0;
}

} // namespace DemoVerb
