// Veltrix — KPI dashboard for small businesses.
#include "common/numberformat.h"
#include "views/barlayout.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestBarLayout : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void bars_data();
    void bars();
    void denserScreensScaleUp();
    void tooltips_data();
    void tooltips();
    void placement();
    void compareLayout_data();
    void compareLayout();

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

void TestBarLayout::denserScreensScaleUp()
{
    QCOMPARE(BarLayout::scale(15.0), 2.0);
    QCOMPARE(BarLayout::scale(10.0), 3.0);
    QCOMPARE(BarLayout::scale(0.0), 2.0);
    QCOMPARE(BarLayout::layoutBar(u"<30"_s, 25.0, 10.0, m_numbers).columnHeight, 90);
}

void TestBarLayout::tooltips_data()
{
    QTest::addColumn<double>("variant");
    QTest::addColumn<QString>("text");
    QTest::newRow("above") << 2.5 << u"+2.5%"_s;
    QTest::newRow("below") << -3.0 << u"-3%"_s;
    QTest::newRow("on it") << 0.0 << u"0%"_s;
}

void TestBarLayout::tooltips()
{
    QFETCH(double, variant);
    QFETCH(QString, text);
    QCOMPARE(BarLayout::tooltip(variant, m_numbers), text);
}

void TestBarLayout::placement()
{
    QCOMPARE(BarLayout::barWidthTwips(15.0), 864);
    const auto main = BarLayout::placeBars({1, 2, 3}, {60, 50, 0}, 15.0, 15.0, false);
    QCOMPARE(main.at(0).left, 35);
    QCOMPARE(main.at(1).left, 35 + 864 + 16);
    QCOMPARE(main.at(2).left, 35 + 2 * (864 + 16));
    QCOMPARE(main.at(0).height, 60 * 15 - 1);
    QCOMPARE(main.at(0).top, 3300 - (60 * 15 - 1));
    // In a comparison the periods of one Field touch.
    const auto compare = BarLayout::placeBars({1, 1, 2}, {10, 20, 30}, 15.0, 15.0, true);
    QCOMPARE(compare.at(1).left, 35 + 864);
    QCOMPARE(compare.at(2).left, 35 + 2 * 864 + 16);
}

void TestBarLayout::compareLayout_data()
{
    QTest::addColumn<QList<qint64>>("fields");
    QTest::addColumn<int>("periods");
    QTest::addColumn<int>("innerWidth");
    QTest::addColumn<int>("width");
    QTest::addColumn<QList<int>>("lefts");
    // Two Fields over two periods: (3000 - 16 * 2 - 20) / 4 = 737.
    QTest::newRow("pairs") << QList<qint64>{5, 5, 9, 9} << 2 << 3000 << 737
                           << QList<int>{35, 772, 1525, 2262};
    // Three periods, one Field: (1000 - 16 - 20) / 3 = 321.33 -> 321.
    QTest::newRow("one field, N = 2")
        << QList<qint64>{7, 7, 7} << 3 << 1000 << 321 << QList<int>{35, 356, 677};
    // A window far too narrow still gives every bar a width.
    QTest::newRow("narrow") << QList<qint64>{1, 2} << 1 << 10 << 1 << QList<int>{35, 52};
    QTest::newRow("no bars") << QList<qint64>{} << 2 << 3000 << 0 << QList<int>{};
}

void TestBarLayout::compareLayout()
{
    QFETCH(QList<qint64>, fields);
    QFETCH(int, periods);
    QFETCH(int, innerWidth);
    QFETCH(int, width);
    QFETCH(QList<int>, lefts);
    const BarLayout::CompareLayout layout =
        BarLayout::layoutCompareBars(fields, periods, BarLayout::FirstLeft, innerWidth);
    QCOMPARE(layout.barWidth, width);
    QCOMPARE(layout.lefts, lefts);
}

QTEST_GUILESS_MAIN(TestBarLayout)
#include "tst_barlayout.moc"
