// Veltrix — KPI dashboard for small businesses.
#include "simulatorprocess.h"

#include "common/numberformat.h"
#include "common/recordingprompter.h"
#include "common/settings.h"
#include "sources/companyfilewriter.h"
#include "sources/moneyworkssource.h"
#include "sources/restmoneyworkslink.h"

#include <QNetworkReply>
#include <QRandomGenerator>
#include <QTcpServer>
#include <QTcpSocket>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

const QString Document = u"Harbour Panel & Paint.moneyworks"_s;

// Gives the document's name to the check that opens it and the same reply to everything
// else, as a broken or hostile server might.
void answerNonsense(QTcpServer &server, const QByteArray &headers, const QByteArray &body)
{
    QObject::connect(&server, &QTcpServer::newConnection, &server, [&server, headers, body] {
        QTcpSocket *socket = server.nextPendingConnection();
        QObject::connect(socket, &QTcpSocket::disconnected, socket, &QObject::deleteLater);
        QObject::connect(socket, &QTcpSocket::readyRead, socket, [socket, headers, body] {
            const QByteArray request = socket->peek(socket->bytesAvailable());
            const bool opening = request.contains("/evaluate/expr=DocumentPath ");
            const QByteArray content = opening ? QUrl::toPercentEncoding(Document) : body;
            if (request.contains("\r\n\r\n")) {
                socket->write(
                    "HTTP/1.1 200 OK\r\nContent-Length: " + QByteArray::number(content.size()) +
                    "\r\n" + (opening ? QByteArray() : headers) + "\r\n" + content);
                socket->disconnectFromHost();
            }
        });
    });
}

} // namespace

class TestMoneyWorksSource : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void countJobReferences_data();
    void countJobReferences();
    void figuresThroughTheServer();
    void openingIsRefused_data();
    void openingIsRefused();
    void lateAnswersTimeOut();
    void serverThatAnswersNonsense_data();
    void serverThatAnswersNonsense();

private:
    std::unique_ptr<MoneyWorksSource> serverSource(const QString &user, const QString &password,
                                                   int port, int timeoutSeconds = 15);

    QTemporaryDir m_dir;
    QString m_ledger;
    RecordingPrompter m_prompter;
    Settings m_settings;
    NumberFormat m_numbers{QLocale(QLocale::English, QLocale::Australia)};
    SimulatorProcess m_simulator;
};

void TestMoneyWorksSource::initTestCase()
{
    m_ledger = m_dir.filePath(u"ledger.myo"_s);
    CompanyFileWriter writer;
    QCOMPARE(writer.create(m_ledger), std::nullopt);
    const qint64 panel = writer.addAccount(u"4-1100"_s, u"Panel Labour"_s);
    const qint64 wages = writer.addAccount(u"5-1100"_s, u"Panel Wages"_s);
    writer.addJournalLine(panel, QDate(2025, 7, 1), -1000.0);
    writer.addJournalLine(panel, QDate(2025, 7, 31), -234.56);
    writer.addJournalLine(panel, QDate(2025, 8, 1), -99.0);
    writer.addJournalLine(wages, QDate(2025, 7, 4), 400.25);
    for (int day = 1; day <= 5; ++day)
        writer.addSale(QDate(2025, 7, day), u"RO%1"_s.arg(day));
    QCOMPARE(writer.finish(), std::nullopt);

    m_settings.appFolder = m_dir.path() + u'/';
    m_settings.jobsFile = m_settings.appFolder + u"jobs.inf"_s;
    QVERIFY2(m_simulator.start({u"--ledger"_s, m_ledger, u"--document"_s, Document, u"--user"_s,
                                u"Admin"_s, u"--password"_s, u"s3cret"_s, u"--period-end"_s,
                                u"2025-07-31"_s}),
             qPrintable(m_simulator.problem()));
}

std::unique_ptr<MoneyWorksSource> TestMoneyWorksSource::serverSource(const QString &user,
                                                                     const QString &password,
                                                                     int port, int timeoutSeconds)
{
    m_settings.accFilePath = u"http://127.0.0.1:%1/"_s.arg(port) +
                             QString::fromLatin1(QUrl::toPercentEncoding(Document));
    return std::make_unique<MoneyWorksSource>(
        m_settings, m_prompter, m_numbers, [user, password, timeoutSeconds] {
            return std::make_unique<RestMoneyWorksLink>(user, password, timeoutSeconds);
        });
}

void TestMoneyWorksSource::countJobReferences_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("jobs");
    const QString header = u"TransDate\tTheirRef\tU.Detail.Account\r\n"_s;
    QTest::newRow("only the header") << header << 0;
    QTest::newRow("nothing at all") << QString() << 0;
    QTest::newRow("empty line after the last break")
        << header + u"1/7/25\tRO1\t4-1100\r\n1/7/25\tRO2\t4-1100\r\n"_s << 2;
    QTest::newRow("one invoice, two lines") << header + u"x\tRO1\t4-1100\r\nx\tRO1\t4-1400"_s << 1;
    QTest::newRow("references differing in case")
        << header + u"x\tro1\t4-1100\r\nx\tRO1\t4-1100"_s << 2;
    QTest::newRow("12 and 123") << header + u"x\t12\t4-1100\r\nx\t123\t4-1100"_s << 2;
    QTest::newRow("EI in either case")
        << header + u"x\tRO1\tEI\r\nx\tRO2\tei\r\nx\tRO3\t4-1100"_s << 1;
    QTest::newRow("blank reference") << header + u"x\t  \t4-1100\r\nx\tRO3\t4-1100"_s << 1;
    QTest::newRow("line too short") << header + u"x\r\nx\tRO3"_s << 1;
    QTest::newRow("names missing: first column") << u"a\tb\r\nRO1\tx\r\nRO2\tx"_s << 2;
    QTest::newRow("a name twice: the later column") << u"theirref\ttheirref\r\nA\tB\r\nA\tC"_s << 2;
}

void TestMoneyWorksSource::countJobReferences()
{
    QFETCH(QString, text);
    QFETCH(int, jobs);
    QCOMPARE(MoneyWorksSource::countJobReferences(text), jobs);
}

void TestMoneyWorksSource::figuresThroughTheServer()
{
    auto source = serverSource(u"Admin"_s, u"s3cret"_s, m_simulator.port());
    m_prompter.clearMessages();
    QVERIFY(!source->isReachable());
    QCOMPARE(source->openDataFile(), std::nullopt);
    QVERIFY(source->isReachable());
    const QDate first(2025, 7, 1);
    const QDate last(2025, 7, 31);
    QCOMPARE(source->accountMovement(u"4-1100"_s, first, last), -1234.56);
    QCOMPARE(source->accountMovement(u"4-1100"_s, last, last), -234.56);
    QCOMPARE(source->accountMovement(u"5-1100"_s, first, last), 400.25);
    QCOMPARE(source->accountMovement(u"9-9999"_s, first, last), 0.0);
    // The simulator takes only the expression and search texts MoneyWorks is sent; a quote in a
    // code, which goes in unescaped, makes an expression it cannot evaluate.
    QCOMPARE(source->accountMovement(u"4\"1100"_s, first, last), 0.0);
    QCOMPARE(source->jobsCount(first, last), qint16(5));
    QCOMPARE(source->jobsCount(QDate(2025, 7, 2), QDate(2025, 7, 3)), qint16(2));
    QCOMPARE(source->jobsCount(QDate(2024, 1, 1), QDate(2024, 1, 31)), qint16(0));
    // The range loader refuses a range beyond this; its message is tested there.
    QCOMPARE(source->currentPeriodEnd(), std::optional<QDate>(last));
    QVERIFY(m_prompter.messages().isEmpty());
    // The server sends the records alone; the file gets the column names the count reads.
    QFile jobs(source->jobsFile());
    QVERIFY(jobs.open(QIODevice::ReadOnly));
    QCOMPARE(jobs.readAll(), QByteArray("theirref\tu.detail.account\r\n"));
}

void TestMoneyWorksSource::openingIsRefused_data()
{
    QTest::addColumn<QString>("address");
    QTest::addColumn<QString>("password");
    QTest::addColumn<int>("error");
    const QString server = m_simulator.address(Document);
    QTest::newRow("wrong password") << server << u"wrong"_s << 401;
    QTest::newRow("no document in the address")
        << u"/books/Acme.moneyworks"_s << u"s3cret"_s << RestMoneyWorksLink::NotADocumentError;
    // A server that takes connections and says nothing.
    QTest::newRow("silent server") << QString() << u"s3cret"_s << RestMoneyWorksLink::TimeoutError;
}

void TestMoneyWorksSource::openingIsRefused()
{
    QFETCH(QString, address);
    QFETCH(QString, password);
    QFETCH(int, error);
    QTcpServer silent;
    QVERIFY(silent.listen(QHostAddress::LocalHost));
    auto source =
        serverSource(u"Admin"_s, password, silent.serverPort(), address.isEmpty() ? 1 : 15);
    if (!address.isEmpty())
        m_settings.accFilePath = address;
    const std::optional<DbError> opened = source->openDataFile();
    QVERIFY(opened);
    QCOMPARE(opened->number, error);
    QVERIFY(!source->isReachable());
}

void TestMoneyWorksSource::lateAnswersTimeOut()
{
    // Once open (the answers arrive late, not never), every code reports its own timeout.
    SimulatorProcess slow;
    QVERIFY2(slow.start({u"--ledger"_s, m_ledger, u"--document"_s, Document, u"--delay-ms"_s,
                         u"1500"_s, u"--delay-after"_s, u"1"_s}),
             qPrintable(slow.problem()));
    auto late = serverSource(QString(), QString(), slow.port(), 1);
    QCOMPARE(late->openDataFile(), std::nullopt);
    m_prompter.clearMessages();
    for (const QString &code : {u"4-1100"_s, u"5-1100"_s})
        QCOMPARE(late->accountMovement(code, QDate(2025, 7, 1), QDate(2025, 7, 31)), 0.0);
    QCOMPARE(m_prompter.messages().size(), 2);
    for (const RecordingPrompter::Message &message : m_prompter.messages())
        QCOMPARE(message.title, u"GetMWValue Error -2147023436"_s);
}

void TestMoneyWorksSource::serverThatAnswersNonsense_data()
{
    QTest::addColumn<QByteArray>("headers");
    QTest::addColumn<QByteArray>("body");
    QTest::addColumn<double>("movement");
    QTest::addColumn<QStringList>("titles");
    QByteArray noise(4096, 0);
    QRandomGenerator(17).fillRange(reinterpret_cast<quint32 *>(noise.data()), 4096 / 4);
    const QStringList notAnswers{u"GetMWValue Error 13"_s, u"GetMWJobs Error 13"_s};
    const QStringList tooLarge{u"GetMWValue Error 7"_s, u"GetMWJobs Error 7"_s};
    QTest::newRow("random bytes") << QByteArray() << noise << 0.0 << notAnswers;
    QTest::newRow("a web page") << QByteArray("Content-Type: text/html\r\n")
                                << QByteArray("<html><body>It works!</body></html>") << 0.0
                                << notAnswers;
    QTest::newRow("references without accounts")
        << QByteArray() << QByteArray("RO1\nRO2\nRO3\n") << 0.0 << notAnswers;
    QTest::newRow("three columns")
        << QByteArray() << QByteArray("RO1\t4-1100\tx\n") << 0.0 << notAnswers;
    QTest::newRow("40 MB of records")
        << QByteArray() << QByteArray("RO1\t4-1100\n").repeated(4 << 20) << 0.0 << tooLarge;
    // 100 MB of one letter, squeezed to about 100 KB: the network layer refuses to unpack it.
    const QString unpacked = QString::number(QNetworkReply::UnknownContentError);
    QTest::newRow("compressed bomb")
        << QByteArray("Content-Encoding: deflate\r\n")
        << qCompress(QByteArray(100 << 20, 'A'), 9).mid(4) << 0.0
        << QStringList{u"GetMWValue Error "_s + unpacked, u"GetMWJobs Error "_s + unpacked};
    // Answers to the movement that are numbers or MoneyWorks' own error text are no failure;
    // as a list of jobs they are.
    const QStringList jobsOnly{u"GetMWJobs Error 13"_s};
    QTest::newRow("a number") << QByteArray() << QByteArray("-1234.56") << -1234.56 << jobsOnly;
    QTest::newRow("a grouped number")
        << QByteArray() << QByteArray("1,234.50") << 1234.5 << jobsOnly;
    QTest::newRow("error text") << QByteArray() << QByteArray("[ERROR] Unknown identifier") << 0.0
                                << jobsOnly;
    QTest::newRow("a number and more")
        << QByteArray() << QByteArray("12 apples") << 0.0 << notAnswers;
    // An empty list is no jobs, an empty answer no number.
    QTest::newRow("nothing") << QByteArray() << QByteArray() << 0.0 << notAnswers.mid(0, 1);
}

void TestMoneyWorksSource::serverThatAnswersNonsense()
{
    QFETCH(QByteArray, headers);
    QFETCH(QByteArray, body);
    QFETCH(double, movement);
    QFETCH(QStringList, titles);
    QTcpServer server;
    answerNonsense(server, headers, body);
    QVERIFY(server.listen(QHostAddress::LocalHost));
    auto source = serverSource(QString(), QString(), server.serverPort());
    QCOMPARE(source->openDataFile(), std::nullopt);
    QFile::remove(source->jobsFile());
    m_prompter.clearMessages();

    // No figure comes of it but a number, and each call says what went wrong in a box of
    // readable size.
    QCOMPARE(source->accountMovement(u"4-1100"_s, QDate(2025, 7, 1), QDate(2025, 7, 31)), movement);
    QCOMPARE(source->jobsCount(QDate(2025, 7, 1), QDate(2025, 7, 31)), qint16(0));
    QStringList shown;
    for (const RecordingPrompter::Message &message : m_prompter.messages()) {
        shown << message.title;
        QVERIFY(message.text.size() <= Prompter::MaxTextLength + 1);
    }
    QCOMPARE(shown, titles);
    // A failed export leaves no list of jobs behind.
    QCOMPARE(QFile::exists(source->jobsFile()), !titles.last().startsWith(u"GetMWJobs"_s));
}

QTEST_GUILESS_MAIN(TestMoneyWorksSource)
#include "tst_moneyworkssource.moc"
