// Veltrix — KPI dashboard for small businesses.
#include "common/numberformat.h"
#include "engine/perioddataset.h"
#include "engine/usualsign.h"
#include "views/comparisonranges.h"
#include "views/kpievaluation.h"

#include <QTest>

using namespace Qt::StringLiterals;
using namespace KpiEvaluation;

class TestKpiEvaluation : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void evaluateBenchmark_data();
    void evaluateBenchmark();
    void wrongSignIsShownAndPoor_data();
    void wrongSignIsShownAndPoor();
    void comparisonRanges_data();
    void comparisonRanges();

private:
    NumberFormat m_numbers{QLocale(QLocale::English, QLocale::Australia)};
};

void TestKpiEvaluation::evaluateBenchmark_data()
{
    QTest::addColumn<QString>("benchmark");
    QTest::addColumn<double>("actual");
    QTest::addColumn<double>("optimal");
    QTest::addColumn<double>("variant");
    QTest::addColumn<int>("band");
    QTest::addColumn<int>("type");

    QTest::newRow("margin met") << u">45,<35"_s << 52.3 << 45.0 << 7.3 << 2 << 2;
    QTest::newRow("margin short, above the red line")
        << u">45,<35"_s << 40.0 << 45.0 << -5.0 << 1 << 2;
    QTest::newRow("margin on the red line") << u">45,<35"_s << 35.0 << 45.0 << -10.0 << 1 << 2;
    QTest::newRow("margin below the red line") << u">45,<35"_s << 30.04 << 45.0 << -15.0 << 0 << 2;
    QTest::newRow("cost met") << u"<30,>40"_s << 28.0 << 30.0 << 2.0 << 2 << 1;
    QTest::newRow("cost over, under the red line")
        << u"<30,>40"_s << 33.0 << 30.0 << -3.0 << 1 << 1;
    QTest::newRow("cost over the red line") << u"<30,>40"_s << 45.5 << 30.0 << -15.5 << 0 << 1;
    QTest::newRow("no second element: red") << u">45"_s << 44.9 << 45.0 << -0.1 << 0 << 2;
    QTest::newRow("negative actual") << u">10,<5"_s << -3.2 << 10.0 << -13.2 << 0 << 2;
    QTest::newRow("bare number") << u"30"_s << 12.0 << 0.0 << 0.0 << 2 << 0;
    QTest::newRow("not a number counts as 0") << u"<abc"_s << 5.0 << 0.0 << -5.0 << 0 << 1;
    QTest::newRow("both characters: a < element") << u"<>20"_s << 10.0 << 0.0 << -10.0 << 0 << 1;
    QTest::newRow("variant to one decimal") << u">45"_s << 45.04 << 45.0 << 0.0 << 2 << 2;
    QTest::newRow("decimal benchmark") << u"<1.5,>2.5"_s << 2.0 << 1.5 << -0.5 << 1 << 1;
}

void TestKpiEvaluation::evaluateBenchmark()
{
    QFETCH(QString, benchmark);
    QFETCH(double, actual);
    QFETCH(double, optimal);
    QFETCH(double, variant);
    QFETCH(int, band);
    QFETCH(int, type);
    const Result result = KpiEvaluation::evaluateBenchmark(benchmark, actual, m_numbers);
    QCOMPARE(result.optimal, optimal);
    QCOMPARE(result.variant, variant);
    QCOMPARE(int(result.band), band);
    QCOMPARE(int(result.optimalType), type);
}

void TestKpiEvaluation::wrongSignIsShownAndPoor_data()
{
    QTest::addColumn<qint64>("field");
    QTest::addColumn<double>("value"); // signed, as the data set reads it
    QTest::addColumn<QString>("benchmark");
    QTest::addColumn<double>("shown");
    QTest::addColumn<int>("band");

    QTest::newRow("net loss") << qint64(110) << -22480.57 << QString() << -22480.57 << 0;
    QTest::newRow("net profit") << qint64(110) << 10690.09 << QString() << 10690.09 << 0;
    QTest::newRow("cost as a magnitude") << qint64(89) << -5000.0 << QString() << 5000.0 << 0;
    QTest::newRow("cost account in credit") << qint64(85) << 500.0 << QString() << -500.0 << 0;
    QTest::newRow("negative net margin") << qint64(111) << -16.0 << u">8,<4"_s << -16.0 << 0;
    QTest::newRow("net margin met") << qint64(111) << 12.0 << u">8,<4"_s << 12.0 << 2;
    QTest::newRow("negative share never green") << qint64(109) << -5.0 << u"<20,>26"_s << -5.0 << 0;
    QTest::newRow("Field of unknown sign") << qint64(999) << -7.0 << u"<20"_s << 7.0 << 2;
}

void TestKpiEvaluation::wrongSignIsShownAndPoor()
{
    QFETCH(qint64, field);
    QFETCH(double, value);
    QFETCH(QString, benchmark);
    QFETCH(double, shown);
    QFETCH(int, band);
    QCOMPARE(UsualSign::shown(field, value), shown);
    QCOMPARE(UsualSign::isUnusual(field, value), shown < 0);
    QCOMPARE(int(evaluateField(field, benchmark, value, m_numbers).band), band);
}

void TestKpiEvaluation::comparisonRanges_data()
{
    QTest::addColumn<QDate>("start");
    QTest::addColumn<QDate>("end");
    QTest::addColumn<QString>("kind");
    QTest::addColumn<int>("count");
    QTest::addColumn<QList<QDate>>("expected"); // start, end of each earlier range

    QTest::newRow("financial years") << QDate(2003, 7, 1) << QDate(2004, 6, 30) << u"Years"_s << 2
                                     << QList<QDate>{QDate(2002, 7, 1), QDate(2003, 6, 30),
                                                     QDate(2001, 7, 1), QDate(2002, 6, 30)};
    QTest::newRow("quarters") << QDate(2007, 1, 1) << QDate(2007, 3, 31) << u"Periods"_s << 1
                              << QList<QDate>{QDate(2006, 10, 1), QDate(2006, 12, 31)};
    QTest::newRow("two months end on the month's last day")
        << QDate(2008, 3, 1) << QDate(2008, 4, 30) << u"Periods"_s << 2
        << QList<QDate>{QDate(2008, 1, 1), QDate(2008, 2, 29), QDate(2007, 11, 1),
                        QDate(2007, 12, 31)};
    QTest::newRow("a year back keeps the whole of February")
        << QDate(2008, 3, 1) << QDate(2009, 2, 28) << u"years"_s << 1
        << QList<QDate>{QDate(2007, 3, 1), QDate(2008, 2, 29)};
    QTest::newRow("at most four") << QDate(2020, 1, 1) << QDate(2020, 1, 31) << u"Periods"_s << 9
                                  << QList<QDate>{QDate(2019, 12, 1), QDate(2019, 12, 31),
                                                  QDate(2019, 11, 1), QDate(2019, 11, 30),
                                                  QDate(2019, 10, 1), QDate(2019, 10, 31),
                                                  QDate(2019, 9, 1),  QDate(2019, 9, 30)};
}

void TestKpiEvaluation::comparisonRanges()
{
    QFETCH(QDate, start);
    QFETCH(QDate, end);
    QFETCH(QString, kind);
    QFETCH(int, count);
    QFETCH(QList<QDate>, expected);
    const auto ranges =
        ComparisonRanges::earlierRanges({start, end}, *ComparisonRanges::kindFromText(kind), count);
    QList<QDate> dates;
    for (const PeriodDataSet::Range &range : ranges)
        dates << range.start << range.end;
    QCOMPARE(dates, expected);
}

QTEST_GUILESS_MAIN(TestKpiEvaluation)
#include "tst_kpievaluation.moc"
