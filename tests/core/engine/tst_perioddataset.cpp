// Veltrix — KPI dashboard for small businesses.
#include "common/numberformat.h"
#include "engine/perioddataset.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestPeriodDataSet : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void storeByTypeCode_data();
    void storeByTypeCode();
    void absentZeroAndHandWrittenEntries();
    void sumSkipsAbsentIds();
    void lookupsFollowTheSlots();
    void formatFieldValue_data();
    void formatFieldValue();

private:
    NumberFormat m_numbers{QLocale(QLocale::English, QLocale::Australia)};
};

void TestPeriodDataSet::storeByTypeCode_data()
{
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("code");
    QTest::addColumn<QString>("storedValue");
    QTest::addColumn<QString>("storedAbs");
    QTest::addColumn<double>("readBack");

    QTest::newRow("ratio becomes a percentage") << 0.1234 << 1 << u"12.3"_s << u"12.3"_s << 12.3;
    QTest::newRow("money, half away from zero")
        << -52.375 << 0 << u"-52.38"_s << u"52.38"_s << -52.38;
    QTest::newRow("money, an exact half") << 0.125 << 0 << u"0.13"_s << u"0.13"_s << 0.13;
    QTest::newRow("computed money") << 1234.5678 << 5 << u"1234.57"_s << u"1234.57"_s << 1234.57;
    QTest::newRow("count, half to even down") << 2.5 << 3 << u"2"_s << u"2"_s << 2.0;
    QTest::newRow("count, half to even up") << 3.5 << 3 << u"4"_s << u"4"_s << 4.0;
    QTest::newRow("one decimal, half to even") << 0.25 << 4 << u"0.2"_s << u"0.2"_s << 0.2;
    QTest::newRow("one decimal") << 7.46 << 4 << u"7.5"_s << u"7.5"_s << 7.5;
    QTest::newRow("unknown code becomes zero") << 99.0 << 7 << u"0"_s << u"0"_s << 0.0;
    QTest::newRow("tiny value rounds to zero text") << 0.001 << 0 << u"0"_s << u"0"_s << 0.0;
    QTest::newRow("negative ratio") << -0.0555 << 1 << u"-5.6"_s << u"5.6"_s << -5.6;
    // Account figures are kept unrounded and read back negated; the range loader's test reads
    // income, expenses and zeros through the whole load.
    QTest::newRow("account unrounded")
        << -1234.5678 << 2 << u"-1234.5678"_s << u"1234.5678"_s << 1234.5678;
}

void TestPeriodDataSet::storeByTypeCode()
{
    QFETCH(double, value);
    QFETCH(int, code);
    QFETCH(QString, storedValue);
    QFETCH(QString, storedAbs);
    QFETCH(double, readBack);

    PeriodDataSet data(m_numbers);
    if (code == 2)
        data.storeAccountFigure(104, value, code);
    else
        data.storeFieldValue(104, value, code);
    QCOMPARE(data.current().fieldIds, QStringList{u"104"_s});
    QCOMPARE(data.current().fieldTypes, QStringList{QString::number(code)});
    QCOMPARE(data.current().fieldValues, QStringList{storedValue});
    QCOMPARE(data.current().fieldAbs, QStringList{storedAbs});
    QCOMPARE(data.getFieldValue(104), readBack);
    QCOMPARE(data.getFieldAbs(104), std::fabs(readBack));
}

void TestPeriodDataSet::absentZeroAndHandWrittenEntries()
{
    PeriodDataSet data(m_numbers);
    QCOMPARE(data.getFieldValue(90), 0.0);
    QCOMPARE(data.getFieldAbs(90), 0.0);
    QCOMPARE(PeriodDataSet::findFieldPos(data.current().fieldIds, 90), 0);
    // A computed zero is kept, as empty text.
    data.storeFieldValue(90, 0.0, 0);
    QCOMPARE(data.current().fieldValues, QStringList{QString()});
    QCOMPARE(data.current().fieldAbs, QStringList{QString()});
    QCOMPARE(data.getFieldValue(90), 0.0);
    QCOMPARE(data.getFieldAbs(90), 0.0);
    QCOMPARE(PeriodDataSet::findFieldPos(data.current().fieldIds, 90), 1);

    // A hand-edited cache: what is not a number reads as 0, a number in the region's own form
    // still reads, and an ID written in another form still counts, in its place.
    data.current().fieldIds << u"5"_s << u"6"_s << u" 81.0"_s;
    data.current().fieldValues << u"n/a"_s << u"1,234.5"_s << u"5"_s;
    data.current().fieldAbs << QString() << u"1,234.5"_s << u"5"_s;
    data.current().fieldTypes << u"0"_s << u"0"_s << u"0"_s;
    QCOMPARE(data.getFieldValue(5), 0.0);
    QCOMPARE(data.getFieldAbs(5), 0.0);
    QCOMPARE(data.getFieldValue(6), 1234.5);
    data.storeFieldValue(81, 99.0, 0);
    QCOMPARE(data.getFieldValue(81), 5.0);
    QCOMPARE(data.current().findFieldPos(81), 4);
}

void TestPeriodDataSet::sumSkipsAbsentIds()
{
    PeriodDataSet data(m_numbers);
    data.storeAccountFigure(72, -1000.0, 2);
    data.storeAccountFigure(75, -250.5, 2);
    data.storeAccountFigure(79, -99999.0, 2);
    QCOMPARE(data.sumFieldValues(72, 78), 1250.5);
    QCOMPARE(data.sumFieldValues(78, 72), 0.0);
    QCOMPARE(data.sumFieldValues(75, 75), 250.5);
}

void TestPeriodDataSet::lookupsFollowTheSlots()
{
    PeriodDataSet data(m_numbers);
    data.storeFieldValue(79, 10.0, 0);
    QCOMPARE(data.getFieldValue(79), 10.0);
    QCOMPARE(data.getFieldValue(80), 0.0);
    data.storeFieldValue(80, 20.0, 0);
    data.storeFieldValue(79, 30.0, 0);
    QCOMPARE(data.getFieldValue(80), 20.0);
    QCOMPARE(data.getFieldValue(79), 10.0); // the first entry of an ID wins
    QCOMPARE(data.current().size(), 3);
    const QStringList ids{u"12"_s, u" 79 "_s, u"79.0"_s, u"abc"_s};
    QCOMPARE(PeriodDataSet::findFieldPos(ids, 79), 2); // compared as numbers
    QCOMPARE(PeriodDataSet::findFieldPos(ids, 0), 0);

    // Each slot has its own figures and range.
    data.setCurrentSlot(4);
    QCOMPARE(data.getFieldValue(79), 0.0);
    data.storeFieldValue(79, 40.0, 0);
    data.setRange(4, {QDate(2025, 7, 1), QDate(2025, 7, 31)});
    data.setCurrentSlot(0);
    QCOMPARE(data.getFieldValue(79), 10.0);
    QCOMPARE(data.range(4).end, QDate(2025, 7, 31));
    QVERIFY(data.range(0).start.isNull());

    // A slot replaced by a new one starts over.
    data.clearCurrent();
    QVERIFY(data.slot(0).isEmpty());
    QCOMPARE(data.slot(4).size(), 1);
    QCOMPARE(data.getFieldValue(79), 0.0);
    data.storeFieldValue(79, 7.0, 0);
    QCOMPARE(data.getFieldValue(79), 7.0);
}

void TestPeriodDataSet::formatFieldValue_data()
{
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("code");
    QTest::addColumn<bool>("storage");
    QTest::addColumn<QString>("expected");
    QTest::newRow("storage money") << 1234.5 << 0 << true << u"1,234.50"_s;
    QTest::newRow("storage ratio") << 0.1234 << 1 << true << u"12.3"_s;
    QTest::newRow("storage account") << 1234.56 << 2 << true << u"1,234.6"_s;
    QTest::newRow("storage count") << 2.5 << 3 << true << u"2"_s;
    QTest::newRow("storage one decimal") << 3.25 << 4 << true << u"3.2"_s;
    QTest::newRow("storage unknown") << 3.0 << 9 << true << QString();
    QTest::newRow("shown heading") << 5.0 << 1 << false << QString();
    QTest::newRow("shown percentage") << 12.34 << 3 << false << u"12.3%"_s;
    QTest::newRow("shown count") << 7.5 << 4 << false << u"8"_s;
    QTest::newRow("shown money") << 1234.5 << 5 << false << u"$ 1,234.50"_s;
    QTest::newRow("shown zero money") << 0.0 << 2 << false << u"$ -"_s;
}

void TestPeriodDataSet::formatFieldValue()
{
    QFETCH(double, value);
    QFETCH(int, code);
    QFETCH(bool, storage);
    QFETCH(QString, expected);
    QCOMPARE(PeriodDataSet(m_numbers).formatFieldValue(value, code, storage), expected);
}

QTEST_GUILESS_MAIN(TestPeriodDataSet)
#include "tst_perioddataset.moc"
