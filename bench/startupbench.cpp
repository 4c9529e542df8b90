// Veltrix — KPI dashboard for small businesses.
// Start-up to the end of the database connection: settings read and checked, main.db opened,
// standing record sets filled and the figures cache read. Prints the first run (which loads
// the SQL driver) and the spread of the warm runs after it. Target: under 150 ms warm.

#include "app/appcontext.h"
#include "app/mainconnector.h"
#include "app/settingsloader.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"
#include "engine/cachefile.h"

#include <QCoreApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QTemporaryDir>
#include <QTextStream>

#include <algorithm>

using namespace Qt::StringLiterals;

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    const int runs = argc > 1 ? QString::fromLocal8Bit(argv[1]).toInt() : 50;

    QTemporaryDir root;
    const QString appFolder = root.filePath(u"app/"_s);
    QDir().mkpath(appFolder);
    QFile::copy(QStringLiteral(VELTRIX_NEW_DB), appFolder + u"new.db"_s);
    {
        SettingsStore store(root.filePath(u"settings.ini"_s));
        store.writeSetting(u"AccPackage"_s, u"MYOB"_s);
        store.writeSetting(u"AccFileDriver"_s, u"SQLite"_s);
    }
    // A full cache, as after a produce: every Field of the catalogue once.
    PeriodDataSet::Slot cached;
    for (int id = 1; id <= 130; ++id) {
        cached.fieldIds << QString::number(id);
        cached.fieldValues << u"-12345.67"_s;
        cached.fieldAbs << u"12345.67"_s;
        cached.fieldTypes << u"2"_s;
    }
    CacheFile::write(appFolder + u"data.db"_s, cached);

    QList<double> timings;
    for (int run = 0; run <= runs; ++run) {
        RecordingPrompter prompter;
        AppContext context(std::make_unique<SettingsStore>(root.filePath(u"settings.ini"_s)),
                           prompter, AppLocations::inFolder(appFolder));
        QElapsedTimer timer;
        timer.start();
        QString problem = loadSettings(context);
        if (problem.isEmpty())
            problem = connectMainDatabase(context);
        const double ms = double(timer.nsecsElapsed()) / 1e6;
        if (!problem.isEmpty()) {
            QTextStream(stderr) << "start-up failed: " << problem << Qt::endl;
            return 1;
        }
        timings << ms;
    }

    QTextStream out(stdout);
    out << "startup to connected database\n";
    out << "  first run (driver load): " << QString::number(timings.first(), 'f', 2) << " ms\n";
    QList<double> warm = timings.mid(1);
    std::sort(warm.begin(), warm.end());
    out << "  warm runs: " << warm.size() << "\n";
    out << "  min    " << QString::number(warm.first(), 'f', 2) << " ms\n";
    out << "  median " << QString::number(warm.at(warm.size() / 2), 'f', 2) << " ms\n";
    out << "  p95    " << QString::number(warm.at(warm.size() * 95 / 100), 'f', 2) << " ms\n";
    out << "  max    " << QString::number(warm.last(), 'f', 2) << " ms\n";
    out << "  target 150 ms: " << (warm.at(warm.size() / 2) < 150.0 ? "met" : "MISSED") << '\n';
    return 0;
}
