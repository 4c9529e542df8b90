// Veltrix — KPI dashboard for small businesses.
#include "common/settingsstore.h"

#include <QFile>
#include <QSettings>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

class TestSettingsStore : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void readRules_data();
    void readRules();
    void keysAreKeptApart();
    void fileIsPrivate();
    void seesWritesOfAnotherCopy();

private:
    QString storeFile() const { return m_dir.filePath(u"settings.ini"_s); }

    QTemporaryDir m_dir;
};

void TestSettingsStore::init()
{
    QFile::remove(storeFile());
}

void TestSettingsStore::readRules_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("defaultValue");
    QTest::addColumn<QString>("expected");

    const QString thousand = u"a"_s.repeated(1000);
    QTest::newRow("never written") << QString() << QString() << QString();
    QTest::newRow("never written, default")
        << QString() << u"/srv/veltrix/"_s << u"/srv/veltrix/"_s;
    QTest::newRow("plain") << u"MYOB"_s << QString() << u"MYOB"_s;
    QTest::newRow("spaces around") << u"  MoneyWorks  "_s << QString() << u"MoneyWorks"_s;
    QTest::newRow("tabs are not spaces") << u"\tx\t"_s << QString() << u"\tx\t"_s;
    QTest::newRow("exactly 1000 characters") << thousand << QString() << thousand;
    QTest::newRow("1000 with spaces")
        << u" "_s + u"b"_s.repeated(998) + u" "_s << QString() << u"b"_s.repeated(998);
    QTest::newRow("1001 characters with default")
        << thousand + u"a"_s << u"fallback"_s << u"fallback"_s;
    QTest::newRow("only spaces with default") << u"   "_s << u"C:\\Data"_s << u"C:\\Data"_s;
    QTest::newRow("trailing zero character") << u"abc"_s + QChar(u'\0') << QString() << u"abc"_s;
    QTest::newRow("value wins over default") << u"set"_s << u"fallback"_s << u"set"_s;
    QTest::newRow("comma kept") << u"a,b"_s << QString() << u"a,b"_s;
}

void TestSettingsStore::readRules()
{
    QFETCH(QString, stored);
    QFETCH(QString, defaultValue);
    QFETCH(QString, expected);

    SettingsStore store(storeFile());
    if (!stored.isNull())
        store.writeSetting(u"DBPath"_s, stored);
    QCOMPARE(store.readSetting(u"DBPath"_s, {}, defaultValue), expected);
    // A second store on the same file reads the same.
    QCOMPARE(SettingsStore(storeFile()).readSetting(u"DBPath"_s, {}, defaultValue), expected);
}

void TestSettingsStore::keysAreKeptApart()
{
    SettingsStore store(storeFile());
    store.writeSetting(u"AccFileUser"_s, u"Administrator"_s);
    store.writeSetting(u"frmCompareTop"_s, u"1200"_s, SettingsStore::FormsKey);
    QCOMPARE(store.readSetting(u"AccFileUser"_s, SettingsStore::DefaultKey), u"Administrator"_s);
    QCOMPARE(store.readSetting(u"frmCompareTop"_s), QString());
    QCOMPARE(store.readSetting(u"frmCompareTop"_s, SettingsStore::FormsKey), u"1200"_s);
    QCOMPARE(store.readSetting(u"Top"_s, u"SOFTWARE\\Nowhere"_s, u"7"_s), u"7"_s);
    // An empty key means the program's own.
    QSettings raw(storeFile(), QSettings::IniFormat);
    QCOMPARE(raw.value(u"SOFTWARE/Veltrix/AccFileUser"_s).toString(), u"Administrator"_s);
}

void TestSettingsStore::fileIsPrivate()
{
    SettingsStore(storeFile()).writeSetting(u"M1"_s, u"11"_s);
#ifdef Q_OS_UNIX
    // It holds the enciphered accounting password.
    QCOMPARE(QFile::permissions(storeFile()) & 0x0FFF,
             QFileDevice::ReadUser | QFileDevice::WriteUser);
#endif
}

void TestSettingsStore::seesWritesOfAnotherCopy()
{
    SettingsStore reader(storeFile());
    QCOMPARE(reader.readSetting(u"LastUser"_s), QString());
    SettingsStore(storeFile()).writeSetting(u"LastUser"_s, u"O'Brien"_s);
    QCOMPARE(reader.readSetting(u"LastUser"_s), u"O'Brien"_s);
}

QTEST_GUILESS_MAIN(TestSettingsStore)
#include "tst_settingsstore.moc"
