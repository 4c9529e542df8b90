// Veltrix — KPI dashboard for small businesses.
#include "produceverb.h"

#include "app/appcontext.h"
#include "app/consoleprompter.h"
#include "app/settingsstore.h"
#include "app/startupsequence.h"
#include "database/mainconnector.h"
#include "engine/producecommand.h"
#include "engine/rangeloader.h"
#include "users/loginservice.h"
#include "views/comparisonranges.h"
#include "views/gridmodel.h"
#include "views/kpievaluation.h"
#include "views/tabviewbuilder.h"

#include <QCommandLineParser>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QTextStream>

using namespace Qt::StringLiterals;

namespace ProduceVerb {

namespace {

const QStringList Columns = {u"slot"_s,  u"id"_s,        u"tab"_s,     u"order"_s,
                             u"label"_s, u"type"_s,      u"display"_s, u"signed"_s,
                             u"abs"_s,   u"benchmark"_s, u"variant"_s, u"band"_s};

int usageError(const QString &problem)
{
    QTextStream err(stderr);
    err << "veltrix-cli produce: " << problem << "\n"
        << "usage: veltrix-cli produce --from YYYY-MM --to YYYY-MM --user NAME --password PW\n"
        << "       [--settings FILE] [--compare years|periods --count N] [--format csv|json]"
        << Qt::endl;
    return 2;
}

std::optional<QDate> month(const QString &text)
{
    const QDate date = QDate::fromString(text + u"-01"_s, u"yyyy-MM-dd"_s);
    return date.isValid() ? std::optional<QDate>(date) : std::nullopt;
}

QString numberText(double value)
{
    return QLocale::c().toString(value, 'g', QLocale::FloatingPointShortest);
}

QString csvField(const QString &text)
{
    if (!text.contains(u',') && !text.contains(u'"') && !text.contains(u'\n') &&
        !text.contains(u'\r'))
        return text;
    return u'"' + QString(text).replace(u"\""_s, u"\"\""_s) + u'"';
}

using Record = QList<QString>;

// One record per line of the "All" tab the user may see, for the slot: the grid the main
// window would show, with the benchmark figures beside it.
QList<Record> recordsOfSlot(AppContext &context, int slot)
{
    GridModel grid;
    TabViewBuilder::addMainColumns(grid);
    TabViewBuilder(context, grid).buildSlotView(0, slot);
    const int valueColumn = grid.columnIndex(u"value"_s);

    QList<Record> records;
    const PeriodDataSet &data = context.periodDataSet();
    const NumberFormat &numbers = context.numberFormat();
    RecordSet &fields = context.mainDatabase().fieldsRecordset();
    if (fields.moveFirst())
        return records;
    for (int row = 1; !fields.eof(); fields.moveNext(), ++row) {
        const qint64 id = fields.value(u"ID"_s).toLongLong();
        const int type = fields.value(u"Type"_s).toInt();
        if (!LoginService::maySee(context.loginState(), id, type))
            continue;
        const bool heading = type == 1;
        QString benchmark, variant, band;
        const double actual = data.getFieldValue(id);
        if (type == 3 && actual != 0.0) {
            const auto result = KpiEvaluation::evaluateBenchmark(fields.value(u"Data"_s).toString(),
                                                                 actual, numbers);
            benchmark = numberText(result.optimal);
            variant = numberText(result.variant);
            band = QString::number(result.band);
        }
        records << Record{QString::number(slot),
                          QString::number(id),
                          fields.value(u"Tab"_s).toString(),
                          fields.value(u"Order"_s).toString(),
                          fields.value(u"Label"_s).toString(),
                          QString::number(type),
                          grid.cellText(row, valueColumn),
                          heading ? QString() : numberText(actual),
                          heading ? QString() : numberText(data.getFieldAbs(id)),
                          benchmark,
                          variant,
                          band};
    }
    return records;
}

void print(const QList<Record> &records, bool json)
{
    QTextStream out(stdout);
    if (json) {
        QJsonArray array;
        for (const Record &record : records) {
            QJsonObject object;
            for (int i = 0; i < Columns.size(); ++i)
                object.insert(Columns[i], record[i]);
            array.append(object);
        }
        out << QJsonDocument(array).toJson(QJsonDocument::Indented);
        return;
    }
    out << Columns.join(u',') << '\n';
    for (const Record &record : records) {
        QStringList fields;
        for (const QString &field : record)
            fields << csvField(field);
        out << fields.join(u',') << '\n';
    }
}

} // namespace

int produce(const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.addOptions({{u"from"_s, u"first month"_s, u"YYYY-MM"_s},
                       {u"to"_s, u"last month"_s, u"YYYY-MM"_s},
                       {u"user"_s, u"user name"_s, u"NAME"_s},
                       {u"password"_s, u"password"_s, u"PW"_s},
                       {u"settings"_s, u"settings file"_s, u"FILE"_s},
                       {u"compare"_s, u"years or periods"_s, u"KIND"_s},
                       {u"count"_s, u"earlier periods, 1 to 4"_s, u"N"_s},
                       {u"format"_s, u"csv or json"_s, u"FORMAT"_s, u"csv"_s}});
    if (!parser.parse(QStringList{u"veltrix-cli produce"_s} + arguments))
        return usageError(parser.errorText());

    const auto from = month(parser.value(u"from"_s));
    const auto to = month(parser.value(u"to"_s));
    if (!from || !to)
        return usageError(u"--from and --to need a month written YYYY-MM"_s);
    if (!parser.isSet(u"user"_s))
        return usageError(u"--user is needed"_s);
    const QString format = parser.value(u"format"_s);
    if (format != u"csv"_s && format != u"json"_s)
        return usageError(u"--format is csv or json"_s);
    std::optional<ComparisonRanges::Kind> compareKind;
    int compareCount = 0;
    if (parser.isSet(u"compare"_s)) {
        compareKind = ComparisonRanges::kindFromText(parser.value(u"compare"_s));
        bool ok = false;
        compareCount = parser.value(u"count"_s).toInt(&ok);
        if (!compareKind || !ok || compareCount < 1 || compareCount > 4)
            return usageError(u"--compare is years or periods, with --count 1 to 4"_s);
    }

    ConsolePrompter prompter;
    auto store = parser.isSet(u"settings"_s)
                     ? std::make_unique<SettingsStore>(parser.value(u"settings"_s))
                     : std::make_unique<SettingsStore>();
    AppContext context(std::move(store), prompter, AppLocations::forThisMachine());

    const StartupOutcome startup = runStartupSequence(context);
    if (startup.failed) {
        QTextStream(stderr) << startup.message << Qt::endl;
        return 2;
    }
    const auto login = LoginService::checkCredentials(
        context.mainDatabase(), parser.value(u"user"_s), parser.value(u"password"_s));
    if (!login) {
        QTextStream(stderr) << LoginService::LoginFailedMessage << Qt::endl;
        disconnectMainDatabase(context);
        return 2;
    }
    context.loginState() = *login;

    const ProduceCommand::Selection selection{from->month(), from->year(), to->month(), to->year()};
    if (ProduceCommand(context).produce(selection) != ProduceCommand::Outcome::Produced) {
        disconnectMainDatabase(context);
        return 2;
    }

    QList<Record> records = recordsOfSlot(context, 0);
    if (compareKind) {
        PeriodDataSet &data = context.periodDataSet();
        const auto ranges =
            ComparisonRanges::earlierRanges(data.range(0), *compareKind, compareCount);
        for (int slot = 1; slot <= ranges.size(); ++slot) {
            data.setRange(slot, ranges[slot - 1]);
            data.setCurrentSlot(quint8(slot));
            RangeLoader(context).loadDateRange(ranges[slot - 1].start, ranges[slot - 1].end);
            records += recordsOfSlot(context, slot);
        }
        data.setCurrentSlot(0);
    }
    print(records, format == u"json"_s);
    disconnectMainDatabase(context);
    return 0;
}

} // namespace ProduceVerb
