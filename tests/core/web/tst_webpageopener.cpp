// Veltrix — KPI dashboard for small businesses.
#include "common/settingsstore.h"
#include "web/webpageopener.h"

#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

class TestWebPageOpener : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void addresses_data();
    void addresses();
    void hostAndSiteAreSettings();
    void opensABareCentredWindowAndClosesTheLast();
    void browserThatCannotStartIsAnError();

private:
    QStringList argumentsOfRun(int run) const;
    static bool isRunning(qint64 pid) { return QFileInfo::exists(u"/proc/%1"_s.arg(pid)); }
    qint64 pidOfRun(int run) const { return argumentsOfRun(run).value(0).mid(4).toLongLong(); }

    QTemporaryDir m_dir;
    QString m_fakeBrowser;
};

void TestWebPageOpener::initTestCase()
{
    // Stands in for Chromium: notes its arguments and stays open like a window would.
    m_fakeBrowser = m_dir.filePath(u"fake-browser"_s);
    QFile script(m_fakeBrowser);
    QVERIFY(script.open(QIODevice::WriteOnly));
    script.write("#!/bin/sh\n"
                 "n=$(ls \"$(dirname \"$0\")\" | grep -c '^run-')\n"
                 "{ echo \"pid=$$\"; printf '%s\\n' \"$@\"; } > \"$(dirname \"$0\")/run-$n\"\n"
                 "exec sleep 60\n");
    script.close();
    QFile::setPermissions(m_fakeBrowser,
                          QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ExeOwner);
}

QStringList TestWebPageOpener::argumentsOfRun(int run) const
{
    QFile file(m_dir.filePath(u"run-%1"_s.arg(run)));
    if (!file.open(QIODevice::ReadOnly))
        return {};
    return QString::fromUtf8(file.readAll()).split(u'\n', Qt::SkipEmptyParts);
}

void TestWebPageOpener::addresses_data()
{
    QTest::addColumn<QString>("url");
    QTest::addColumn<QString>("expected");
    QTest::newRow("update from the menu")
        << WebPageOpener::updatePageUrl(u"example.com"_s, u"1.55"_s, u"1.50"_s, false)
        << u"http://example.com/vx/updates.php?appver=1.55&dbver=1.50"_s;
    QTest::newRow("update from the loading window")
        << WebPageOpener::updatePageUrl(u"example.com"_s, u"1.55"_s, QString(), true)
        << u"http://example.com/vx/mw/updates.php?appver=1.55&dbver="_s;
    QTest::newRow("coaching")
        << WebPageOpener::coachingPageUrl(u"example.com"_s, u"Smith & Sons Panels"_s)
        << u"http://example.com/vx/mw/coaching.php?site=Smith%20%26%20Sons%20Panels"_s;
}

void TestWebPageOpener::addresses()
{
    QFETCH(QString, url);
    QFETCH(QString, expected);
    QCOMPARE(url, expected);
}

void TestWebPageOpener::hostAndSiteAreSettings()
{
    SettingsStore store(m_dir.filePath(u"settings.ini"_s));
    QVERIFY(!WebPageOpener::webHost(store).isEmpty());
    store.writeSetting(u"WebHost"_s, u"intranet.local"_s);
    store.writeSetting(u"SiteName"_s, u"Acme Crash Repairs"_s);
    QCOMPARE(WebPageOpener::webHost(store), u"intranet.local"_s);
    QCOMPARE(WebPageOpener::siteName(store), u"Acme Crash Repairs"_s);
}

void TestWebPageOpener::opensABareCentredWindowAndClosesTheLast()
{
    WebPageOpener opener(m_dir.filePath(u"profile"_s));
    opener.setBrowserProgram(m_fakeBrowser);
    QCOMPARE(
        opener.openWebPage(u"http://example.com/updates"_s, {600, 400}, QRect(0, 0, 1920, 1080)),
        std::nullopt);
    QVERIFY(opener.hasWindow());
    QTRY_VERIFY(argumentsOfRun(0).contains(u"--app=http://example.com/updates"_s));
    const QStringList arguments = argumentsOfRun(0);
    QVERIFY(arguments.contains(u"--window-size=600,400"_s));
    QVERIFY(arguments.contains(u"--window-position=660,340"_s));
    QVERIFY(arguments.contains(u"--user-data-dir="_s + m_dir.filePath(u"profile"_s)));
    const qint64 updateWindow = pidOfRun(0);

    // A second page closes the first window.
    QCOMPARE(opener.openWebPage(u"http://example.com/coaching"_s, {600, 600}, QRect()),
             std::nullopt);
    QTRY_VERIFY(argumentsOfRun(1).contains(u"--app=http://example.com/coaching"_s));
    const qint64 coachingWindow = pidOfRun(1);
    QVERIFY(!isRunning(updateWindow));
    QVERIFY(isRunning(coachingWindow));
    opener.closeWindow();
    QVERIFY(!opener.hasWindow());
    QVERIFY(!isRunning(coachingWindow));
}

void TestWebPageOpener::browserThatCannotStartIsAnError()
{
    WebPageOpener opener;
    opener.setBrowserProgram(m_dir.filePath(u"no-such-browser"_s));
    const std::optional<DbError> error =
        opener.openWebPage(u"http://example.com/"_s, {600, 400}, QRect());
    QVERIFY(error);
    QVERIFY(!error->description.isEmpty());
    QVERIFY(!opener.hasWindow());
}

QTEST_GUILESS_MAIN(TestWebPageOpener)
#include "tst_webpageopener.moc"
