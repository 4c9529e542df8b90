// Veltrix — KPI dashboard for small businesses.
// veltrix-cli: the program's core without windows, for scripts, provisioning and tests.

#include "databaseverbs.h"
#include "demoverb.h"
#include "gifverb.h"
#include "passwordverbs.h"
#include "produceverb.h"
#include "reportverb.h"

#include <QApplication>
#include <QCoreApplication>
#include <QTextStream>

#include <functional>
#include <memory>

using namespace Qt::StringLiterals;

namespace {

struct Verb
{
    QString name;
    QString arguments;
    QString summary;
    std::function<int(const QStringList &)> run;
};

const QList<Verb> &verbs()
{
    static const QList<Verb> all = {
        {u"encrypt-password"_s, u"TEXT"_s, u"print the stored form of an accounting password"_s,
         PasswordVerbs::encryptPassword},
        {u"decrypt-password"_s, u"STORED"_s, u"print the password a stored value holds"_s,
         PasswordVerbs::decryptPassword},
        {u"make-demo"_s, u"DIR [--use]"_s,
         u"write a demo workspace (database, company file, settings)"_s, DemoVerb::makeDemo},
        {u"use-demo"_s, u"DIR [myob|moneyworks]"_s,
         u"point your own settings at a demo workspace"_s, DemoVerb::useDemo},
        {u"produce"_s,
         u"--from YYYY-MM --to YYYY-MM --user NAME --password PW [--settings FILE] "
         u"[--compare years|periods --count N] [--format csv|json]"_s,
         u"produce a range and print its figures"_s, ProduceVerb::produce},
        {u"report"_s,
         u"--from YYYY-MM --to YYYY-MM --user NAME --password PW [--settings FILE] [--tab N] "
         u"[--compare years|periods --count N] --out FILE.html|FILE.pdf"_s,
         u"write the printed report of a tab as HTML or PDF"_s, ReportVerb::report},
        {u"encode-gif"_s, u"IN OUT.gif [--transparent RRGGBB]"_s,
         u"write any picture as an 8-bit GIF with the fixed palette"_s, GifVerb::encodeGif},
        {u"create-database"_s, u"SCRIPT OUTPUT"_s, u"make a database file from a SQL script"_s,
         DatabaseVerbs::createDatabase},
    };
    return all;
}

int usage(QTextStream &out)
{
    out << "usage: veltrix-cli VERB [ARGUMENTS]\n\nverbs:\n";
    for (const Verb &verb : verbs())
        out << "  " << verb.name << ' ' << verb.arguments << "\n      " << verb.summary << '\n';
    out.flush();
    return 2;
}

// The off-screen platform remarks on every window it is asked to show; a scheduled report
// should print only what concerns its user.
void quietOffscreenRemarks(QtMsgType type, const QMessageLogContext &context, const QString &text)
{
    if (type == QtWarningMsg && (text.startsWith(u"This plugin does not support"_s) ||
                                 text.startsWith(u"QStandardPaths: XDG_RUNTIME_DIR not set"_s)))
        return;
    QTextStream(stderr) << qFormatLogMessage(type, context, text) << Qt::endl;
}

} // namespace

int main(int argc, char *argv[])
{
    // The report draws the program's own graph and grid off screen; it never needs a display,
    // so a scheduled job can run it.
    const bool drawsWidgets = argc > 1 && qstrcmp(argv[1], "report") == 0;
    std::unique_ptr<QCoreApplication> app;
    if (drawsWidgets) {
        qputenv("QT_QPA_PLATFORM", "offscreen");
        qInstallMessageHandler(quietOffscreenRemarks);
        app = std::make_unique<QApplication>(argc, argv);
    } else {
        app = std::make_unique<QCoreApplication>(argc, argv);
    }
    QCoreApplication::setOrganizationName(u"Veltrix"_s);
    QCoreApplication::setApplicationName(u"veltrix"_s);

    QStringList arguments = QCoreApplication::arguments().mid(1);
    if (arguments.isEmpty()) {
        QTextStream err(stderr);
        return usage(err);
    }
    const QString name = arguments.takeFirst();
    if (name == u"help"_s || name == u"--help"_s || name == u"-h"_s) {
        QTextStream out(stdout);
        usage(out);
        return 0;
    }
    for (const Verb &verb : verbs()) {
        if (verb.name == name)
            return verb.run(arguments);
    }
    QTextStream err(stderr);
    err << "veltrix-cli: unknown verb '" << name << "'\n\n";
    return usage(err);
}
