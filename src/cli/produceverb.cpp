// Veltrix — KPI dashboard for small businesses.
#include "produceverb.h"

#include "headlesssession.h"

#include "app/appcontext.h"
#include "app/contextwiring.h"
#include "grid/gridmodel.h"
#include "users/loginservice.h"
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
        << "usage: veltrix-cli produce --from YYYY-MM --to YYYY-MM --user NAME\n"
        << "       [--password PW | --password-file FILE] [--settings FILE] [--remember]\n"
        << "       [--compare years|periods --count N] [--format csv|json]" << Qt::endl;
    return 2;
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
    ContextWiring::tabViewBuilder(context, grid).buildSlotView(0, slot);
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
    HeadlessSession::addOptions(parser);
    parser.addOption({u"format"_s, u"csv or json"_s, u"FORMAT"_s, u"csv"_s});
    if (!parser.parse(QStringList{u"veltrix-cli produce"_s} + arguments))
        return usageError(parser.errorText());
    const auto read = HeadlessSession::readOptions(parser);
    if (const QString *problem = std::get_if<QString>(&read))
        return usageError(*problem);
    const auto &options = std::get<HeadlessSession::Options>(read);
    const QString format = parser.value(u"format"_s);
    if (format != u"csv"_s && format != u"json"_s)
        return usageError(u"--format is csv or json"_s);

    HeadlessSession::Session session;
    if (const int failed = session.open(options))
        return failed;
    AppContext &context = session.context();
    QList<Record> records = recordsOfSlot(context, 0);
    if (options.compareKind) {
        session.loadComparison(options);
        for (int slot = 1; slot <= options.compareCount; ++slot)
            records += recordsOfSlot(context, slot);
    }
    if (session.figuresIncomplete(u"produce"_s))
        return HeadlessSession::IncompleteFigures;
    print(records, format == u"json"_s);
    return HeadlessSession::Success;
}

} // namespace ProduceVerb
