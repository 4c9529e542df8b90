// Veltrix — KPI dashboard for small businesses.
#include "headlesssession.h"

#include "app/appcontext.h"
#include "app/contextwiring.h"
#include "app/mainconnector.h"
#include "app/producecommand.h"
#include "app/startupsequence.h"
#include "common/consoleprompter.h"
#include "common/settingsstore.h"
#include "engine/rangeloader.h"
#include "users/loginservice.h"

#include <QCommandLineParser>
#include <QFile>
#include <QFileInfo>
#include <QRegularExpression>
#include <QTextStream>

#ifdef Q_OS_UNIX
#include <termios.h>
#include <unistd.h>
#endif

using namespace Qt::StringLiterals;

namespace HeadlessSession {

namespace {

constexpr int FirstYear = 1950; // the window's year boxes take nothing earlier

std::optional<QDate> month(const QString &text)
{
    static const QRegularExpression written(u"^([0-9]{4})-([0-9]{2})$"_s);
    const QRegularExpressionMatch match = written.match(text);
    if (!match.hasMatch())
        return std::nullopt;
    const QDate date(match.captured(1).toInt(), match.captured(2).toInt(), 1);
    if (!date.isValid() || date.year() < FirstYear || date.year() > QDate::currentDate().year())
        return std::nullopt;
    return date;
}

// A line typed at the terminal without showing it.
QString promptHidden(const QString &prompt)
{
    QTextStream err(stderr);
    err << prompt << Qt::flush;
#ifdef Q_OS_UNIX
    termios saved{};
    const bool terminal = ::isatty(STDIN_FILENO) && ::tcgetattr(STDIN_FILENO, &saved) == 0;
    if (terminal) {
        termios hidden = saved;
        hidden.c_lflag &= ~tcflag_t(ECHO);
        ::tcsetattr(STDIN_FILENO, TCSAFLUSH, &hidden);
    }
    const QString line = QTextStream(stdin).readLine();
    if (terminal) {
        ::tcsetattr(STDIN_FILENO, TCSAFLUSH, &saved);
        err << Qt::endl;
    }
    return line;
#else
    return QTextStream(stdin).readLine();
#endif
}

bool stdinIsTerminal()
{
#ifdef Q_OS_UNIX
    return ::isatty(STDIN_FILENO);
#else
    return false;
#endif
}

// The login password, from the first place that has one: --password (seen by anyone who lists
// the processes), --password-file, the environment, or a prompt at the terminal. A file that
// cannot be read leaves a problem.
QString readPassword(const QCommandLineParser &parser, const QString &user, QString &problem)
{
    if (parser.isSet(u"password"_s))
        return parser.value(u"password"_s);
    if (parser.isSet(u"password-file"_s)) {
        QFile file(parser.value(u"password-file"_s));
        if (!file.open(QIODevice::ReadOnly)) {
            problem =
                u"cannot read the password file %1: %2"_s.arg(file.fileName(), file.errorString());
            return {};
        }
        QString line = QString::fromUtf8(file.readLine());
        while (line.endsWith(u'\n') || line.endsWith(u'\r'))
            line.chop(1);
        return line;
    }
    if (const QByteArray fromEnvironment = qgetenv(PasswordVariable); !fromEnvironment.isNull())
        return QString::fromUtf8(fromEnvironment);
    if (stdinIsTerminal())
        return promptHidden(u"Password for %1: "_s.arg(user));
    return {};
}

} // namespace

void addOptions(QCommandLineParser &parser)
{
    parser.addOptions(
        {{u"from"_s, u"first month"_s, u"YYYY-MM"_s},
         {u"to"_s, u"last month"_s, u"YYYY-MM"_s},
         {u"user"_s, u"user name"_s, u"NAME"_s},
         {u"password"_s, u"password (visible to other users; prefer the others)"_s, u"PW"_s},
         {u"password-file"_s, u"file whose first line is the password"_s, u"FILE"_s},
         {u"remember"_s, u"remember the range in the settings, as the window does"_s},
         {u"settings"_s, u"settings file"_s, u"FILE"_s},
         {u"compare"_s, u"years or periods"_s, u"KIND"_s},
         {u"count"_s, u"earlier periods, 1 to 4"_s, u"N"_s}});
}

std::variant<Options, QString> readOptions(const QCommandLineParser &parser)
{
    Options options;
    const auto from = month(parser.value(u"from"_s));
    const auto to = month(parser.value(u"to"_s));
    if (!from || !to)
        return u"--from and --to need a month written YYYY-MM, in a year from %1 to %2"_s.arg(
            QString::number(FirstYear), QString::number(QDate::currentDate().year()));
    if (!parser.isSet(u"user"_s))
        return u"--user is needed"_s;
    options.from = *from;
    options.to = *to;
    options.user = parser.value(u"user"_s);
    QString problem;
    options.password = readPassword(parser, options.user, problem);
    if (!problem.isEmpty())
        return problem;
    options.rememberRange = parser.isSet(u"remember"_s);
    options.settingsFile = parser.value(u"settings"_s);
    // A mistyped path would otherwise read as settings that name nothing at all.
    if (parser.isSet(u"settings"_s) && !QFileInfo(options.settingsFile).isFile())
        return u"there is no settings file at %1"_s.arg(options.settingsFile);
    if (parser.isSet(u"compare"_s)) {
        options.compareKind = ComparisonRanges::kindFromText(parser.value(u"compare"_s));
        bool ok = false;
        options.compareCount = parser.value(u"count"_s).toInt(&ok);
        if (!options.compareKind || !ok || options.compareCount < 1 || options.compareCount > 4)
            return u"--compare is years or periods, with --count 1 to 4"_s;
    }
    return options;
}

Session::Session()
    : m_prompter(std::make_unique<ConsolePrompter>())
{}

Session::~Session()
{
    if (m_connected)
        disconnectMainDatabase(*m_context);
}

int Session::open(const Options &options)
{
    auto store = options.settingsFile.isEmpty()
                     ? std::make_unique<SettingsStore>()
                     : std::make_unique<SettingsStore>(options.settingsFile);
    // A scheduled run beside the desktop program, or beside another run, must never pick up
    // their export or their graph: its working files are its own.
    AppLocations locations = AppLocations::forThisMachine();
    locations.privateWorkingFiles = true;
    m_context = std::make_unique<AppContext>(std::move(store), *m_prompter, std::move(locations));
    const StartupOutcome startup = runStartupSequence(*m_context);
    if (startup.failed) {
        QTextStream(stderr) << startup.message << Qt::endl;
        return Refused;
    }
    m_connected = true;
    const auto login =
        LoginService::checkCredentials(m_context->mainDatabase(), options.user, options.password);
    if (!login) {
        QTextStream(stderr) << LoginService::LoginFailedMessage << Qt::endl;
        return Refused;
    }
    m_context->loginState() = *login;
    const ProduceCommand::Selection selection{options.from.month(), options.from.year(),
                                              options.to.month(), options.to.year()};
    m_problemsBeforeProduce = m_prompter->problemCount();
    const auto remember =
        options.rememberRange ? ProduceCommand::Remember::Range : ProduceCommand::Remember::Nothing;
    if (ProduceCommand(*m_context).produce(selection, remember) !=
        ProduceCommand::Outcome::Produced)
        return Refused;
    return Success;
}

bool Session::figuresIncomplete(const QString &verb) const
{
    if (m_prompter->problemCount() == m_problemsBeforeProduce)
        return false;
    QTextStream(stderr) << "veltrix-cli " << verb
                        << ": the accounting data could not be read completely (see above); "
                           "no figures were written"
                        << Qt::endl;
    return true;
}

void Session::loadComparison(const Options &options)
{
    if (!options.compareKind)
        return;
    PeriodDataSet &data = m_context->periodDataSet();
    const auto ranges =
        ComparisonRanges::earlierRanges(data.range(0), *options.compareKind, options.compareCount);
    for (int slot = 1; slot <= ranges.size(); ++slot)
        ContextWiring::rangeLoader(*m_context)
            .loadSlot(slot, ranges[slot - 1].start, ranges[slot - 1].end);
    data.setCurrentSlot(0);
}

} // namespace HeadlessSession
