// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/mainconnector.h"
#include "app/settingsloader.h"
#include "common/numberformat.h"
#include "database/configvalues.h"
#include "database/schemacheck.h"

#include <QProcess>
#include <QRandomGenerator>
#include <QSqlQuery>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

const auto UpdateProgram = u"You must update Veltrix to work with the new database!"_s;
const auto UpdateDatabase = u"You must update the database to work with this version of Veltrix!"_s;
const auto ConnectionFailed = u"Database connection failed!"_s;

void writeFile(const QString &path, const QByteArray &content)
{
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(content);
}

} // namespace

class TestMainConnector : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void versionRule_data();
    void versionRule();
    void opensTheStandingRecordsets();
    void cacheFile_data();
    void cacheFile();
    void unusableDatabase_data();
    void unusableDatabase();
    void lockedDatabaseFails();
    void missingConfigRowIsReportedOnEveryAccess();
    void twoProcessesWriteConfigTogether();

private:
    AppContext &context() { return m_workspace->context(); }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestMainConnector::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    QCOMPARE(loadSettings(context()), QString()); // main.db made, not yet connected
}

void TestMainConnector::versionRule_data()
{
    QTest::addColumn<QString>("required");
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("expected");
    QTest::newRow("both equal to the program") << u"1.55"_s << u"1.55"_s << QString();
    QTest::newRow("program too old") << u"1.6"_s << u"1.55"_s << UpdateProgram;
    QTest::newRow("database too old") << u"1.0"_s << u"1.4"_s << UpdateDatabase;
    QTest::newRow("database just new enough") << u"1.0"_s << u"1.5"_s << QString();
    QTest::newRow("both fail: the first wins") << u"2.0"_s << u"1.0"_s << UpdateProgram;
    QTest::newRow("missing versions") << QString() << QString() << UpdateDatabase;
    QTest::newRow("words count as zero") << u"new"_s << u"1.7"_s << QString();
}

void TestMainConnector::versionRule()
{
    QFETCH(QString, required);
    QFETCH(QString, database);
    QFETCH(QString, expected);
    const NumberFormat australia(QLocale(QLocale::English, QLocale::Australia));
    const NumberFormat germany(QLocale(QLocale::German, QLocale::Germany));
    QCOMPARE(checkVersions(required, database, u"1.55"_s, australia), expected);
    QCOMPARE(checkVersions(required, database, u"1.55"_s, germany), expected);
}

void TestMainConnector::opensTheStandingRecordsets()
{
    QCOMPARE(connectMainDatabase(context()), QString());
    MainDatabase &database = context().mainDatabase();
    QVERIFY(database.isConnected());
    QCOMPARE(database.configRecordset().recordCount(), 4);
    QCOMPARE(database.hoursRecordset().recordCount(), 2);
    QCOMPARE(database.usersRecordset().recordCount(), 0);
    QCOMPARE(database.fieldsRecordset().recordCount(), 123);
    int perTab = 0;
    for (int tab = 1; tab <= MainDatabase::TabCount; ++tab) {
        RecordSet &records = database.tabRecordset(tab);
        QVERIFY(records.isOpen());
        perTab += records.recordCount();
        for (records.moveFirst(); !records.eof(); records.moveNext())
            QCOMPARE(records.value(u"Tab"_s).toInt(), tab);
    }
    QCOMPARE(perTab, 123);
    QVERIFY(context().periodDataSet().slot(0).isEmpty());
    QCOMPARE(m_workspace->prompter().messages().size(), 1); // "New Database" only
}

void TestMainConnector::cacheFile_data()
{
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QString>("expected");
    QTest::addColumn<QStringList>("ids");
    QTest::addColumn<QStringList>("values");

    QTest::newRow("two lines") << QByteArray("79\t1234.5\t1234.5\t0\r\n104\t\t\t1\r\n") << QString()
                               << QStringList{u"79"_s, u"104"_s}
                               << QStringList{u"1234.5"_s, QString()};
    QTest::newRow("blank lines skipped")
        << QByteArray("\r\n   \r\n79\t5\t5\t0\r\n\t\r\n\r\n") << QString() << QStringList{u"79"_s}
        << QStringList{u"5"_s};
    QTest::newRow("five fields: the first four count")
        << QByteArray("13\t-100\t100\t2\textra\r\n") << QString() << QStringList{u"13"_s}
        << QStringList{u"-100"_s};
    QTest::newRow("three fields fail the connection")
        << QByteArray("79\t5\t5\t0\r\n13\t-100\t100\r\n") << ConnectionFailed << QStringList()
        << QStringList();
    QTest::newRow("only blanks") << QByteArray("  \r\n\r\n") << QString() << QStringList()
                                 << QStringList();
    QByteArray noise(2048, 0);
    QRandomGenerator(3).fillRange(reinterpret_cast<quint32 *>(noise.data()), 2048 / 4);
    QTest::newRow("random bytes") << noise << ConnectionFailed << QStringList() << QStringList();
}

void TestMainConnector::cacheFile()
{
    QFETCH(QByteArray, content);
    QFETCH(QString, expected);
    QFETCH(QStringList, ids);
    QFETCH(QStringList, values);
    writeFile(m_workspace->appFolder() + u"data.db"_s, content);

    QCOMPARE(connectMainDatabase(context()), expected);
    const PeriodDataSet::Slot &slot = context().periodDataSet().slot(0);
    QCOMPARE(slot.fieldIds, ids);
    QCOMPARE(slot.fieldValues, values);
    if (expected != ConnectionFailed)
        return;
    const RecordingPrompter::Message &report = m_workspace->prompter().messages().last();
    QCOMPARE(report.title, u"Connection Error 1"_s);
    QVERIFY(report.text.contains(u"fewer than four fields"_s));

    // Said once: the damaged file is kept beside under another name, and the next try starts
    // with an empty slot 0.
    const QStringList kept =
        QDir(m_workspace->appFolder()).entryList({u"data.db.damaged-*"_s}, QDir::Files);
    QCOMPARE(kept.size(), 1);
    QVERIFY(report.text.contains(kept.first()));
    QFile keptFile(m_workspace->appFolder() + kept.first());
    QVERIFY(keptFile.open(QIODevice::ReadOnly));
    QCOMPARE(keptFile.readAll(), content);
    QCOMPARE(connectMainDatabase(context()), QString());
    QVERIFY(context().periodDataSet().slot(0).isEmpty());
}

void TestMainConnector::unusableDatabase_data()
{
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QString>("sql");
    QTest::addColumn<QString>("expected");
    QTest::newRow("not a database")
        << QByteArray("This is a spreadsheet, not a database.") << QString() << ConnectionFailed;
    QTest::newRow("empty file") << QByteArray("") << QString() << ConnectionFailed;
    QTest::newRow("without Fields") << QByteArray() << u"DROP TABLE Fields"_s << ConnectionFailed;
    // Another tool renamed a column: every figure, rate or login would read as empty.
    QTest::newRow("Fields.Data renamed")
        << QByteArray() << u"ALTER TABLE Fields RENAME COLUMN Data TO Account"_s
        << SchemaCheck::refusal({u"Fields.Data"_s});
    QTest::newRow("Hours.Value and Users.Fields renamed")
        << QByteArray()
        << u"ALTER TABLE Hours RENAME COLUMN Value TO Rate;"
           u"ALTER TABLE Users RENAME COLUMN Fields TO Lines"_s
        << SchemaCheck::refusal({u"Users.Fields"_s, u"Hours.Value"_s});
    QTest::newRow("a column in another case is the same column")
        << QByteArray() << u"ALTER TABLE Hours RENAME COLUMN Value TO VALUE"_s << QString();
}

void TestMainConnector::unusableDatabase()
{
    QFETCH(QByteArray, content);
    QFETCH(QString, sql);
    QFETCH(QString, expected);
    for (const QString &statement : sql.split(u';', Qt::SkipEmptyParts))
        QVERIFY(m_workspace->exec(statement));
    if (sql.isEmpty())
        writeFile(m_workspace->mainDatabase(), content);
    m_workspace->prompter().clearMessages();

    QCOMPARE(connectMainDatabase(context()), expected);
    // A damaged file is reported as the connection's error; a refused one says why itself.
    const QList<RecordingPrompter::Message> &messages = m_workspace->prompter().messages();
    QCOMPARE(messages.size(), expected == ConnectionFailed ? 1 : 0);
    if (!messages.isEmpty())
        QVERIFY(messages.first().title.startsWith(u"Connection Error "_s));
}

void TestMainConnector::lockedDatabaseFails()
{
    SqliteConnection other;
    QCOMPARE(other.open(m_workspace->mainDatabase()), std::nullopt);
    QSqlQuery lock(other.database());
    QVERIFY(lock.exec(u"BEGIN EXCLUSIVE"_s));
    m_workspace->prompter().clearMessages();

    context().mainDatabase().connection().setBusyTimeout(200);
    QCOMPARE(connectMainDatabase(context()), ConnectionFailed);
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    QCOMPARE(m_workspace->prompter().messages().first().title, u"Connection Error 5"_s);
    QVERIFY(lock.exec(u"ROLLBACK"_s));
}

void TestMainConnector::missingConfigRowIsReportedOnEveryAccess()
{
    QVERIFY(m_workspace->setConfigRow(1, u"1.55"_s));
    QVERIFY(m_workspace->exec(u"DELETE FROM Config WHERE ID = 2"_s));
    m_workspace->prompter().clearMessages();
    // A missing required version counts as empty, which no program version fails.
    QCOMPARE(connectMainDatabase(context()), QString());

    const ConfigValues config(context().mainDatabase(), m_workspace->prompter());
    QCOMPARE(config.getConfigValue(2), QString());
    QCOMPARE(config.setConfigValue(2, u"9"_s), std::nullopt);
    const QList<RecordingPrompter::Message> &messages = m_workspace->prompter().messages();
    QCOMPARE(messages.size(), 3);
    for (const RecordingPrompter::Message &message : messages) {
        QCOMPARE(
            message.text,
            u"Unable to set configuration with ID 2\r\nPlease contact the system administrator!"_s);
        QCOMPARE(message.title, u"Veltrix"_s);
        QCOMPARE(message.icon, Prompter::Icon::None);
        QCOMPARE(message.buttons, Prompter::Buttons::Ok);
    }
}

void TestMainConnector::twoProcessesWriteConfigTogether()
{
    QProcess first;
    QProcess second;
    const QString helper = QStringLiteral(VELTRIX_TEST_HELPER);
    first.start(helper, {u"write-config"_s, m_workspace->mainDatabase(), u"4"_s, u"150"_s});
    second.start(helper, {u"write-config"_s, m_workspace->mainDatabase(), u"5"_s, u"150"_s});
    QVERIFY(first.waitForFinished(120000));
    QVERIFY(second.waitForFinished(120000));
    QVERIFY2(first.exitCode() == 0, first.readAllStandardError().constData());
    QVERIFY2(second.exitCode() == 0, second.readAllStandardError().constData());

    QCOMPARE(connectMainDatabase(context()), QString());
    const ConfigValues config(context().mainDatabase(), m_workspace->prompter());
    QCOMPARE(config.getConfigValue(4), u"150"_s);
    QCOMPARE(config.getConfigValue(5), u"150"_s);
}

QTEST_GUILESS_MAIN(TestMainConnector)
#include "tst_mainconnector.moc"
