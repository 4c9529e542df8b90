// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/shutdown.h"
#include "app/startupsequence.h"
#include "common/version.h"
#include "database/configvalues.h"
#include "engine/cachefile.h"
#include "sources/accountingsource.h"

#include <QSqlQuery>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

class CountingSource : public AccountingSource
{
public:
    explicit CountingSource(int &disconnects)
        : m_disconnects(disconnects)
    {}
    void disconnect() override { ++m_disconnects; }
    bool isReachable() override { return true; }
    std::optional<DbError> openDataFile() override { return std::nullopt; }
    double accountMovement(const QString &, const QDate &, const QDate &) override { return 0; }
    qint16 jobsCount(const QDate &, const QDate &) override { return 0; }

private:
    int &m_disconnects;
};

// A workspace started up as the program does.
std::unique_ptr<TestWorkspace> startedWorkspace()
{
    auto workspace = std::make_unique<TestWorkspace>();
    if (!workspace->configure() || runStartupSequence(workspace->context()).failed)
        return nullptr;
    return workspace;
}

} // namespace

class TestStartupShutdown : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void appVersion_data();
    void appVersion();
    void outcomes_data();
    void outcomes();
    void shutDownKeepsSlotZeroForTheNextStart();
    void shutDownLogsOffOnlyALoggedInUser();
};

void TestStartupShutdown::appVersion_data()
{
    QTest::addColumn<int>("major");
    QTest::addColumn<int>("minor");
    QTest::addColumn<int>("revision");
    QTest::addColumn<QString>("expected");
    QTest::newRow("1.5.5") << 1 << 5 << 5 << u"1.55"_s;
    QTest::newRow("1.1.12") << 1 << 1 << 12 << u"1.11"_s;
}

void TestStartupShutdown::appVersion()
{
    QFETCH(int, major);
    QFETCH(int, minor);
    QFETCH(int, revision);
    QFETCH(QString, expected);
    QCOMPARE(AppInfo::appVersionFrom(major, minor, revision), expected);
}

void TestStartupShutdown::outcomes_data()
{
    QTest::addColumn<bool>("configure");
    QTest::addColumn<int>("configRow");
    QTest::addColumn<QString>("version");
    QTest::addColumn<QString>("message");
    QTest::addColumn<bool>("updateNeeded");
    QTest::newRow("fresh install")
        << false << 0 << QString() << u"Your accounting package must be specified!"_s << false;
    QTest::newRow("all well") << true << 0 << QString() << QString() << false;
    QTest::newRow("program too old")
        << true << 2 << u"9.99"_s << u"You must update Veltrix to work with the new database!"_s
        << true;
    QTest::newRow("database too old")
        << true << 1 << u"1.0"_s
        << u"You must update the database to work with this version of Veltrix!"_s << true;
}

void TestStartupShutdown::outcomes()
{
    QFETCH(bool, configure);
    QFETCH(int, configRow);
    QFETCH(QString, version);
    QFETCH(QString, message);
    QFETCH(bool, updateNeeded);
    TestWorkspace workspace;
    if (configure)
        QVERIFY(workspace.configure());
    if (configRow != 0)
        QVERIFY(workspace.setConfigRow(configRow, version));
    const StartupOutcome outcome = runStartupSequence(workspace.context());
    QCOMPARE(outcome.message, message);
    QCOMPARE(outcome.failed, !message.isEmpty());
    QCOMPARE(outcome.updateNeeded, updateNeeded);
    QCOMPARE(workspace.context().mainDatabase().isConnected(), message.isEmpty());
}

void TestStartupShutdown::shutDownKeepsSlotZeroForTheNextStart()
{
    const auto workspace = startedWorkspace();
    QVERIFY(workspace);
    AppContext &context = workspace->context();
    int disconnects = 0;
    context.setAccountingSource(std::make_unique<CountingSource>(disconnects));
    PeriodDataSet &data = context.periodDataSet();
    data.storeFieldValue(79, 1500.0, 0);
    data.setCurrentSlot(3); // the comparison window left another slot current
    data.storeFieldValue(79, 99.0, 0);
    QFile(context.settings().tempFolder + u"tmp.html"_s).open(QIODevice::WriteOnly);

    shutDown(context);

    PeriodDataSet::Slot written;
    QCOMPARE(CacheFile::read(context.settings().cacheFile, written), std::nullopt);
    QCOMPARE(written.fieldIds, QStringList{u"79"_s});
    QCOMPARE(written.fieldValues, QStringList{u"1500"_s});
    QVERIFY(!context.mainDatabase().isConnected());
    QCOMPARE(disconnects, 1);
    QVERIFY(!QFileInfo::exists(context.settings().tempFolder));

    // The next start reads it back (types and signs survive: the cache file's own test).
    data.slot(0) = PeriodDataSet::Slot();
    data.setCurrentSlot(0);
    QVERIFY(!runStartupSequence(context).failed);
    QCOMPARE(data.getFieldValue(79), 1500.0);
}

void TestStartupShutdown::shutDownLogsOffOnlyALoggedInUser()
{
    for (const bool loggedIn : {false, true}) {
        const auto workspace = startedWorkspace();
        QVERIFY(workspace);
        AppContext &context = workspace->context();
        const ConfigValues config(context.mainDatabase(), workspace->prompter());
        QCOMPARE(config.setConfigValue(ConfigValues::UserCount, u"2"_s), std::nullopt);
        context.loginState() = LoginState{loggedIn, u"bob"_s, 0, QString()};
        shutDown(context);
        // With nothing in slot 0, no cache file is written.
        QVERIFY(!QFileInfo::exists(context.settings().cacheFile));
        QVERIFY(runStartupSequence(context).message.isEmpty());
        QCOMPARE(config.getConfigValue(ConfigValues::UserCount), loggedIn ? u"1"_s : u"2"_s);
    }
}

QTEST_GUILESS_MAIN(TestStartupShutdown)
#include "tst_startupshutdown.moc"
