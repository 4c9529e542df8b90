// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/systemconfiguration.h"

#include <QTest>

using namespace Qt::StringLiterals;

namespace {
const auto FolderMissing = u"The remote path you specified does not exist or is inacessible!"_s;
const auto FileMissing =
    u"The account data file path you specified does not exist or is inacessible!"_s;
const auto FileNotGiven = u"You must specify the path to the MYOB data file!"_s;
const auto DriverNotGiven = u"You must specify the MYOB database driver!"_s;
} // namespace

class TestSystemConfiguration : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void checksInOrder_data();
    void checksInOrder();
    void savesEverythingWithThePasswordEnciphered();
};

void TestSystemConfiguration::checksInOrder_data()
{
    QTest::addColumn<QString>("dbPath"); // "<shared>" stands for an existing folder
    QTest::addColumn<QString>("package");
    QTest::addColumn<QString>("file"); // "<file>" stands for an existing file
    QTest::addColumn<QString>("driver");
    QTest::addColumn<QString>("message");
    QTest::addColumn<QString>("title");

    QTest::newRow("missing folder first") << u"/no/such/folder"_s << u"MYOB"_s << QString()
                                          << QString() << FolderMissing << u"Invalid Folder Path"_s;
    QTest::newRow("MYOB without file") << u"<shared>"_s << u"MYOB"_s << QString() << QString()
                                       << FileNotGiven << u"MYOB Data File Path Not Specified"_s;
    QTest::newRow("MYOB, missing file, no driver")
        << u"<shared>"_s << u"MYOB"_s << u"/no/file.myo"_s << QString() << DriverNotGiven
        << u"MYOB ODBC Driver Not Specified"_s;
    QTest::newRow("MYOB, missing file, driver")
        << u"<shared>"_s << u"MYOB"_s << u"/no/file.myo"_s << u"MYOAU0901"_s << FileMissing
        << u"Invalid File Path"_s;
    QTest::newRow("MoneyWorks, missing file")
        << u"<shared>"_s << u"MoneyWorks"_s << u"/no/Acme.mwd5"_s << QString() << FileMissing
        << u"Invalid File Path"_s;
    QTest::newRow("MoneyWorks server address, not a file")
        << u"<shared>"_s << u"MoneyWorks"_s << u"http://127.0.0.1:6710/Acme.moneyworks"_s
        << QString() << QString() << QString();
    QTest::newRow("MoneyWorks with nothing else")
        << u"<shared>"_s << u"MoneyWorks"_s << QString() << QString() << QString() << QString();
    // Start-up then asks for the package: the settings loader's lower-case row.
    QTest::newRow("unknown package written back as it was")
        << u"<shared>"_s << u"myob"_s << QString() << QString() << QString() << QString();
    QTest::newRow("MYOB complete")
        << u"<shared>"_s << u"MYOB"_s << u"<file>"_s << u"SQLite"_s << QString() << QString();
}

void TestSystemConfiguration::checksInOrder()
{
    QFETCH(QString, dbPath);
    QFETCH(QString, package);
    QFETCH(QString, file);
    QFETCH(QString, driver);
    QFETCH(QString, message);
    QFETCH(QString, title);

    TestWorkspace workspace;
    QFile(workspace.path(u"company.myo"_s)).open(QIODevice::WriteOnly);
    dbPath.replace(u"<shared>"_s, workspace.sharedFolder());
    file.replace(u"<file>"_s, workspace.path(u"company.myo"_s));

    SystemConfiguration configuration(workspace.store(), workspace.prompter());
    SystemConfiguration::Values values{dbPath, package, file, driver, u"Admin"_s, u"pw"_s};
    QCOMPARE(configuration.save(values), message.isEmpty());
    if (message.isEmpty()) {
        QVERIFY(workspace.prompter().messages().isEmpty());
        QCOMPARE(workspace.store().readSetting(u"AccPackage"_s), package);
        QCOMPARE(workspace.store().readSetting(u"DBPath"_s), dbPath); // its slash is kept
        return;
    }
    QCOMPARE(workspace.prompter().messages().size(), 1);
    QCOMPARE(workspace.prompter().messages().first().text, message);
    QCOMPARE(workspace.prompter().messages().first().title, title);
    QCOMPARE(workspace.prompter().messages().first().icon, Prompter::Icon::Exclamation);
    // Nothing is written until every check passes.
    QCOMPARE(workspace.store().readSetting(u"DBPath"_s), QString());
    QCOMPARE(workspace.store().readSetting(u"AccPackage"_s), QString());
}

void TestSystemConfiguration::savesEverythingWithThePasswordEnciphered()
{
    TestWorkspace workspace;
    QFile(workspace.path(u"company.myo"_s)).open(QIODevice::WriteOnly);
    SystemConfiguration configuration(workspace.store(), workspace.prompter());
    const QString folder = workspace.sharedFolder().chopped(1);
    SystemConfiguration::Values values{folder,      u"MYOB"_s,  workspace.path(u"company.myo"_s),
                                       u"SQLite"_s, u"Admin"_s, u"Zło?ty"_s};
    // A password outside the Western European code page is refused, and nothing is written.
    QVERIFY(!configuration.save(values));
    QCOMPARE(workspace.prompter().messages().value(0).title, u"Invalid Password"_s);
    QVERIFY(workspace.prompter().messages().value(0).text.contains(u"\"ł\""_s));
    QCOMPARE(workspace.store().readSetting(u"AccPackage"_s), QString());

    values.password = u"Sp@nner Grüße €5"_s; // the code page holds these
    QVERIFY(configuration.save(values));
    QCOMPARE(values.dbPath, folder + QDir::separator());
    SettingsStore &store = workspace.store();
    QCOMPARE(store.readSetting(u"DBPath"_s), folder + QDir::separator());
    QCOMPARE(store.readSetting(u"AccFileDriver"_s), u"SQLite"_s);
    QCOMPARE(store.readSetting(u"AccFileUser"_s), u"Admin"_s);
    const QString stored = store.readSetting(u"AccFilePass"_s);
    QVERIFY(!stored.isEmpty());
    QVERIFY(!stored.contains(u"Sp@nner"_s));

    const SystemConfiguration::Values back = configuration.load();
    QCOMPARE(back.password, u"Sp@nner Grüße €5"_s);
    QCOMPARE(back.accFilePath, workspace.path(u"company.myo"_s));
    // Start-up reads such a value back: the settings loader's password table.
}

QTEST_GUILESS_MAIN(TestSystemConfiguration)
#include "tst_systemconfiguration.moc"
