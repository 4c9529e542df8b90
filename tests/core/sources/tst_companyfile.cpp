// Veltrix — KPI dashboard for small businesses.
#include "database/sqliteconnection.h"
#include "sources/companyfile.h"
#include "sources/companyfilewriter.h"

#include <QSqlQuery>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

class TestCompanyFile : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void dateKeys_data();
    void dateKeys();
    void collationOrder_data();
    void collationOrder();
    void recognisesCompanyFiles();
    void rangeQueriesUseTheIndex();
};

void TestCompanyFile::dateKeys_data()
{
    QTest::addColumn<QByteArray>("text");
    QTest::addColumn<int>("key");
    QTest::newRow("stored form") << QByteArray("2006-07-01") << 20060701;
    QTest::newRow("literal form") << QByteArray("1 Jul 2006") << 20060701;
    QTest::newRow("two-digit day") << QByteArray("31 Dec 1999") << 19991231;
    QTest::newRow("leading zero") << QByteArray("01 Jul 2006") << 20060701;
    QTest::newRow("month in any case") << QByteArray("5 fEB 2008") << 20080205;
    QTest::newRow("unknown month") << QByteArray("5 Foo 2008") << 0;
    QTest::newRow("month 13") << QByteArray("2008-13-01") << 0;
    QTest::newRow("two-digit year") << QByteArray("5 Feb 08") << 0;
    QTest::newRow("not a date") << QByteArray("yesterday") << 0;
    QTest::newRow("empty") << QByteArray() << 0;
}

void TestCompanyFile::dateKeys()
{
    QFETCH(QByteArray, text);
    QFETCH(int, key);
    QCOMPARE(CompanyFile::dateKey(text), key);
}

void TestCompanyFile::collationOrder_data()
{
    QTest::addColumn<QByteArray>("left");
    QTest::addColumn<QByteArray>("right");
    QTest::addColumn<int>("order");
    QTest::newRow("calendar, not text")
        << QByteArray("2 Jul 2006") << QByteArray("10 Jul 2006") << -1;
    QTest::newRow("across forms") << QByteArray("2006-06-30") << QByteArray("1 Jul 2006") << -1;
    QTest::newRow("same day") << QByteArray("2006-07-01") << QByteArray("1 jul 2006") << 0;
    QTest::newRow("year decides") << QByteArray("1 Jan 2007") << QByteArray("2006-12-31") << 1;
    QTest::newRow("text before dates") << QByteArray("zzz") << QByteArray("1 Jan 1900") << -1;
    QTest::newRow("texts by bytes") << QByteArray("abc") << QByteArray("abd") << -1;
    QTest::newRow("shorter text first") << QByteArray("ab") << QByteArray("abc") << -1;
}

void TestCompanyFile::collationOrder()
{
    QFETCH(QByteArray, left);
    QFETCH(QByteArray, right);
    QFETCH(int, order);
    QCOMPARE(CompanyFile::compareMyobDates(left, right), order);
    QCOMPARE(CompanyFile::compareMyobDates(right, left), -order);
}

void TestCompanyFile::recognisesCompanyFiles()
{
    QTemporaryDir dir;
    CompanyFileWriter writer;
    QCOMPARE(writer.create(dir.filePath(u"shop.myo"_s)), std::nullopt);
    QCOMPARE(writer.finish(), std::nullopt);
    QVERIFY(CompanyFile::isCompanyFile(dir.filePath(u"shop.myo"_s)));
    QFile text(dir.filePath(u"notes.txt"_s));
    QVERIFY(text.open(QIODevice::WriteOnly));
    text.write("SQLite format 2 is not this");
    text.close();
    QVERIFY(!CompanyFile::isCompanyFile(dir.filePath(u"notes.txt"_s)));
}

void TestCompanyFile::rangeQueriesUseTheIndex()
{
    QTemporaryDir dir;
    CompanyFileWriter writer;
    QCOMPARE(writer.create(dir.filePath(u"shop.myo"_s)), std::nullopt);
    const qint64 account = writer.addAccount(u"4-1100"_s, u"Panel Labour"_s);
    for (int i = 0; i < 400; ++i)
        writer.addJournalLine(account, QDate(2006, 1, 1).addDays(i), -100.0);
    QCOMPARE(writer.finish(), std::nullopt);

    SqliteConnection connection;
    QCOMPARE(CompanyFile::open(connection, dir.filePath(u"shop.myo"_s)), std::nullopt);
    QSqlQuery query(connection.database());
    const QString sql =
        u"SELECT SUM(TaxExclusiveAmount) As Total FROM JournalRecords WHERE "
        u"AccountID='1' AND TransactionDate BETWEEN '1 Jul 2006' AND '31 Jul 2006'"_s;
    QVERIFY(query.exec(sql) && query.next());
    QCOMPARE(query.value(0).toDouble(), -3100.0);
    QVERIFY(query.exec(u"EXPLAIN QUERY PLAN "_s + sql));
    QString plan;
    while (query.next())
        plan += query.value(3).toString();
    QVERIFY2(plan.contains(u"JournalByAccountDate"_s), qPrintable(plan));
    QVERIFY2(plan.contains(u"TransactionDate>? AND TransactionDate<?"_s), qPrintable(plan));
}

QTEST_GUILESS_MAIN(TestCompanyFile)
#include "tst_companyfile.moc"
