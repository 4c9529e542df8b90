// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/contextwiring.h"
#include "database/configvalues.h"
#include "users/loginsession.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestLoginSession : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void loginCountsAndLogoffUncounts();
    void twoCopiesCountToTwoAndBack();

private:
    QString count(TestWorkspace &workspace)
    {
        return ConfigValues(workspace.context().mainDatabase(), workspace.prompter())
            .getConfigValue(ConfigValues::UserCount);
    }
    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestLoginSession::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    QVERIFY(m_workspace->connect());
    QVERIFY(m_workspace->exec(u"INSERT INTO Users (UserName, Password, Type, Fields) "
                              u"VALUES ('bob', 'pw', 0, '1,2')"_s));
}

// The built-in account is never counted: the main window's log-in table shows it.
void TestLoginSession::loginCountsAndLogoffUncounts()
{
    LoginSession session = ContextWiring::loginSession(m_workspace->context());
    QCOMPARE(session.login(u"Bob"_s, u"pw"_s), u"1"_s);
    QCOMPARE(m_workspace->context().loginState().currentUser, u"bob"_s);
    QCOMPARE(m_workspace->context().loginState().currentUserFields, u"1,2"_s);
    session.logoff(true);
    QCOMPARE(count(*m_workspace), u"0"_s);
    QVERIFY(!m_workspace->context().loginState().loggedIn);

    // A failed log-in clears the state and counts nothing.
    QVERIFY(session.login(u"bob"_s, u"pw"_s));
    QCOMPARE(session.login(u"bob"_s, u"wrong"_s), std::nullopt);
    QVERIFY(!m_workspace->context().loginState().loggedIn);
    QCOMPARE(m_workspace->context().loginState().currentUser, QString());
    QCOMPARE(count(*m_workspace), u"1"_s);
    // A copy nobody is logged in on still takes one off a count left too high.
    QCOMPARE(ConfigValues(m_workspace->context().mainDatabase(), m_workspace->prompter())
                 .setConfigValue(ConfigValues::UserCount, u"3"_s),
             std::nullopt);
    session.logoff(true);
    QCOMPARE(count(*m_workspace), u"2"_s);
}

void TestLoginSession::twoCopiesCountToTwoAndBack()
{
    TestWorkspace other;
    other.store().writeSetting(u"DBPath"_s, m_workspace->sharedFolder());
    other.store().writeSetting(u"AccPackage"_s, u"MoneyWorks"_s);
    QVERIFY(other.connect());
    LoginSession first = ContextWiring::loginSession(m_workspace->context());
    LoginSession second = ContextWiring::loginSession(other.context());
    QCOMPARE(first.login(u"bob"_s, u"pw"_s), u"1"_s);
    QCOMPARE(second.login(u"BOB"_s, u"pw"_s), u"2"_s);
    first.logoff(true);
    second.logoff(true);
    QCOMPARE(count(*m_workspace), u"0"_s);
}

QTEST_GUILESS_MAIN(TestLoginSession)
#include "tst_loginsession.moc"
