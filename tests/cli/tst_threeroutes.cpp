// Veltrix — KPI dashboard for small businesses.
// One ledger, three ways in: the SQLite company file, the MYOB SQL texts over ODBC (PostgreSQL
// standing in for the MYOB driver) and MoneyWorks over REST (veltrix-mw-sim). Every Field must
// come out the same.

#include "clirun.h"
#include "simulatorprocess.h"

#include "cipher/passwordcipher.h"
#include "common/settings.h"
#include "common/settingsstore.h"
#include "database/sqliteconnection.h"
#include "sources/companyfile.h"

#include <QCryptographicHash>
#include <QDir>
#include <QFile>
#include <QProcess>
#include <QRegularExpression>
#include <QSqlQuery>
#include <QSqlRecord>
#include <QTcpServer>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

// The financial year with the two before it.
const QStringList ThreeYears{u"--compare"_s, u"years"_s,   u"--count"_s, u"2"_s,
                             u"--from"_s,    u"2025-07"_s, u"--to"_s,    u"2026-06"_s};

int freePort()
{
    QTcpServer probe;
    probe.listen(QHostAddress::LocalHost);
    return probe.serverPort();
}

QString psqlodbcDriver()
{
    for (const QString &candidate : QDir(u"/usr/lib"_s).entryList({u"*-linux-gnu"_s}, QDir::Dirs)) {
        const QString path = u"/usr/lib/"_s + candidate + u"/odbc/psqlodbcw.so"_s;
        if (QFileInfo::exists(path))
            return path;
    }
    return {};
}

} // namespace

class TestThreeRoutes : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();
    void everyRouteAloneAndAtOnce();

private:
    void start(QProcess &process, const QStringList &arguments)
    {
        startCli(process, arguments, m_dir.path(), m_environment);
    }
    QString moneyWorksSettings();
    bool loadLedgerIntoPostgres(QString *problem);
    QString writeSettings(const QString &name, const QHash<QString, QString> &changes);

    QTemporaryDir m_dir;
    QString m_demo;
    QString m_pgFolder;
    int m_pgPort = 0;
    QProcessEnvironment m_environment = QProcessEnvironment::systemEnvironment();
    SimulatorProcess m_simulator;
};

void TestThreeRoutes::initTestCase()
{
    m_demo = m_dir.filePath(u"demo"_s);
    QCOMPARE(runCli({u"make-demo"_s, m_demo}, m_dir.path()).exitCode, 0);

    // PostgreSQL must be there: a missing server is a failure, never a silent skip.
    m_pgPort = freePort();
    QProcess cluster;
    cluster.start(QStringLiteral(VELTRIX_PGCLUSTER), {u"start"_s, QString::number(m_pgPort)});
    QVERIFY(cluster.waitForFinished(120000));
    QVERIFY2(cluster.exitCode() == 0,
             qPrintable(u"PostgreSQL could not be started: "_s +
                        QString::fromUtf8(cluster.readAllStandardError())));
    m_pgFolder = QString::fromUtf8(cluster.readAllStandardOutput()).trimmed();

    m_environment.insert(u"PGHOST"_s, u"127.0.0.1"_s);
    m_environment.insert(u"PGPORT"_s, QString::number(m_pgPort));
    m_environment.insert(u"PGUSER"_s, u"postgres"_s);
    m_environment.insert(u"PGDATABASE"_s, u"veltrix"_s);
    QString problem;
    QVERIFY2(loadLedgerIntoPostgres(&problem), qPrintable(problem));

    // The psqlODBC driver, registered under a MYOB driver name in a private odbcinst.ini.
    const QString driver = psqlodbcDriver();
    QVERIFY2(!driver.isEmpty(), "the psqlODBC driver (odbc-postgresql) is not installed");
    QFile odbcinst(m_dir.filePath(u"odbcinst.ini"_s));
    QVERIFY(odbcinst.open(QIODevice::WriteOnly));
    odbcinst.write("[MYOAU0901]\nDescription=PostgreSQL standing in for MYOB\nDriver=" +
                   driver.toUtf8() + "\n");
    odbcinst.close();
    m_environment.insert(u"ODBCSYSINI"_s, m_dir.path());

    QVERIFY2(m_simulator.start({u"--ledger"_s, m_demo + u"/Harbour Panel & Paint.moneyworks"_s,
                                u"--document"_s, u"Harbour Panel & Paint.moneyworks"_s, u"--user"_s,
                                u"Admin"_s, u"--password"_s, u"demo"_s, u"--period-end"_s,
                                u"2026-11-30"_s}),
             qPrintable(m_simulator.problem()));
}

void TestThreeRoutes::cleanupTestCase()
{
    if (!m_pgFolder.isEmpty()) {
        QProcess::execute(QStringLiteral(VELTRIX_PGCLUSTER), {u"stop"_s, m_pgFolder});
    }
}

bool TestThreeRoutes::loadLedgerIntoPostgres(QString *problem)
{
    SqliteConnection ledger;
    if (const auto error = CompanyFile::open(ledger, m_demo + u"/Harbour Panel & Paint.myo"_s)) {
        *problem = error->description;
        return false;
    }
    const struct
    {
        QString table;
        QString columns;
    } tables[] = {
        {u"Accounts"_s, u"AccountID, AccountNumber, AccountName"_s},
        {u"JournalRecords"_s, u"JournalRecordID, AccountID, TransactionDate, TaxExclusiveAmount"_s},
        {u"Sales"_s, u"SaleID, Date, InvoiceNumber"_s},
    };
    QString script = uR"(
CREATE DATABASE veltrix;
\c veltrix
CREATE TABLE Accounts (AccountID integer PRIMARY KEY, AccountNumber text, AccountName text);
CREATE TABLE JournalRecords (JournalRecordID integer PRIMARY KEY, AccountID integer,
  TransactionDate date, TaxExclusiveAmount numeric(14,2));
CREATE TABLE Sales (SaleID integer PRIMARY KEY, Date date, InvoiceNumber text);
)"_s;
    for (const auto &table : tables) {
        QFile file(m_dir.filePath(table.table + u".tsv"_s));
        if (!file.open(QIODevice::WriteOnly)) {
            *problem = file.errorString();
            return false;
        }
        QSqlQuery query(ledger.database());
        query.exec(u"SELECT "_s + table.columns + u" FROM "_s + table.table);
        while (query.next()) {
            QStringList cells;
            for (int i = 0; i < query.record().count(); ++i)
                cells << query.value(i).toString().replace(u'\t', u' ');
            file.write((cells.join(u'\t') + u'\n').toUtf8());
        }
        script += u"\\copy "_s + table.table + u" ("_s + table.columns + u") FROM '"_s +
                  file.fileName() + u"'\n"_s;
    }
    script += u"CREATE INDEX ON JournalRecords (AccountID, TransactionDate);\nANALYZE;\n"_s;

    QProcess psql;
    QProcessEnvironment environment = m_environment;
    environment.insert(u"PGDATABASE"_s, u"postgres"_s);
    psql.setProcessEnvironment(environment);
    psql.start(u"psql"_s, {u"-q"_s, u"-v"_s, u"ON_ERROR_STOP=1"_s});
    psql.write(script.toUtf8());
    psql.closeWriteChannel();
    if (!psql.waitForFinished(300000) || psql.exitCode() != 0) {
        *problem = u"psql: "_s + QString::fromUtf8(psql.readAllStandardError());
        return false;
    }
    return true;
}

QString TestThreeRoutes::writeSettings(const QString &name, const QHash<QString, QString> &changes)
{
    const QString path = m_dir.filePath(name);
    QFile::copy(m_demo + u"/settings.ini"_s, path);
    SettingsStore store(path);
    for (auto it = changes.cbegin(); it != changes.cend(); ++it)
        store.writeSetting(it.key(), it.value());
    return path;
}

QString TestThreeRoutes::moneyWorksSettings()
{
    return writeSettings(
        u"moneyworks.ini"_s,
        {{u"AccPackage"_s, u"MoneyWorks"_s},
         {u"AccFilePath"_s, m_simulator.address(u"Harbour Panel & Paint.moneyworks"_s)},
         {u"AccFileUser"_s, u"Admin"_s},
         {u"AccFilePass"_s, PasswordCipher().encryptText(u"demo"_s, Settings::PasswordKey)}});
}

void TestThreeRoutes::everyRouteAloneAndAtOnce()
{
    // Where the desktop program keeps its working files, another process's stand in the way: a
    // run that used them could write neither its export nor its picture.
    const QString desktopFolder = m_dir.filePath(u"data/veltrix/"_s);
    QVERIFY(QDir().mkpath(desktopFolder + u"jobs.inf"_s));
    QVERIFY(QDir().mkpath(desktopFolder + u"temp/tmp.bmp"_s));

    // Each route produces the year with the two before it; MoneyWorks also reports two months
    // with their own invoice counts and graphs. What each run gives (its exit code, messages
    // and lines, or its picture) alone and with the others at once.
    const QString moneyWorks = moneyWorksSettings();
    const QStringList settings{writeSettings(u"sqlite.ini"_s, {}),
                               writeSettings(u"odbc.ini"_s, {{u"AccFileDriver"_s, u"MYOAU0901"_s},
                                                             {u"AccFilePath"_s, u"veltrix"_s},
                                                             {u"AccFileUser"_s, u"postgres"_s}}),
                               moneyWorks, moneyWorks, moneyWorks};
    const auto runAll = [&](bool atOnce) {
        QProcess runs[5];
        QStringList outcomes;
        for (int r = 0; r < 5; ++r) {
            const QStringList account{u"--settings"_s, settings[r],     u"--user"_s,
                                      u"manager"_s,    u"--password"_s, u"manager1"_s};
            const QString month = r == 3 ? u"2025-07"_s : u"2025-08"_s;
            const QString page = m_dir.filePath(u"report%1.html"_s.arg(r));
            QFile::remove(m_dir.filePath(u"report%1.bmp"_s.arg(r)));
            const QStringList range =
                r < 3 ? ThreeYears
                      : QStringList{u"--from"_s, month, u"--to"_s, month, u"--out"_s, page};
            start(runs[r], QStringList{r < 3 ? u"produce"_s : u"report"_s} + account + range);
            if (!atOnce)
                runs[r].waitForFinished(300000);
        }
        for (int r = 0; r < 5; ++r) {
            const CliRun run = finishCli(runs[r]);
            QFile picture(m_dir.filePath(u"report%1.bmp"_s.arg(r)));
            const QByteArray drawn = picture.open(QIODevice::ReadOnly) ? picture.readAll() : "";
            outcomes << u"exit %1 "_s.arg(run.exitCode) + run.err + run.lines().join(u'\n') +
                            QString::fromLatin1(
                                QCryptographicHash::hash(drawn, QCryptographicHash::Sha1).toHex());
        }
        return outcomes;
    };
    const QStringList alone = runAll(false);
    for (const QString &outcome : alone)
        QVERIFY2(outcome.startsWith(u"exit 0 "_s), qPrintable(outcome.left(400)));
    // Every route gives the same lines, with nothing on standard error; something real was
    // read: total sales of the first slot.
    QVERIFY2(alone[0].startsWith(u"exit 0 slot,"_s), qPrintable(alone[0].left(400)));
    QCOMPARE(alone[0].count(u'\n'), 3 * 123);
    static const QRegularExpression totalSales(u"\n0,79,[^\n]*\\$ 3,"_s);
    QVERIFY(alone[0].contains(totalSales));
    QCOMPARE(alone[1], alone[0]);
    QCOMPARE(alone[2], alone[0]);
    QVERIFY(alone[3] != alone[4]);
    for (int round = 0; round < 3; ++round)
        QCOMPARE(runAll(true), alone);
}

QTEST_GUILESS_MAIN(TestThreeRoutes)
#include "tst_threeroutes.moc"
