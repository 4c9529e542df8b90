// Veltrix — KPI dashboard for small businesses.
#include "common/errorreporter.h"
#include "common/recordingprompter.h"
#include "sources/companyfilewriter.h"
#include "sources/myobsource.h"

#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

class TestMyobSource : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void connectionText();
    void sqlDates_data();
    void sqlDates();
    void accountMovement_data();
    void accountMovement();
    void tooManyJobsAreReportedNotWrapped();
    void unknownOdbcDriverFailsToOpen();

private:
    Settings settingsFor(const QString &file) const;

    QTemporaryDir m_dir;
    QString m_ledger;
};

Settings TestMyobSource::settingsFor(const QString &file) const
{
    Settings settings;
    settings.accPackage = u"MYOB"_s;
    settings.accFileDriver = u"sqlite"_s;
    settings.accFilePath = file;
    return settings;
}

void TestMyobSource::initTestCase()
{
    m_ledger = m_dir.filePath(u"ledger.myo"_s);
    CompanyFileWriter writer;
    QCOMPARE(writer.create(m_ledger), std::nullopt);
    const qint64 panel = writer.addAccount(u"4-1100"_s, u"Panel Labour"_s);
    const qint64 panelSub = writer.addAccount(u"4-1101"_s, u"Panel Labour, insurers"_s);
    const qint64 parts = writer.addAccount(u"4-1400"_s, u"Parts"_s);
    writer.addAccount(u"4-1500"_s, u"Sublet (no movements)"_s);
    const qint64 rounding = writer.addAccount(u"6-9000"_s, u"Sundry"_s);

    writer.addJournalLine(panel, QDate(2006, 6, 30), -999.0); // the day before
    writer.addJournalLine(panel, QDate(2006, 7, 1), -1000.0);
    writer.addJournalLine(panel, QDate(2006, 7, 15), -250.5);
    writer.addJournalLine(panel, QDate(2006, 7, 31), -49.5);
    writer.addJournalLine(panel, QDate(2006, 8, 1), -777.0); // the day after
    writer.addJournalLine(panelSub, QDate(2006, 7, 10), -5000.0);
    writer.addJournalLine(parts, QDate(2006, 7, 20), -300.0);
    writer.addJournalLine(parts, QDate(2006, 7, 20), 120.25);
    writer.addJournalLine(rounding, QDate(2006, 7, 3), 1234.565);

    for (int day = 1; day <= 31; ++day)
        writer.addSale(QDate(2006, 7, day), u"INV%1"_s.arg(day));
    writer.addSale(QDate(2006, 8, 1), u"INV-AUG"_s);
    QCOMPARE(writer.finish(), std::nullopt);
}

void TestMyobSource::connectionText()
{
    Settings settings;
    settings.accFileDriver = u"MYOAU0901"_s;
    settings.accFileUser = u"Administrator"_s;
    settings.accFilePass = u"pa;ss"_s;
    settings.accFilePath = u"C:\\MYOB\\Clearwater.myo"_s;
    QCOMPARE(MyobSource::connectionText(settings),
             u"Driver={MYOAU0901}; TYPE=MYOB; UID=Administrator; PWD=pa;ss; "
             u"DATABASE=C:\\MYOB\\Clearwater.myo;"_s);
}

void TestMyobSource::sqlDates_data()
{
    QTest::addColumn<QDate>("date");
    QTest::addColumn<QString>("text");
    QTest::newRow("single-digit day") << QDate(2006, 7, 1) << u"1 Jul 2006"_s;
    QTest::newRow("two-digit day") << QDate(2008, 2, 29) << u"29 Feb 2008"_s;
    QTest::newRow("December") << QDate(1999, 12, 31) << u"31 Dec 1999"_s;
}

void TestMyobSource::sqlDates()
{
    QFETCH(QDate, date);
    QFETCH(QString, text);
    QCOMPARE(MyobSource::sqlDate(date), text);
}

void TestMyobSource::accountMovement_data()
{
    QTest::addColumn<QString>("code");
    QTest::addColumn<QDate>("from");
    QTest::addColumn<QDate>("to");
    QTest::addColumn<double>("movement");
    const QDate july1(2006, 7, 1);
    const QDate july31(2006, 7, 31);
    QTest::newRow("whole month, both ends included") << u"4-1100"_s << july1 << july31 << -1300.0;
    QTest::newRow("one day") << u"4-1100"_s << july1 << july1 << -1000.0;
    QTest::newRow("wildcard takes the first account") << u"4-11%"_s << july1 << july31 << -1300.0;
    QTest::newRow("debits and credits net") << u"4-1400"_s << july1 << july31 << -179.75;
    QTest::newRow("half a cent rounds away from zero") << u"6-9000"_s << july1 << july31 << 1234.57;
    QTest::newRow("account without movements") << u"4-1500"_s << july1 << july31 << 0.0;
    QTest::newRow("no such account") << u"9-9999"_s << july1 << july31 << 0.0;
    QTest::newRow("range with nothing in it")
        << u"4-1100"_s << QDate(2007, 1, 1) << QDate(2007, 12, 31) << 0.0;
    // No code: the jobs count, as the number of sales.
    QTest::newRow("jobs in July") << QString() << july1 << july31 << 31.0;
    QTest::newRow("jobs of one day") << QString() << QDate(2006, 7, 9) << QDate(2006, 7, 9) << 1.0;
    QTest::newRow("jobs into August")
        << QString() << QDate(2006, 7, 30) << QDate(2006, 8, 31) << 3.0;
    QTest::newRow("no sales") << QString() << QDate(2007, 1, 1) << QDate(2007, 1, 31) << 0.0;
}

void TestMyobSource::accountMovement()
{
    QFETCH(QString, code);
    QFETCH(QDate, from);
    QFETCH(QDate, to);
    QFETCH(double, movement);
    RecordingPrompter prompter;
    const Settings settings = settingsFor(m_ledger);
    MyobSource source(settings, prompter);
    QVERIFY(!source.isReachable());
    QCOMPARE(source.openDataFile(), std::nullopt);
    QVERIFY(source.isReachable());
    if (code.isEmpty())
        QCOMPARE(double(source.getMYOBJobs(from, to)), movement);
    else
        QCOMPARE(source.getMYOBValue(code, from, to), movement);
    QVERIFY(prompter.messages().isEmpty());
}

void TestMyobSource::tooManyJobsAreReportedNotWrapped()
{
    const QString busy = m_dir.filePath(u"busy.myo"_s);
    CompanyFileWriter writer;
    QCOMPARE(writer.create(busy), std::nullopt);
    for (int i = 0; i < 32768; ++i)
        writer.addSale(QDate(2010, 1, 1).addDays(i % 365), u"S%1"_s.arg(i));
    QCOMPARE(writer.finish(), std::nullopt);

    RecordingPrompter prompter;
    const Settings settings = settingsFor(busy);
    MyobSource source(settings, prompter);
    QCOMPARE(source.openDataFile(), std::nullopt);
    QCOMPARE(source.getMYOBJobs(QDate(2010, 1, 1), QDate(2010, 12, 31)), qint16(0));
    QCOMPARE(prompter.messages().size(), 1);
    QVERIFY(prompter.messages().first().title.startsWith(u"GetMYOBJobs Error "_s));
    // Without the last day (89 sales) the count fits and is given.
    QCOMPARE(source.getMYOBJobs(QDate(2010, 1, 1), QDate(2010, 12, 30)), qint16(32768 - 89));
}

void TestMyobSource::unknownOdbcDriverFailsToOpen()
{
    RecordingPrompter prompter;
    Settings settings = settingsFor(m_ledger);
    settings.accFileDriver = u"NoSuchDriver"_s;
    MyobSource source(settings, prompter);
    const std::optional<DbError> error = source.openDataFile();
    QVERIFY(error);
    QVERIFY(!source.isReachable());
    // The report names the driver and where it is set; a number of 0 would show nothing.
    ErrorReporter(prompter).reportError(error->number, error->description, u"Produce"_s);
    QCOMPARE(prompter.messages().size(), 1);
    QCOMPARE(prompter.messages().first().title, u"Produce Error 3706"_s);
    QVERIFY(prompter.messages().first().text.contains(u"\"NoSuchDriver\" is not installed"_s));
    QVERIFY(prompter.messages().first().text.contains(u"AccFileDriver"_s));

    // Reading from the source that did not open is reported for each call.
    QCOMPARE(source.getMYOBValue(u"4-1100"_s, QDate(2006, 7, 1), QDate(2006, 7, 31)), 0.0);
    QCOMPARE(source.getMYOBJobs(QDate(2006, 7, 1), QDate(2006, 7, 31)), qint16(0));
    QCOMPARE(prompter.messages().size(), 3);
    QCOMPARE(prompter.messages().at(1).title, u"GetMYOBValue for Account 4-1100 Error 3704"_s);
    QCOMPARE(prompter.messages().at(2).title, u"GetMYOBJobs Error 3704"_s);
}

QTEST_GUILESS_MAIN(TestMyobSource)
#include "tst_myobsource.moc"
