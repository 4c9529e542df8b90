// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "cipher/passwordcipher.h"

#include <QTest>

using namespace Qt::StringLiterals;

namespace {

const auto ConfigureDatabasePath = u"The database path must be configured!"_s;
const auto SpecifyPackage = u"Your accounting package must be specified!"_s;
const auto SpecifyDriver = u"The MYOB database driver must be specified!"_s;
const auto DatabaseMissing = u"The main database file is missing or inaccessible!"_s;

void touch(const QString &path, const QByteArray &content = "template")
{
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(content);
}

} // namespace

class TestSettingsLoader : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void checksInOrder_data();
    void checksInOrder();
    void derivesProgramPaths();
    void createsMainDatabaseFromTemplateOnce();
    void templateFoundInLaterCandidate();
    void deciphersThePassword_data();
    void deciphersThePassword();

private:
    // Another context on the same program folder and settings file.
    std::unique_ptr<AppContext> otherContext(AppLocations locations)
    {
        return std::make_unique<AppContext>(
            std::make_unique<SettingsStore>(m_workspace->path(u"settings.ini"_s)),
            m_workspace->prompter(), std::move(locations));
    }
    SettingsStore &store() { return m_workspace->store(); }
    AppContext &context() { return m_workspace->context(); }
    QString appFolder() const { return m_workspace->appFolder(); }
    QString dataFolder() const { return m_workspace->sharedFolder(); }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestSettingsLoader::init()
{
    m_workspace =
        std::make_unique<TestWorkspace>(Clock::fixedAt(QDateTime(QDate(2031, 1, 1), QTime(0, 0))));
}

void TestSettingsLoader::checksInOrder_data()
{
    QTest::addColumn<QString>("dbPath"); // "<shared>": an existing folder; "<file>": a file
    QTest::addColumn<QString>("package");
    QTest::addColumn<QString>("driver");
    QTest::addColumn<QString>("database"); // main.db in the folder, new.db beside the program
    QTest::addColumn<QString>("expected");

    // An empty store is the start-up test's fresh install.
    QTest::newRow("missing folder before anything else")
        << u"/no/such/folder"_s << QString() << QString() << u"main.db"_s << ConfigureDatabasePath;
    QTest::newRow("package in lower case")
        << u"<shared>"_s << u"myob"_s << u"MYOAU0901"_s << u"main.db"_s << SpecifyPackage;
    QTest::newRow("unknown package")
        << u"<shared>"_s << u"QuickBooks"_s << QString() << u"main.db"_s << SpecifyPackage;
    QTest::newRow("MYOB without driver")
        << u"<shared>"_s << u"MYOB"_s << QString() << u"main.db"_s << SpecifyDriver;
    QTest::newRow("MoneyWorks without driver")
        << u"<shared>"_s << u"MoneyWorks"_s << QString() << u"main.db"_s << QString();
    QTest::newRow("MYOB with driver")
        << u"<shared>"_s << u"MYOB"_s << u"SQLite"_s << u"main.db"_s << QString();
    QTest::newRow("settings fine, no database, no template")
        << u"<shared>"_s << u"MYOB"_s << u"MYOAU0901"_s << QString() << DatabaseMissing;
    QTest::newRow("default path is the program folder")
        << QString() << u"MoneyWorks"_s << QString() << QString() << DatabaseMissing;
    QTest::newRow("path too long to hold is not replaced by the default")
        << u"/"_s + QString(1000, u'x') << u"MoneyWorks"_s << QString() << QString()
        << DatabasePathTooLong;
    // Nothing can be created under a file, even by root: no copy of the template, no message.
    QTest::newRow("a file where the folder should be")
        << u"<file>"_s << u"MoneyWorks"_s << QString() << u"new.db"_s << DatabaseMissing;
}

void TestSettingsLoader::checksInOrder()
{
    QFETCH(QString, dbPath);
    QFETCH(QString, package);
    QFETCH(QString, driver);
    QFETCH(QString, database);
    QFETCH(QString, expected);

    touch(m_workspace->path(u"plain-file"_s));
    dbPath.replace(u"<shared>"_s, dataFolder())
        .replace(u"<file>"_s, m_workspace->path(u"plain-file"_s));
    store().writeSetting(u"DBPath"_s, dbPath);
    store().writeSetting(u"AccPackage"_s, package);
    store().writeSetting(u"AccFileDriver"_s, driver);
    if (!database.isEmpty())
        touch((database == u"main.db"_s ? dataFolder() : appFolder()) + database);

    QCOMPARE(loadSettings(context()), expected);
    QVERIFY(m_workspace->prompter().messages().isEmpty());
}

void TestSettingsLoader::derivesProgramPaths()
{
    loadSettings(context());
    const Settings &settings = context().settings();
    QCOMPARE(settings.appFolder, appFolder());
    QCOMPARE(settings.newDatabaseFile, appFolder() + u"new.db"_s);
    QCOMPARE(settings.cacheFile, appFolder() + u"data.db"_s);
    QCOMPARE(settings.tempFolder, appFolder() + u"temp"_s + QDir::separator());
    QCOMPARE(settings.tempHtmlFile, settings.tempFolder + u"tmp.html"_s);
    QCOMPARE(settings.tempGifFile, settings.tempFolder + u"tmp.gif"_s);
    QCOMPARE(settings.tempBmpFile, settings.tempFolder + u"tmp.bmp"_s);
    QCOMPARE(settings.jobsFile, appFolder() + u"jobs.inf"_s);
    // The temporary folder is made on start.
    QVERIFY(QFileInfo(settings.tempFolder).isDir());

    // A second copy on the same folder while this one runs (a lock is held per process, so a
    // second holder here stands for a second process), and any command-line run, keep their
    // working files apart from it and from each other, until the first lets go.
    AppLocations commandLine = AppLocations::inFolder(appFolder());
    commandLine.privateWorkingFiles = true;
    QStringList jobsFiles{settings.jobsFile};
    for (auto &other :
         {otherContext(AppLocations::inFolder(appFolder())), otherContext(commandLine)}) {
        loadSettings(*other);
        QVERIFY(!jobsFiles.contains(other->settings().jobsFile));
        QVERIFY(!other->settings().tempFolder.startsWith(appFolder()));
        QVERIFY(QFileInfo(other->settings().tempFolder).isDir());
        jobsFiles << other->settings().jobsFile;
    }
    context().workingFolder().release();
    auto next = otherContext(AppLocations::inFolder(appFolder()));
    loadSettings(*next);
    QCOMPARE(next->settings().jobsFile, settings.jobsFile);
}

void TestSettingsLoader::createsMainDatabaseFromTemplateOnce()
{
    QVERIFY(m_workspace->configure());
    QCOMPARE(loadSettings(context()), QString());
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    const RecordingPrompter::Message &shown = m_workspace->prompter().messages().first();
    QCOMPARE(shown.text, u"A new database file has been created!"_s);
    QCOMPARE(shown.title, u"New Database"_s);
    QCOMPARE(shown.icon, Prompter::Icon::Information);
    QFile created(m_workspace->mainDatabase());
    QFile original(QStringLiteral(VELTRIX_NEW_DB));
    QVERIFY(created.open(QIODevice::ReadOnly) && original.open(QIODevice::ReadOnly));
    QCOMPARE(created.readAll(), original.readAll());

    // The second start finds the database and says nothing.
    QCOMPARE(loadSettings(*otherContext(AppLocations::inFolder(appFolder()))), QString());
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
}

void TestSettingsLoader::templateFoundInLaterCandidate()
{
    const QString installed = m_workspace->path(u"new.db"_s);
    touch(installed);
    AppLocations locations = AppLocations::inFolder(appFolder());
    locations.newDatabaseCandidates << installed;
    const auto other = otherContext(locations);
    store().writeSetting(u"AccPackage"_s, u"MoneyWorks"_s);

    QCOMPARE(loadSettings(*other), QString());
    QCOMPARE(other->settings().newDatabaseFile, installed);
    QVERIFY(QFileInfo::exists(appFolder() + u"main.db"_s));
}

void TestSettingsLoader::deciphersThePassword_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("expected");
    const QString enciphered = PasswordCipher().encryptText(u"Sp@nner 7"_s, Settings::PasswordKey);
    QTest::newRow("enciphered") << enciphered << u"Sp@nner 7"_s;
    QTest::newRow("typed in clear") << u"plainpass"_s << u"plainpass"_s;
}

void TestSettingsLoader::deciphersThePassword()
{
    QFETCH(QString, stored);
    QFETCH(QString, expected);
    QVERIFY(m_workspace->configure());
    context().setPlatformScrollBarHeight(21);
    store().writeSetting(u"DBPath"_s, u"  "_s + dataFolder().chopped(1) + u"  "_s); // trimmed
    store().writeSetting(u"AccFilePath"_s, u"/books/Acme.moneyworks"_s);
    store().writeSetting(u"AccFileUser"_s, u"Admin"_s);
    store().writeSetting(u"AccFilePass"_s, stored);

    QCOMPARE(loadSettings(context()), QString());
    const Settings &settings = context().settings();
    QCOMPARE(settings.accFilePass, expected);
    QCOMPARE(settings.accFilePath, u"/books/Acme.moneyworks"_s);
    QCOMPARE(settings.accFileUser, u"Admin"_s);
    QCOMPARE(settings.mainDatabaseFile, dataFolder().chopped(1) + QDir::separator() + u"main.db"_s);
    QCOMPARE(settings.currentYear, 2031);
    QCOMPARE(settings.scrollBarHeight, qint16(21));
}

QTEST_GUILESS_MAIN(TestSettingsLoader)
#include "tst_settingsloader.moc"
