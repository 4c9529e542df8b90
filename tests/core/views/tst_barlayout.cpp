// Veltrix — KPI dashboard for small businesses.
#include "common/numberformat.h"
#include "views/barlayout.h"

#include <QSet>
#include <QTest>

using namespace Qt::StringLiterals;

class TestBarLayout : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void bars_data();
    void bars();
    void denserScreensScaleUpAndVariantsAreSigned();
    void spread_data();
    void spread();

private:
    NumberFormat m_numbers{QLocale(QLocale::English, QLocale::Australia)};
};

void TestBarLayout::bars_data()
{
    QTest::addColumn<QString>("benchmark");
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("height");
    QTest::addColumn<int>("extra");
    QTest::addColumn<int>("lineY");
    QTest::addColumn<int>("band");
    QTest::addColumn<qint64>("field");
    QTest::newRow("at most, met") << u"<30"_s << 25.0 << 60 << 10 << 0 << 2 << qint64(0);
    QTest::newRow("at least, met") << u">20"_s << 25.0 << 50 << 10 << 10 << 2 << qint64(0);
    QTest::newRow("at most, yellow") << u"<30,>40"_s << 35.0 << 70 << 10 << 10 << 1 << qint64(0);
    QTest::newRow("at least, red") << u">20,<10"_s << 5.0 << 40 << 30 << 0 << 0 << qint64(0);
    QTest::newRow("exactly the optimal") << u">20"_s << 20.0 << 40 << 0 << 0 << 2 << qint64(0);
    QTest::newRow("no benchmark yet") << QString() << 25.0 << 0 << 0 << 0 << 0 << qint64(0);
    // Below the base line there is nothing to draw: the bar stands at its optimal, all of it
    // marked as the shortfall, red whatever the benchmark says of the magnitude.
    QTest::newRow("negative share") << u"<20,>26"_s << -5.0 << 40 << 40 << 0 << 0 << qint64(109);
    QTest::newRow("negative margin") << u">8,<4"_s << -16.0 << 16 << 16 << 0 << 0 << qint64(111);
    QTest::newRow("value of zero") << u"<30"_s << 0.0 << 0 << 0 << 0 << 0 << qint64(0);
}

void TestBarLayout::bars()
{
    QFETCH(QString, benchmark);
    QFETCH(double, value);
    QFETCH(int, height);
    QFETCH(int, extra);
    QFETCH(int, lineY);
    QFETCH(int, band);
    QFETCH(qint64, field);
    const BarLayout::Bar bar = BarLayout::layoutBar(benchmark, value, 15.0, m_numbers, field);
    QCOMPARE(bar.columnHeight, height);
    QCOMPARE(bar.extraHeight, extra);
    QCOMPARE(bar.extraVisible, extra > 0);
    QCOMPARE(bar.optimalLineY, lineY);
    QCOMPARE(int(bar.evaluation.band), band);
}

void TestBarLayout::denserScreensScaleUpAndVariantsAreSigned()
{
    QCOMPARE(BarLayout::scale(15.0), 2.0);
    QCOMPARE(BarLayout::scale(10.0), 3.0);
    QCOMPARE(BarLayout::scale(0.0), 2.0);
    QCOMPARE(BarLayout::layoutBar(u"<30"_s, 25.0, 10.0, m_numbers).columnHeight, 90);
    QCOMPARE(BarLayout::tooltip(2.5, m_numbers), u"+2.5%"_s);
    QCOMPARE(BarLayout::tooltip(-3.0, m_numbers), u"-3%"_s);
    QCOMPARE(BarLayout::tooltip(0.0, m_numbers), u"0%"_s);
}

void TestBarLayout::spread_data()
{
    QTest::addColumn<QList<qint64>>("fields");
    QTest::addColumn<int>("width");
    QTest::newRow("seven Fields") << QList<qint64>{1, 2, 3, 4, 5, 6, 7} << 700;
    QTest::newRow("three Fields over four periods")
        << QList<qint64>{1, 1, 1, 1, 2, 2, 2, 2, 3, 3, 3, 3} << 1200;
    QTest::newRow("seven Fields over five periods") << [] {
        QList<qint64> ids;
        for (qint64 id = 1; id <= 7; ++id)
            ids << id << id << id << id << id;
        return ids;
    }() << 1366;
    QTest::newRow("far too narrow") << QList<qint64>{1, 2} << 3;
    QTest::newRow("no bars") << QList<qint64>{} << 500;
}

void TestBarLayout::spread()
{
    QFETCH(QList<qint64>, fields);
    QFETCH(int, width);
    const BarLayout::Spread spread = BarLayout::spreadBars(fields, width);
    QCOMPARE(spread.lefts.size(), fields.size());
    if (fields.isEmpty())
        return;
    QVERIFY(spread.barWidth >= 1);
    for (qsizetype n = 1; n < fields.size(); ++n) {
        const int gap = spread.lefts[n] - spread.lefts[n - 1] - spread.barWidth;
        if (fields[n] == fields[n - 1])
            QVERIFY2(gap >= 0 && gap <= 1, "the periods of one Field touch");
        else
            QVERIFY2(gap >= spread.barWidth / 4, "Fields stand apart");
    }
    const int used = spread.lefts.last() + spread.barWidth - spread.lefts.first();
    if (width >= 100) {
        QVERIFY(spread.lefts.last() + spread.barWidth <= width);
        QVERIFY2(used >= width * 8 / 10, "the bars use the width they have");
    }
    QCOMPARE(spread.groups.size(), QSet<qint64>(fields.cbegin(), fields.cend()).size());
}

QTEST_GUILESS_MAIN(TestBarLayout)
#include "tst_barlayout.moc"
