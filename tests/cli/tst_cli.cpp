// Veltrix — KPI dashboard for small businesses.
#include "app/settings.h"
#include "cipher/passwordcipher.h"

#include <QProcess>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

struct Run
{
    int exitCode = -1;
    QString out;
    QString err;
};

Run runCli(const QStringList &arguments)
{
    QProcess process;
    process.start(QStringLiteral(VELTRIX_CLI), arguments);
    Run run;
    if (!process.waitForFinished(30000))
        return run;
    run.exitCode = process.exitCode();
    run.out = QString::fromUtf8(process.readAllStandardOutput());
    run.err = QString::fromUtf8(process.readAllStandardError());
    return run;
}

} // namespace

class TestCli : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void passwordRoundTrip_data();
    void passwordRoundTrip();
    void decryptsWhatTheProgramStores();
    void undecipherableValueFails();
    void badUsage_data();
    void badUsage();
};

void TestCli::passwordRoundTrip_data()
{
    QTest::addColumn<QString>("password");
    QTest::newRow("plain") << u"Sp@nner 7"_s;
    QTest::newRow("quote and accent") << u"O'Brien caf\u00e9"_s;
}

void TestCli::passwordRoundTrip()
{
    QFETCH(QString, password);
    const Run encrypted = runCli({u"encrypt-password"_s, password});
    QCOMPARE(encrypted.exitCode, 0);
    const QString stored = encrypted.out.trimmed();
    QVERIFY(!stored.isEmpty());
    QVERIFY(stored != password);

    const Run decrypted = runCli({u"decrypt-password"_s, stored});
    QCOMPARE(decrypted.exitCode, 0);
    QCOMPARE(decrypted.out, password + u'\n');
}

void TestCli::decryptsWhatTheProgramStores()
{
    const QString stored = PasswordCipher().encryptText(u"garage"_s, Settings::PasswordKey);
    const Run run = runCli({u"decrypt-password"_s, stored});
    QCOMPARE(run.exitCode, 0);
    QCOMPARE(run.out.trimmed(), u"garage"_s);
}

void TestCli::undecipherableValueFails()
{
    const Run run = runCli({u"decrypt-password"_s, u"typed-in-clear"_s});
    QCOMPARE(run.exitCode, 1);
    QCOMPARE(run.out, QString());
    QCOMPARE(run.err.trimmed(), u"Failed decoding the text (Error 33)"_s);
}

void TestCli::badUsage_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::newRow("no verb") << QStringList();
    QTest::newRow("unknown verb") << QStringList{u"frobnicate"_s};
    QTest::newRow("missing argument") << QStringList{u"encrypt-password"_s};
    QTest::newRow("extra argument") << QStringList{u"decrypt-password"_s, u"a"_s, u"b"_s};
}

void TestCli::badUsage()
{
    QFETCH(QStringList, arguments);
    const Run run = runCli(arguments);
    QCOMPARE(run.exitCode, 2);
    QVERIFY(run.err.contains(u"usage: veltrix-cli"_s));
}

QTEST_GUILESS_MAIN(TestCli)
#include "tst_cli.moc"
