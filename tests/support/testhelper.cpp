// Veltrix — KPI dashboard for small businesses.
// A second process for tests that need one: another copy of the program writing the shared
// database, or a writer that is killed in the middle of its work.

#include "common/recordingprompter.h"
#include "database/configvalues.h"
#include "database/maindatabase.h"
#include "engine/cachefile.h"
#include "users/usercounter.h"

#include <QCoreApplication>
#include <QTextStream>

using namespace Qt::StringLiterals;

namespace {

// write-config DATABASE ID COUNT: sets Config row ID COUNT times, as another copy would.
int writeConfig(const QStringList &arguments)
{
    MainDatabase database;
    if (const auto error = database.connection().open(arguments[0])) {
        QTextStream(stderr) << error->description << Qt::endl;
        return 1;
    }
    if (const auto error = database.openStandingRecordsets()) {
        QTextStream(stderr) << error->description << Qt::endl;
        return 1;
    }
    RecordingPrompter prompter;
    const ConfigValues config(database, prompter);
    const int id = arguments[1].toInt();
    const int count = arguments[2].toInt();
    int failures = 0;
    for (int i = 1; i <= count; ++i) {
        if (const auto error = config.setConfigValue(id, QString::number(i))) {
            QTextStream(stderr) << error->number << ' ' << error->description << Qt::endl;
            ++failures;
        }
    }
    for (const auto &message : prompter.messages())
        QTextStream(stderr) << message.title << ": " << message.text << Qt::endl;
    return failures + int(prompter.messages().size()) == 0 ? 0 : 1;
}

// count-users DATABASE up|down COUNT: logs in (up) or off (down) COUNT times, as copies do.
int countUsers(const QStringList &arguments)
{
    MainDatabase database;
    if (const auto error = database.connection().open(arguments[0])) {
        QTextStream(stderr) << error->description << Qt::endl;
        return 1;
    }
    UserCounter counter(database);
    const bool up = arguments[1] == u"up"_s;
    int failures = 0;
    for (int i = 0; i < arguments[2].toInt(); ++i) {
        if (const auto error = up ? counter.increment() : counter.decrement()) {
            QTextStream(stderr) << error->number << ' ' << error->description << Qt::endl;
            ++failures;
        }
    }
    return failures == 0 ? 0 : 1;
}

// write-cache FILE: writes two different caches in turn, for ever, until killed.
int writeCacheForever(const QStringList &arguments)
{
    PeriodDataSet::Slot first;
    PeriodDataSet::Slot second;
    for (int i = 0; i < 20000; ++i) {
        for (PeriodDataSet::Slot *slot : {&first, &second}) {
            slot->fieldIds << QString::number(i);
            slot->fieldTypes << u"0"_s;
        }
        first.fieldValues << u"111.11"_s;
        first.fieldAbs << u"111.11"_s;
        second.fieldValues << u"-2222.2"_s;
        second.fieldAbs << u"2222.2"_s;
    }
    // One whole cache is in place before the writer can be killed in the middle of the next.
    CacheFile::write(arguments[0], first);
    QTextStream(stdout) << "writing" << Qt::endl;
    for (;;) {
        CacheFile::write(arguments[0], first);
        CacheFile::write(arguments[0], second);
    }
}

} // namespace

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    const QStringList arguments = QCoreApplication::arguments().mid(1);
    if (arguments.value(0) == u"write-config"_s && arguments.size() == 4)
        return writeConfig(arguments.mid(1));
    if (arguments.value(0) == u"count-users"_s && arguments.size() == 4)
        return countUsers(arguments.mid(1));
    if (arguments.value(0) == u"write-cache"_s && arguments.size() == 2)
        return writeCacheForever(arguments.mid(1));
    QTextStream(stderr) << "usage: veltrix-testhelper write-config DATABASE ID COUNT | "
                           "write-cache FILE"
                        << Qt::endl;
    return 2;
}
