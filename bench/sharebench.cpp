// Veltrix — KPI dashboard for small businesses.
// Two processes on one main.db: a writer that saves new hourly rates and then a new account
// mapping through the setup code every few moments, and a producer that produces the demo
// year over and over. Each save carries a generation number (the rates are 100 + g and
// 200 + g; Field 13's codes end in a never-moved account "ZZ<g>"), so every produce can tell
// which state of the database it read. The rates are saved before the mapping, so a state
// the database was really in has a rate generation equal to the mapping's or one ahead;
// anything else is a mixed state.
//
//   sharebench [SECONDS] [WRITER_PAUSE_MS]      (default 180 and 2000)

#include "app/appcontext.h"
#include "app/contextwiring.h"
#include "app/demoworkspace.h"
#include "app/mainconnector.h"
#include "app/producecommand.h"
#include "app/settingsloader.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"
#include "engine/rangeloader.h"
#include "grid/gridoperations.h"
#include "setup/hourlyrates.h"
#include "setup/programsetup.h"

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QProcess>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QTextStream>
#include <QThread>

#include <memory>

using namespace Qt::StringLiterals;

namespace {

// One copy of the program over the demo's settings, with a program folder of its own.
std::unique_ptr<AppContext> startCopy(const QString &demo, const QString &appFolder,
                                      RecordingPrompter &prompter)
{
    auto context =
        std::make_unique<AppContext>(std::make_unique<SettingsStore>(demo + u"/settings.ini"_s),
                                     prompter, AppLocations::inFolder(appFolder));
    if (!loadSettings(*context).isEmpty() || !connectMainDatabase(*context).isEmpty())
        return nullptr;
    context->loginState() = LoginState{true, u"sysop"_s, 1, QString()};
    return context;
}

int writer(const QString &demo, const QString &appFolder, int seconds, int pauseMs)
{
    RecordingPrompter prompter;
    const auto context = startCopy(demo, appFolder, prompter);
    if (!context)
        return 1;
    int saves = 0;
    int failures = 0;
    const QDeadlineTimer deadline(seconds * 1000);
    for (int generation = 1; !deadline.hasExpired(); ++generation) {
        HourlyRates rates(context->mainDatabase(), context->prompter(), context->numberFormat());
        rates.load();
        rates.commitEdit(GridOperations::findGridRow(rates.grid(), 1, u"1"_s),
                         QString::number(100 + generation));
        rates.commitEdit(GridOperations::findGridRow(rates.grid(), 1, u"2"_s),
                         QString::number(200 + generation));
        failures += rates.save() ? 0 : 1;

        ProgramSetup setup(context->mainDatabase(), context->prompter());
        setup.load();
        GridModel &mapping = setup.grid(ProgramSetup::Mapping);
        const int row = GridOperations::findGridRow(mapping, 1, u"13"_s);
        QString codes = mapping.cellText(row, ProgramSetup::DataColumn);
        codes.remove(QRegularExpression(u"\\+ZZ\\d+$"_s));
        setup.commitEdit(ProgramSetup::Mapping, row,
                         codes + u"+ZZ"_s + QString::number(generation));
        failures += setup.save() ? 0 : 1;
        saves += 2;
        QThread::msleep(pauseMs);
    }
    QTextStream(stdout) << saves << ' ' << failures << Qt::endl;
    return 0;
}

} // namespace

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    const QStringList arguments = QCoreApplication::arguments();
    if (arguments.value(1) == u"writer"_s) {
        return writer(arguments.value(2), arguments.value(3), arguments.value(4).toInt(),
                      arguments.value(5).toInt());
    }
    const int seconds = arguments.size() > 1 ? arguments.at(1).toInt() : 180;
    const int pauseMs = arguments.size() > 2 ? arguments.at(2).toInt() : 2000;

    QTemporaryDir root;
    const QString demo = root.filePath(u"demo"_s);
    if (DemoWorkspace::create(demo, QStringLiteral(VELTRIX_NEW_DB))) {
        QTextStream(stderr) << "cannot write the demo workspace" << Qt::endl;
        return 1;
    }
    RecordingPrompter prompter;
    const auto context = startCopy(demo, root.filePath(u"producer"_s), prompter);
    if (!context) {
        QTextStream(stderr) << "start-up failed" << Qt::endl;
        return 1;
    }

    QProcess writerProcess;
    writerProcess.start(QCoreApplication::applicationFilePath(),
                        {u"writer"_s, demo, root.filePath(u"writer"_s), QString::number(seconds),
                         QString::number(pauseMs)});
    int produces = 0;
    int failed = 0;
    int mixed = 0;
    int lastMapping = 0;
    const QRegularExpression marker(u"\\+ZZ(\\d+)$"_s);
    const QDeadlineTimer deadline(seconds * 1000);
    while (!deadline.hasExpired()) {
        if (ProduceCommand(*context).produce({7, 2025, 6, 2026}) !=
            ProduceCommand::Outcome::Produced) {
            ++failed;
            continue;
        }
        ++produces;
        RangeLoader loader = ContextWiring::rangeLoader(*context);
        const int rate1 = int(loader.hourlyRate(1)) - 100;
        const int rate2 = int(loader.hourlyRate(2)) - 200;
        RecordSet &fields = context->mainDatabase().fieldsRecordset();
        fields.moveFirst();
        fields.findId(13);
        const QRegularExpressionMatch match = marker.match(fields.value(u"Data"_s).toString());
        const int mapping = match.hasMatch() ? match.captured(1).toInt() : 0;
        lastMapping = std::max(lastMapping, mapping);
        // Before the writer's first save the demo's own rates are in place.
        const bool original = rate1 < 0 && rate2 < 0 && mapping == 0;
        if (!original && (rate1 != rate2 || (rate1 != mapping && rate1 != mapping + 1)))
            ++mixed;
    }
    writerProcess.waitForFinished(60000);
    const QStringList written =
        QString::fromUtf8(writerProcess.readAllStandardOutput()).split(u' ');
    QTextStream(stdout) << "seconds " << seconds << ", writer pause " << pauseMs << " ms\n"
                        << "produces " << produces << ", failed " << failed << ", mixed states "
                        << mixed << ", last mapping generation seen " << lastMapping << '\n'
                        << "writer saves " << written.value(0).trimmed() << ", failed saves "
                        << written.value(1).trimmed() << ", messages to the producer "
                        << prompter.messages().size() << Qt::endl;
    return mixed == 0 ? 0 : 1;
}
