// Veltrix — KPI dashboard for small businesses.
// veltrix-mw-sim: a MoneyWorks REST stand-in for the tests and the demo.

#include "simulatorserver.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QHostAddress>
#include <QTextStream>

using namespace Qt::StringLiterals;

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    QCommandLineParser parser;
    parser.setApplicationDescription(u"Serves a company file as a MoneyWorks document over the "
                                     u"MoneyWorks Datacentre REST interface."_s);
    parser.addHelpOption();
    parser.addOptions({
        {u"ledger"_s, u"the company file to serve"_s, u"FILE"_s},
        {u"document"_s, u"the document name clients ask for"_s, u"NAME"_s},
        {u"port"_s, u"port to listen on (0: any free port)"_s, u"PORT"_s, u"6710"_s},
        {u"listen"_s, u"address to listen on"_s, u"ADDRESS"_s, u"127.0.0.1"_s},
        {u"user"_s, u"user name clients must give"_s, u"USER"_s},
        {u"password"_s, u"password clients must give"_s, u"PASSWORD"_s},
        {u"period-end"_s, u"last day of the current period"_s, u"YYYY-MM-DD"_s, u"2026-06-30"_s},
        {u"delay-ms"_s, u"wait before every answer"_s, u"MS"_s, u"0"_s},
        {u"delay-after"_s, u"answer this many requests at once first"_s, u"N"_s, u"0"_s},
    });
    parser.process(app);

    SimulatorServer::Options options;
    options.ledger = parser.value(u"ledger"_s);
    options.document = parser.value(u"document"_s);
    options.user = parser.value(u"user"_s);
    options.password = parser.value(u"password"_s);
    options.periodEnd = QDate::fromString(parser.value(u"period-end"_s), Qt::ISODate);
    options.delayMs = parser.value(u"delay-ms"_s).toInt();
    options.delayAfter = parser.value(u"delay-after"_s).toInt();
    QTextStream err(stderr);
    if (options.ledger.isEmpty() || options.document.isEmpty() || !options.periodEnd.isValid()) {
        err << "veltrix-mw-sim: --ledger, --document and a valid --period-end are needed"
            << Qt::endl;
        return 2;
    }

    SimulatorServer server(options);
    if (const auto problem = server.open()) {
        err << "veltrix-mw-sim: cannot open " << options.ledger << ": " << *problem << Qt::endl;
        return 1;
    }
    const QHostAddress address(parser.value(u"listen"_s));
    if (!server.listen(address, quint16(parser.value(u"port"_s).toUInt()))) {
        err << "veltrix-mw-sim: cannot listen on " << parser.value(u"listen"_s) << ':'
            << parser.value(u"port"_s) << Qt::endl;
        return 1;
    }
    QTextStream(stdout) << "listening on " << address.toString() << ':' << server.port()
                        << Qt::endl;
    return QCoreApplication::exec();
}
