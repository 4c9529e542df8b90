// Veltrix — KPI dashboard for small businesses.
#include "headlesssession.h"

#include "app/appcontext.h"
#include "app/consoleprompter.h"
#include "app/settingsstore.h"
#include "app/startupsequence.h"
#include "database/mainconnector.h"
#include "engine/producecommand.h"
#include "engine/rangeloader.h"
#include "users/loginservice.h"

#include <QCommandLineParser>
#include <QFileInfo>
#include <QTextStream>

using namespace Qt::StringLiterals;

namespace HeadlessSession {

namespace {

std::optional<QDate> month(const QString &text)
{
    const QDate date = QDate::fromString(text + u"-01"_s, u"yyyy-MM-dd"_s);
    return date.isValid() ? std::optional<QDate>(date) : std::nullopt;
}

} // namespace

void addOptions(QCommandLineParser &parser)
{
    parser.addOptions({{u"from"_s, u"first month"_s, u"YYYY-MM"_s},
                       {u"to"_s, u"last month"_s, u"YYYY-MM"_s},
                       {u"user"_s, u"user name"_s, u"NAME"_s},
                       {u"password"_s, u"password"_s, u"PW"_s},
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
        return u"--from and --to need a month written YYYY-MM"_s;
    if (!parser.isSet(u"user"_s))
        return u"--user is needed"_s;
    options.from = *from;
    options.to = *to;
    options.user = parser.value(u"user"_s);
    options.password = parser.value(u"password"_s);
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
    m_context =
        std::make_unique<AppContext>(std::move(store), *m_prompter, AppLocations::forThisMachine());
    const StartupOutcome startup = runStartupSequence(*m_context);
    if (startup.failed) {
        QTextStream(stderr) << startup.message << Qt::endl;
        return 2;
    }
    m_connected = true;
    const auto login =
        LoginService::checkCredentials(m_context->mainDatabase(), options.user, options.password);
    if (!login) {
        QTextStream(stderr) << LoginService::LoginFailedMessage << Qt::endl;
        return 2;
    }
    m_context->loginState() = *login;
    const ProduceCommand::Selection selection{options.from.month(), options.from.year(),
                                              options.to.month(), options.to.year()};
    if (ProduceCommand(*m_context).produce(selection) != ProduceCommand::Outcome::Produced)
        return 2;
    return 0;
}

void Session::loadComparison(const Options &options)
{
    if (!options.compareKind)
        return;
    PeriodDataSet &data = m_context->periodDataSet();
    const auto ranges =
        ComparisonRanges::earlierRanges(data.range(0), *options.compareKind, options.compareCount);
    for (int slot = 1; slot <= ranges.size(); ++slot)
        RangeLoader(*m_context).loadSlot(slot, ranges[slot - 1].start, ranges[slot - 1].end);
    data.setCurrentSlot(0);
}

} // namespace HeadlessSession
