// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "database/sqliteconnection.h"

#include <QDate>
#include <QLocale>
#include <QTcpServer>

// A stand-in for a MoneyWorks Datacentre REST server that serves one ledger, a company file,
// as one document, answering as the published REST interface does: "version" without a login,
// "evaluate" with the expression's value as plain text, and "export" of transactions through a
// format template, which gives each record the template's text with its fields filled in and
// nothing else (no line of column names). It understands exactly what Veltrix sends:
// "DocumentPath", "periodtodate(currentperiod())", the GetMovement expression and the search
// for debtor invoices of the jobs count; any other expression gets MoneyWorks' error text.
class SimulatorServer : public QObject
{
    Q_OBJECT

public:
    struct Options
    {
        QString ledger;   // a company file
        QString document; // the name clients ask for
        QString user;     // empty: no login needed
        QString password;
        QDate periodEnd;    // the end of the current period
        int delayMs = 0;    // wait this long before every answer
        int delayAfter = 0; // ... but answer this many requests at once first
    };

    explicit SimulatorServer(Options options, QObject *parent = nullptr);

    std::optional<QString> open();
    bool listen(const QHostAddress &address, quint16 port);
    quint16 port() const { return m_server.serverPort(); }

    // The answer to one evaluate request.
    QString evaluate(const QString &expression);
    // The answer to an export of invoice lines through a format template; nothing when the
    // template names a field the simulator does not keep.
    std::optional<QString> exportInvoices(const QString &search, const QString &format);

private:
    void serve(QTcpSocket *socket);
    QByteArray respond(const QByteArray &request);

    Options m_options;
    QLocale m_locale;
    SqliteConnection m_ledger;
    int m_requests = 0;
    QTcpServer m_server;
};
