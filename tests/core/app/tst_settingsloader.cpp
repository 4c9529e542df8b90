// Veltrix — KPI dashboard for small businesses.
#include "app/appcontext.h"
#include "app/settingsloader.h"
#include "cipher/passwordcipher.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
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
    void cleanup();
    void checksInOrder_data();
    void checksInOrder();
    void derivesProgramPaths();
    void createsMainDatabaseFromTemplateOnce();
    void templateFoundInLaterCandidate();
    void unwritableDatabaseFolderShowsNoMessage();
    void deciphersThePassword_data();
    void deciphersThePassword();

private:
    std::unique_ptr<AppContext>
    makeContext(Clock clock = Clock::fixedAt(QDateTime(QDate(2026, 12, 6), QTime(9, 0))));
    SettingsStore &store() { return m_context->settingsStore(); }
    QString appFolder() const { return m_root->filePath(u"app"_s) + u'/'; }
    QString dataFolder() const { return m_root->filePath(u"shared"_s); }

    std::unique_ptr<QTemporaryDir> m_root;
    RecordingPrompter m_prompter;
    std::unique_ptr<AppContext> m_context;
};

std::unique_ptr<AppContext> TestSettingsLoader::makeContext(Clock clock)
{
    return std::make_unique<AppContext>(
        std::make_unique<SettingsStore>(m_root->filePath(u"settings.ini"_s)), m_prompter,
        AppLocations::inFolder(appFolder()), std::move(clock));
}

void TestSettingsLoader::init()
{
    m_root = std::make_unique<QTemporaryDir>();
    QVERIFY(QDir(m_root->path()).mkpath(u"shared"_s));
    m_prompter.clearMessages();
    m_context = makeContext();
}

void TestSettingsLoader::cleanup()
{
    m_context.reset();
    m_root.reset();
}

void TestSettingsLoader::checksInOrder_data()
{
    QTest::addColumn<QString>("dbPath"); // "<shared>" stands for an existing folder
    QTest::addColumn<QString>("package");
    QTest::addColumn<QString>("driver");
    QTest::addColumn<bool>("mainDatabaseExists");
    QTest::addColumn<QString>("expected");

    QTest::newRow("empty store") << QString() << QString() << QString() << false << SpecifyPackage;
    QTest::newRow("missing folder before anything else")
        << u"/no/such/folder"_s << QString() << QString() << true << ConfigureDatabasePath;
    QTest::newRow("package in lower case")
        << u"<shared>"_s << u"myob"_s << u"MYOAU0901"_s << true << SpecifyPackage;
    QTest::newRow("unknown package")
        << u"<shared>"_s << u"QuickBooks"_s << QString() << true << SpecifyPackage;
    QTest::newRow("MYOB without driver")
        << u"<shared>"_s << u"MYOB"_s << QString() << true << SpecifyDriver;
    QTest::newRow("MoneyWorks without driver")
        << u"<shared>"_s << u"MoneyWorks"_s << QString() << true << QString();
    QTest::newRow("MYOB with driver")
        << u"<shared>"_s << u"MYOB"_s << u"SQLite"_s << true << QString();
    QTest::newRow("settings fine, no database, no template")
        << u"<shared>"_s << u"MYOB"_s << u"MYOAU0901"_s << false << DatabaseMissing;
    QTest::newRow("default path is the program folder")
        << QString() << u"MoneyWorks"_s << QString() << false << DatabaseMissing;
    QTest::newRow("path too long to hold is not replaced by the default")
        << u"/"_s + QString(1000, u'x') << u"MoneyWorks"_s << QString() << false
        << DatabasePathTooLong;
}

void TestSettingsLoader::checksInOrder()
{
    QFETCH(QString, dbPath);
    QFETCH(QString, package);
    QFETCH(QString, driver);
    QFETCH(bool, mainDatabaseExists);
    QFETCH(QString, expected);

    dbPath.replace(u"<shared>"_s, dataFolder());
    store().writeSetting(u"DBPath"_s, dbPath);
    store().writeSetting(u"AccPackage"_s, package);
    store().writeSetting(u"AccFileDriver"_s, driver);
    if (mainDatabaseExists)
        touch(dataFolder() + u"/main.db"_s);

    QCOMPARE(loadSettings(*m_context), expected);
    QVERIFY(m_prompter.messages().isEmpty());
}

void TestSettingsLoader::derivesProgramPaths()
{
    loadSettings(*m_context);
    const Settings &settings = m_context->settings();
    const QString sep = QDir::separator();
    QCOMPARE(settings.appFolder, appFolder());
    QCOMPARE(settings.newDatabaseFile, appFolder() + u"new.db"_s);
    QCOMPARE(settings.cacheFile, appFolder() + u"data.db"_s);
    QCOMPARE(settings.tempFolder, appFolder() + u"temp"_s + sep);
    QCOMPARE(settings.tempHtmlFile, settings.tempFolder + u"tmp.html"_s);
    QCOMPARE(settings.tempGifFile, settings.tempFolder + u"tmp.gif"_s);
    QCOMPARE(settings.tempBmpFile, settings.tempFolder + u"tmp.bmp"_s);
    QCOMPARE(settings.jobsFile, appFolder() + u"jobs.inf"_s);
    // The program folder is made on first start, and the temporary folder in it.
    QVERIFY(QFileInfo(settings.tempFolder).isDir());

    // A second copy on the same folder while this one runs (a lock is held per process, so a
    // second holder here stands for a second process), and any command-line run, keep their
    // working files apart from it and from each other, until the first lets go.
    auto second = makeContext();
    AppLocations commandLine = AppLocations::inFolder(appFolder());
    commandLine.privateWorkingFiles = true;
    AppContext headless(std::make_unique<SettingsStore>(m_root->filePath(u"settings.ini"_s)),
                        m_prompter, commandLine);
    QStringList jobsFiles{settings.jobsFile};
    for (AppContext *other : {second.get(), &headless}) {
        loadSettings(*other);
        QVERIFY(!jobsFiles.contains(other->settings().jobsFile));
        QVERIFY(!other->settings().tempFolder.startsWith(appFolder()));
        QVERIFY(QFileInfo(other->settings().tempFolder).isDir());
        jobsFiles << other->settings().jobsFile;
    }
    m_context->workingFolder().release();
    auto next = makeContext();
    loadSettings(*next);
    QCOMPARE(next->settings().jobsFile, settings.jobsFile);
}

void TestSettingsLoader::createsMainDatabaseFromTemplateOnce()
{
    QVERIFY(QDir().mkpath(appFolder()));
    touch(appFolder() + u"new.db"_s, "empty database");
    store().writeSetting(u"DBPath"_s, dataFolder());
    store().writeSetting(u"AccPackage"_s, u"MoneyWorks"_s);

    QCOMPARE(loadSettings(*m_context), QString());
    QCOMPARE(m_prompter.messages().size(), 1);
    const RecordingPrompter::Message &shown = m_prompter.messages().first();
    QCOMPARE(shown.text, u"A new database file has been created!"_s);
    QCOMPARE(shown.title, u"New Database"_s);
    QCOMPARE(shown.icon, Prompter::Icon::Information);
    QFile created(dataFolder() + u"/main.db"_s);
    QVERIFY(created.open(QIODevice::ReadOnly));
    QCOMPARE(created.readAll(), QByteArray("empty database"));

    // The second start finds the database and says nothing.
    m_context = makeContext();
    QCOMPARE(loadSettings(*m_context), QString());
    QCOMPARE(m_prompter.messages().size(), 1);
}

void TestSettingsLoader::templateFoundInLaterCandidate()
{
    const QString installed = m_root->filePath(u"share"_s);
    QVERIFY(QDir().mkpath(installed));
    touch(installed + u"/new.db"_s);
    AppLocations locations = AppLocations::inFolder(appFolder());
    locations.newDatabaseCandidates << installed + u"/new.db"_s;
    AppContext context(std::make_unique<SettingsStore>(m_root->filePath(u"settings.ini"_s)),
                       m_prompter, locations);
    context.settingsStore().writeSetting(u"AccPackage"_s, u"MoneyWorks"_s);

    QCOMPARE(loadSettings(context), QString());
    QCOMPARE(context.settings().newDatabaseFile, installed + u"/new.db"_s);
    QVERIFY(QFileInfo::exists(appFolder() + u"main.db"_s));
}

void TestSettingsLoader::unwritableDatabaseFolderShowsNoMessage()
{
    QVERIFY(QDir().mkpath(appFolder()));
    touch(appFolder() + u"new.db"_s);
    // A file where the folder should be: nothing can be created under it, even by root.
    const QString notAFolder = m_root->filePath(u"plain-file"_s);
    touch(notAFolder);
    store().writeSetting(u"DBPath"_s, notAFolder);
    store().writeSetting(u"AccPackage"_s, u"MoneyWorks"_s);

    QCOMPARE(loadSettings(*m_context), DatabaseMissing);
    QVERIFY(m_prompter.messages().isEmpty());
}

void TestSettingsLoader::deciphersThePassword_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("expected");
    const QString enciphered = PasswordCipher().encryptText(u"Sp@nner 7"_s, Settings::PasswordKey);
    QTest::newRow("enciphered") << enciphered << u"Sp@nner 7"_s;
    QTest::newRow("typed in clear") << u"plainpass"_s << u"plainpass"_s;
    QTest::newRow("empty") << QString() << QString();
}

void TestSettingsLoader::deciphersThePassword()
{
    QFETCH(QString, stored);
    QFETCH(QString, expected);
    touch(dataFolder() + u"/main.db"_s);
    m_context = makeContext(Clock::fixedAt(QDateTime(QDate(2031, 1, 1), QTime(0, 0))));
    m_context->setPlatformScrollBarHeight(21);
    store().writeSetting(u"DBPath"_s, u"  "_s + dataFolder() + u"  "_s); // trimmed
    store().writeSetting(u"AccPackage"_s, u"MoneyWorks"_s);
    store().writeSetting(u"AccFilePath"_s, u"/books/Acme.moneyworks"_s);
    store().writeSetting(u"AccFileUser"_s, u"Admin"_s);
    store().writeSetting(u"AccFilePass"_s, stored);

    QCOMPARE(loadSettings(*m_context), QString());
    const Settings &settings = m_context->settings();
    QCOMPARE(settings.accFilePass, expected);
    QCOMPARE(settings.accFilePath, u"/books/Acme.moneyworks"_s);
    QCOMPARE(settings.accFileUser, u"Admin"_s);
    QCOMPARE(settings.mainDatabaseFile, dataFolder() + QDir::separator() + u"main.db"_s);
    QCOMPARE(settings.currentYear, 2031);
    QCOMPARE(settings.scrollBarHeight, qint16(21));
}

QTEST_GUILESS_MAIN(TestSettingsLoader)
#include "tst_settingsloader.moc"
