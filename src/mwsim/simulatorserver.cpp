// Veltrix — KPI dashboard for small businesses.
#include "simulatorserver.h"

#include "common/numberformat.h"
#include "common/rounding.h"
#include "sources/companyfile.h"
#include "sources/myobsource.h"
#include "sources/shortdate.h"

#include <QRegularExpression>
#include <QSqlQuery>
#include <QTcpSocket>
#include <QTimer>
#include <QUrl>

using namespace Qt::StringLiterals;

namespace {

const auto InvalidExpression = u"[ERROR] Invalid expression"_s;

QByteArray httpResponse(int status, const QByteArray &reason, const QByteArray &body)
{
    return "HTTP/1.1 " + QByteArray::number(status) + ' ' + reason +
           "\r\nServer: MoneyWorks_Datacentre/9.2 REST/9.2\r\nContent-Type: text/plain; "
           "charset=utf-8\r\nContent-Length: " +
           QByteArray::number(body.size()) + "\r\nConnection: close\r\n\r\n" + body;
}

} // namespace

SimulatorServer::SimulatorServer(Options options, QObject *parent)
    : QObject(parent)
    , m_options(std::move(options))
    , m_locale(NumberFormat::userLocale())
{
    connect(&m_server, &QTcpServer::newConnection, this, [this] {
        while (QTcpSocket *socket = m_server.nextPendingConnection())
            serve(socket);
    });
}

std::optional<QString> SimulatorServer::open()
{
    if (const auto error = CompanyFile::open(m_ledger, m_options.ledger))
        return error->description;
    return std::nullopt;
}

bool SimulatorServer::listen(const QHostAddress &address, quint16 port)
{
    return m_server.listen(address, port);
}

void SimulatorServer::serve(QTcpSocket *socket)
{
    connect(socket, &QTcpSocket::disconnected, socket, &QObject::deleteLater);
    connect(socket, &QTcpSocket::readyRead, socket, [this, socket] {
        QByteArray request = socket->property("request").toByteArray() + socket->readAll();
        socket->setProperty("request", request);
        if (!request.contains("\r\n\r\n"))
            return;
        const QByteArray answer = respond(request);
        const int delay = ++m_requests > m_options.delayAfter ? m_options.delayMs : 0;
        QTimer::singleShot(delay, socket, [socket, answer] {
            socket->write(answer);
            socket->disconnectFromHost();
        });
    });
}

QByteArray SimulatorServer::respond(const QByteArray &request)
{
    const QList<QByteArray> lines = request.split('\n');
    const QList<QByteArray> requestLine = lines.first().trimmed().split(' ');
    if (requestLine.size() < 2 || requestLine[0] != "GET")
        return httpResponse(405, "Method Not Allowed", "GET only\n");

    // /REST/<document>/<command>/<parameters>
    const QByteArray target = requestLine[1];
    if (!target.startsWith("/REST/"))
        return httpResponse(404, "Not Found", "No such resource\n");
    const QList<QByteArray> parts = target.mid(6).split('/');
    // The server's version is told to anyone, logged in or not.
    if (parts.size() >= 2 && (parts[0].isEmpty() || parts[0] == "server") && parts[1] == "version")
        return httpResponse(200, "OK", "9.2");

    if (!m_options.user.isEmpty()) {
        const QByteArray expected =
            "Basic " + (m_options.user + u':' + m_options.password).toUtf8().toBase64();
        bool authorised = false;
        for (const QByteArray &line : lines) {
            if (line.toLower().startsWith("authorization:"))
                authorised = line.mid(14).trimmed() == expected;
        }
        if (!authorised)
            return httpResponse(401, "Unauthorized", "Login required\n");
    }
    if (parts.size() < 3)
        return httpResponse(404, "Not Found", "No such resource\n");
    const QString document = QUrl::fromPercentEncoding(parts[0]);
    if (document != m_options.document)
        return httpResponse(404, "Not Found", "No such document\n");

    const QByteArray command = parts[1];
    const QByteArray parameters = parts.mid(2).join('/');
    QHash<QString, QString> values;
    for (const QByteArray &pair : parameters.split('&')) {
        const qsizetype equals = pair.indexOf('=');
        if (equals > 0)
            values.insert(QString::fromLatin1(pair.left(equals)),
                          QUrl::fromPercentEncoding(pair.mid(equals + 1)));
    }
    if (command == "evaluate")
        return httpResponse(200, "OK", evaluate(values.value(u"expr"_s)).toUtf8());
    if (command == "export" && values.value(u"table"_s).toLower() == u"transaction"_s) {
        const std::optional<QString> records =
            exportInvoices(values.value(u"search"_s), values.value(u"format"_s));
        if (!records)
            return httpResponse(400, "Bad Request", "Unsupported export format\n");
        return httpResponse(200, "OK", records->toUtf8());
    }
    return httpResponse(400, "Bad Request", "Unsupported command\n");
}

QString SimulatorServer::evaluate(const QString &expression)
{
    if (expression == u"DocumentPath"_s)
        return m_options.document;
    if (expression == u"periodtodate(currentperiod())"_s)
        return ShortDate::format(m_options.periodEnd, m_locale);

    static const QRegularExpression movement(
        uR"(^GetMovement\(`accountcode = \\"([^"\\]*)\\"`, '([^']*) ', '([^']*)'\)$)"_s);
    const QRegularExpressionMatch match = movement.match(expression);
    if (!match.hasMatch())
        return InvalidExpression;
    const QDate from = ShortDate::parse(match.captured(2), m_locale);
    const QDate to = ShortDate::parse(match.captured(3), m_locale);
    if (!from.isValid() || !to.isValid())
        return InvalidExpression;

    QSqlQuery query(m_ledger.database());
    query.prepare(u"SELECT SUM(j.TaxExclusiveAmount) FROM JournalRecords j JOIN Accounts a "
                  u"ON a.AccountID = j.AccountID WHERE a.AccountNumber = ? AND "
                  u"j.TransactionDate BETWEEN ? AND ?"_s);
    query.addBindValue(match.captured(1));
    query.addBindValue(from.toString(Qt::ISODate));
    query.addBindValue(to.toString(Qt::ISODate));
    double total = 0.0;
    if (query.exec() && query.next())
        total = query.value(0).toDouble();
    // Amounts are money: two decimals, as MoneyWorks keeps them.
    return QString::number(Rounding::halfAwayFromZero(total, 2), 'f', 2);
}

namespace {

// A format template filled in for one record: every [Field] becomes the record's value of that
// field, named in any case; the rest is copied as it is.
std::optional<QString> fillTemplate(const QString &format, const QHash<QString, QString> &record)
{
    QString text;
    for (qsizetype i = 0; i < format.size(); ++i) {
        const QChar c = format[i];
        if (c == u'[') {
            const qsizetype close = format.indexOf(u']', i);
            if (close < 0)
                return std::nullopt;
            const auto value = record.constFind(format.mid(i + 1, close - i - 1).toLower());
            if (value == record.cend())
                return std::nullopt;
            text += *value;
            i = close;
        } else {
            text += c;
        }
    }
    return text;
}

} // namespace

std::optional<QString> SimulatorServer::exportInvoices(const QString &search, const QString &format)
{
    // Only templates are served; MoneyWorks' own XML forms are not needed by Veltrix.
    if (!format.contains(u'['))
        return std::nullopt;
    static const QRegularExpression invoices(
        uR"(^type = `DI@` and transdate >= '([^']*)' and transdate <= '([^']*)'$)"_s);
    const QRegularExpressionMatch match = invoices.match(search);
    QString text;
    if (!match.hasMatch())
        return text;
    const QDate from = ShortDate::parse(match.captured(1), m_locale);
    const QDate to = ShortDate::parse(match.captured(2), m_locale);
    QSqlQuery query(m_ledger.database());
    query.prepare(
        u"SELECT InvoiceNumber, Date FROM Sales WHERE Date BETWEEN ? AND ? ORDER BY Date"_s);
    query.addBindValue(from.toString(Qt::ISODate));
    query.addBindValue(to.toString(Qt::ISODate));
    if (!query.exec())
        return text;
    // Every invoice has its labour and its parts line; both carry the reference.
    while (query.next()) {
        const QString reference = query.value(0).toString();
        const QString date =
            ShortDate::format(QDate::fromString(query.value(1).toString(), Qt::ISODate), m_locale);
        for (const QString &account : {u"4-1100"_s, u"4-1400"_s}) {
            const QHash<QString, QString> record{{u"theirref"_s, reference},
                                                 {u"transdate"_s, date},
                                                 {u"type"_s, u"DI"_s},
                                                 {u"detail.account"_s, account}};
            const std::optional<QString> line = fillTemplate(format, record);
            if (!line)
                return std::nullopt;
            text += *line;
        }
    }
    return text;
}
