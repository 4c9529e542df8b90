// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "users/loginservice.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestLoginService : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void credentials_data();
    void credentials();
    void visibility_data();
    void visibility();

private:
    TestWorkspace m_workspace;
};

void TestLoginService::initTestCase()
{
    QVERIFY(m_workspace.configure());
    QVERIFY(m_workspace.connect());
    QVERIFY(m_workspace.exec(u"INSERT INTO Users (UserName, Password, Type, Fields) VALUES "
                             u"('bob', 'Secret1', 0, '1,2#13'), ('O''Brien', 'pw', 1, '#'), "
                             u"('ann_1', 'x', 0, ''), ('annA1', 'y', 0, '')"_s));
}

void TestLoginService::credentials_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("user"); // empty: refused
    QTest::addColumn<int>("type");
    QTest::newRow("built-in account") << u"sysop"_s << u"sysop"_s << u"sysop"_s << 1;
    QTest::newRow("built-in account is exact") << u"SYSOP"_s << u"sysop"_s << QString() << 0;
    QTest::newRow("name in another case") << u"Bob"_s << u"Secret1"_s << u"bob"_s << 0;
    QTest::newRow("password is exact") << u"bob"_s << u"secret1"_s << QString() << 0;
    QTest::newRow("apostrophe in the name") << u"o'brien"_s << u"pw"_s << u"O'Brien"_s << 1;
    QTest::newRow("unknown name") << u"carol"_s << u"pw"_s << QString() << 0;
    QTest::newRow("underscore is a character") << u"ann_1"_s << u"x"_s << u"ann_1"_s << 0;
    QTest::newRow("underscore matches no other") << u"ann_1"_s << u"y"_s << QString() << 0;
    QTest::newRow("percent is a character") << u"b%"_s << u"Secret1"_s << QString() << 0;
    QTest::newRow("backslash is a character") << u"bo\\b"_s << u"Secret1"_s << QString() << 0;
}

void TestLoginService::credentials()
{
    QFETCH(QString, name);
    QFETCH(QString, password);
    QFETCH(QString, user);
    QFETCH(int, type);
    const auto login =
        LoginService::checkCredentials(m_workspace.context().mainDatabase(), name, password);
    QCOMPARE(login.has_value(), !user.isEmpty());
    if (login) {
        QCOMPARE(login->currentUser, user);
        QCOMPARE(login->currentUserType, type);
        QVERIFY(login->loggedIn);
    }
}

void TestLoginService::visibility_data()
{
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("fields");
    QTest::addColumn<qint64>("id");
    QTest::addColumn<int>("type");
    QTest::addColumn<bool>("visible");
    QTest::newRow("listed in the first group") << u"bob"_s << u"1,2#13"_s << qint64(2) << 3 << true;
    QTest::newRow("listed in the second group")
        << u"bob"_s << u"1,2#13"_s << qint64(13) << 2 << true;
    QTest::newRow("not listed") << u"bob"_s << u"1,2#13"_s << qint64(3) << 3 << false;
    QTest::newRow("part of another ID") << u"bob"_s << u"13"_s << qint64(1) << 3 << false;
    QTest::newRow("nothing allowed") << u"bob"_s << u"#"_s << qint64(1) << 3 << false;
    QTest::newRow("headings always") << u"bob"_s << u"#"_s << qint64(9) << 1 << true;
    QTest::newRow("built-in sees all") << u"SysOp"_s << QString() << qint64(5) << 3 << true;
}

void TestLoginService::visibility()
{
    QFETCH(QString, user);
    QFETCH(QString, fields);
    QFETCH(qint64, id);
    QFETCH(int, type);
    QFETCH(bool, visible);
    const LoginState login{true, user, 0, fields};
    QCOMPARE(LoginService::maySee(login, id, type), visible);
}

QTEST_GUILESS_MAIN(TestLoginService)
#include "tst_loginservice.moc"
