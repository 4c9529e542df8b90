// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "database/configvalues.h"
#include "users/usercounter.h"
#include "users/userpoll.h"

#include <QProcess>
#include <QTest>

using namespace Qt::StringLiterals;

class TestUserCounter : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void counts_data();
    void counts();
    void pollActsOnceAndWithdrawsTheRequest_data();
    void pollActsOnceAndWithdrawsTheRequest();
    void eightCopiesLoseNoCount();

private:
    ConfigValues config()
    {
        return ConfigValues(m_workspace->context().mainDatabase(), m_workspace->prompter());
    }
    UserCounter counter() { return UserCounter(m_workspace->context().mainDatabase()); }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestUserCounter::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    QVERIFY(m_workspace->connect());
}

// Resetting the count is the main window's reset test, which reads both rows back.
void TestUserCounter::counts_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("afterLogin");
    QTest::addColumn<QString>("afterLogoff");
    QTest::newRow("none") << u"0"_s << u"1"_s << u"0"_s;
    QTest::newRow("two") << u"2"_s << u"3"_s << u"1"_s;
    QTest::newRow("negative") << u"-3"_s << u"-2"_s << u"0"_s;
    QTest::newRow("not a number") << u"many"_s << u"1"_s << u"many"_s;
}

void TestUserCounter::counts()
{
    QFETCH(QString, stored);
    QFETCH(QString, afterLogin);
    QFETCH(QString, afterLogoff);
    QCOMPARE(config().setConfigValue(4, stored), std::nullopt);
    QCOMPARE(counter().increment(), std::nullopt);
    QCOMPARE(config().getConfigValue(4), afterLogin);
    QCOMPARE(config().setConfigValue(4, stored), std::nullopt);
    QCOMPARE(counter().decrement(), std::nullopt);
    QCOMPARE(config().getConfigValue(4), afterLogoff);
}

void TestUserCounter::pollActsOnceAndWithdrawsTheRequest_data()
{
    QTest::addColumn<QString>("request");
    QTest::addColumn<UserPoll::Action>("action");
    QTest::addColumn<bool>("duringLoad");
    QTest::newRow("log off") << u"Logoff"_s << UserPoll::Action::Logoff << false;
    QTest::newRow("shut down") << u"Shutdown"_s << UserPoll::Action::Shutdown << false;
    QTest::newRow("disconnect") << u"Disconnect"_s << UserPoll::Action::Disconnect << false;
    QTest::newRow("something else") << u"Reboot"_s << UserPoll::Action::None << false;
    QTest::newRow("shut down during a load") << u"Shutdown"_s << UserPoll::Action::Shutdown << true;
}

void TestUserCounter::pollActsOnceAndWithdrawsTheRequest()
{
    QFETCH(QString, request);
    QFETCH(UserPoll::Action, action);
    QFETCH(bool, duringLoad);
    UserPoll thisCopy;
    UserPoll otherCopy;
    QCOMPARE(config().setConfigValue(4, u"3"_s), std::nullopt);
    QCOMPARE(thisCopy.tick(config()).action, UserPoll::Action::None);

    QCOMPARE(config().setConfigValue(5, request), std::nullopt);
    const UserPoll::Result first = thisCopy.tick(config(), duringLoad);
    QCOMPARE(first.activeUsers, u"3"_s);
    QCOMPARE(first.action, duringLoad ? UserPoll::Action::None : action);
    QCOMPARE(otherCopy.tick(config()).action, action);
    // The next tick finds the same request again: it is withdrawn for everybody, also while
    // this copy is loading.
    QCOMPARE(thisCopy.tick(config(), duringLoad).action, UserPoll::Action::None);
    QCOMPARE(config().getConfigValue(5), QString());
    QCOMPARE(thisCopy.lastRequest(), QString());
    // A request held back for a load is carried out by the first tick after it, once.
    if (duringLoad)
        QCOMPARE(thisCopy.tick(config()).action, action);
    QCOMPARE(thisCopy.tick(config()).action, UserPoll::Action::None);
    QCOMPARE(otherCopy.tick(config()).action, UserPoll::Action::None);
}

void TestUserCounter::eightCopiesLoseNoCount()
{
    // Eight processes on one main.db: 320 logins, then 320 logoffs, all at once.
    const QString database = m_workspace->mainDatabase();
    for (const QString &direction : {u"up"_s, u"down"_s}) {
        QList<QProcess *> copies;
        for (int i = 0; i < 8; ++i) {
            auto *copy = new QProcess(this);
            copy->start(QStringLiteral(VELTRIX_TEST_HELPER),
                        {u"count-users"_s, database, direction, u"40"_s});
            copies << copy;
        }
        for (QProcess *copy : copies) {
            QVERIFY(copy->waitForFinished(180000));
            QVERIFY2(copy->exitCode() == 0, copy->readAllStandardError().constData());
            delete copy;
        }
        QCOMPARE(config().getConfigValue(4), direction == u"up"_s ? u"320"_s : u"0"_s);
    }
}

QTEST_GUILESS_MAIN(TestUserCounter)
#include "tst_usercounter.moc"
