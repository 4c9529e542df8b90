// Veltrix — KPI dashboard for small businesses.
#include "modalwindow.h"
#include "testworkspace.h"

#include "app/demoworkspace.h"
#include "app/producecommand.h"
#include "grid/gridoperations.h"
#include "report/gifencoder.h"
#include "report/printwindow.h"
#include "views/bargraphitem.h"
#include "views/comparewindow.h"
#include "views/grapharea.h"
#include "views/kpigrid.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QTest>
#include <QTextBrowser>

using namespace Qt::StringLiterals;

namespace {

bool waitUntilLoaded(CompareWindow &window)
{
    if (!window.isLoading())
        return true;
    QSignalSpy loaded(&window, &CompareWindow::loaded);
    return loaded.wait(10000);
}

} // namespace

class TestCompareWindow : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void loadsEarlierPeriodsIntoColumns_data();
    void loadsEarlierPeriodsIntoColumns();
    void earlierColumnsMatchTheirOwnProduce();
    void graphStretchesAndHighestPeriodIsHighlighted();
    void printFromTheGraphTab();

private:
    void produce(int firstMonth, int firstYear, int lastMonth, int lastYear)
    {
        QCOMPARE(ProduceCommand(m_workspace->context())
                     .produce({firstMonth, firstYear, lastMonth, lastYear}),
                 ProduceCommand::Outcome::Produced);
    }

    QTemporaryDir m_demo;
    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestCompareWindow::initTestCase()
{
    QCOMPARE(DemoWorkspace::create(m_demo.filePath(u"demo"_s), QStringLiteral(VELTRIX_NEW_DB)),
             std::nullopt);
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    DemoWorkspace::configure(m_workspace->store(), m_demo.filePath(u"demo"_s));
    AppContext &context = m_workspace->context();
    context.setNumberFormat(NumberFormat(QLocale(QLocale::English, QLocale::Australia)));
    QVERIFY(m_workspace->connect());
    context.loginState() = LoginState{true, u"sysop"_s, 1, QString()};
}

void TestCompareWindow::loadsEarlierPeriodsIntoColumns_data()
{
    QTest::addColumn<QString>("kind");
    QTest::addColumn<int>("count");
    QTest::addColumn<QList<int>>("range"); // produced: month, year, month, year
    QTest::addColumn<QStringList>("headers");
    QTest::newRow("years, 2") << u"Years"_s << 2 << QList<int>{7, 2025, 6, 2026}
                              << QStringList{u"Jul 25 - Jun 26"_s, u"Jul 24 - Jun 25"_s,
                                             u"Jul 23 - Jun 24"_s};
    QTest::newRow("periods of 3 months") << u"Periods"_s << 1 << QList<int>{1, 2026, 3, 2026}
                                         << QStringList{u"Jan 26 - Mar 26"_s, u"Oct 25 - Dec 25"_s};
}

void TestCompareWindow::loadsEarlierPeriodsIntoColumns()
{
    QFETCH(QString, kind);
    QFETCH(int, count);
    QFETCH(QList<int>, range);
    QFETCH(QStringList, headers);
    produce(range[0], range[1], range[2], range[3]);

    CompareWindow window(m_workspace->context(), *ComparisonRanges::kindFromText(kind), count);
    QCOMPARE(window.lblLoad()->text(),
             u"Please wait while we load the past '%1 %2' of data..."_s.arg(count).arg(
                 count == 1 ? kind.chopped(1) : kind));
    window.show();
    QVERIFY(window.picLoad()->isVisible());
    QCOMPARE(window.shpProgress()->width(), 0);
    QVERIFY(waitUntilLoaded(window));
    // The legend names every period, oldest first, and explains the highlight.
    QCOMPARE(window.lblLegend()->text().count(u" · "_s), count);
    QVERIFY(window.lblLegend()->text().contains(KpiGrid::Highest.name()));
    QVERIFY(!window.picLoad()->isVisible());
    QCOMPARE(window.shpProgress()->width(), window.shpProgress()->parentWidget()->width());

    const GridModel &grid = window.tabView()->grid();
    QCOMPARE(grid.column(grid.columnIndex(u"value"_s)).header, headers[0]);
    for (int slot = 1; slot <= 4; ++slot) {
        const GridModel::Column &column =
            grid.column(grid.columnIndex(u"value"_s + QString::number(slot)));
        QCOMPARE(column.visible, slot <= count);
        if (slot <= count)
            QCOMPARE(column.header, headers[slot]);
    }
    QCOMPARE(window.tabView()->currentTab(), 0);
    QVERIFY(window.tabButton(0)->isChecked());
}

void TestCompareWindow::earlierColumnsMatchTheirOwnProduce()
{
    // What the comparison shows for a year back is what producing that year shows.
    produce(7, 2024, 6, 2025);
    KpiTabView single(m_workspace->context());
    single.showTab(0);
    const GridModel &alone = single.grid();
    QStringList expected;
    for (int row = 1; row <= alone.rowCount(); ++row)
        expected << alone.cellText(row, alone.columnIndex(u"value"_s));

    produce(7, 2025, 6, 2026);
    CompareWindow window(m_workspace->context(), ComparisonRanges::Kind::Years, 1);
    window.show();
    QVERIFY(waitUntilLoaded(window));
    const GridModel &grid = window.tabView()->grid();
    QStringList shown;
    for (int row = 1; row <= grid.rowCount(); ++row)
        shown << grid.cellText(row, grid.columnIndex(u"value1"_s));
    QCOMPARE(shown, expected);
    QVERIFY(expected.contains(u"53%"_s));
}

void TestCompareWindow::graphStretchesAndHighestPeriodIsHighlighted()
{
    produce(7, 2025, 6, 2026);
    CompareWindow window(m_workspace->context(), ComparisonRanges::Kind::Years, 4);
    window.resize(900, 700);
    window.show();
    QVERIFY(waitUntilLoaded(window));
    const GridModel &grid = window.tabView()->grid();
    const int row = GridOperations::findGridRow(grid, grid.columnIndex(u"label"_s),
                                                u"Repair orders invoiced"_s);
    QVERIFY(row > 0);
    // 920, 873, 894, 1,107 and 1,158 repair orders: the produced year is the highest.
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"value"_s)), u"1,158"_s);
    QCOMPARE(grid.cell(row, grid.columnIndex(u"value"_s)).back, KpiGrid::Highest);
    QVERIFY(grid.cell(row, grid.columnIndex(u"value4"_s)).back != KpiGrid::Highest);
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"average"_s)), u"990"_s);

    // The graph shows every period of each Field, without variants, across the window's width.
    window.selectTab(TabViewBuilder::SummaryTab);
    GraphArea *graph = window.tabView()->picGraph();
    QVERIFY(graph->isVisible());
    const QList<BarGraphItem *> &bars = graph->bars();
    QCOMPARE(bars.size() % 5, 0);
    QVERIFY(bars.size() >= 10);
    QVERIFY(graph->variantLabels().isEmpty());
    const int narrow = bars.first()->width();
    window.resize(1400, 700);
    QCoreApplication::processEvents();
    QVERIFY(bars.first()->width() > narrow);
    QVERIFY(bars.last()->x() + bars.last()->width() <= graph->width());

    // Picking a bar selects its Field's row.
    bars[6]->setFocus(Qt::MouseFocusReason);
    QCoreApplication::processEvents();
    QCOMPARE(grid.cellText(grid.selectedRow(), 1).toLongLong(), bars[6]->tag());
}

void TestCompareWindow::printFromTheGraphTab()
{
    produce(7, 2025, 6, 2026);
    CompareWindow window(m_workspace->context(), ComparisonRanges::Kind::Years, 1);
    window.show();
    QVERIFY(waitUntilLoaded(window));
    window.selectTab(TabViewBuilder::SummaryTab);
    const Settings &settings = m_workspace->context().settings();
    QFile::remove(settings.tempBmpFile);

    QString header;
    QString shown;
    whenModalOpens<PrintWindow>([&](PrintWindow &print) {
        header = print.txtHeader()->text();
        shown = print.ieFrame()->toPlainText();
    });
    window.print();
    QCOMPARE(header, u"Summary: 1/7/25 to 30/6/26"_s);
    QVERIFY(shown.contains(u"Panel labour gross profit %"_s));

    const QString page = QString::fromUtf8([&] {
        QFile file(settings.tempHtmlFile);
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }());
    const QString picture = u"<p align='left'><img src='"_s + settings.tempBmpFile + u"'></p>"_s;
    QVERIFY(page.contains(picture));
    QVERIFY(page.indexOf(picture) > page.indexOf(u"</table>"_s));
    QVERIFY(page.contains(u"Jul 24 - Jun 25"_s));
    QVERIFY(!page.contains(u">id<"_s));
    QVERIFY(!QFile::exists(settings.tempGifFile));

    // The picture is the graph as drawn, its white ground kept, its bars in cube colours.
    const QImage snapshot(settings.tempBmpFile);
    GraphArea *graph = window.tabView()->picGraph();
    QCOMPARE(snapshot.size(), graph->size());
    QCOMPARE(snapshot.pixel(0, 0), qRgb(255, 255, 255));
    const QImage drawn = graph->grab().toImage();
    const BarGraphItem *bar = graph->bars().first();
    const QPoint inside = bar->geometry().center();
    QCOMPARE(snapshot.pixel(inside),
             GifEncoder::fixedPalette()[GifEncoder::nearestCubeIndex(drawn.pixel(inside))]);

    // From another tab the page has no picture.
    window.selectTab(2);
    whenModalOpens<PrintWindow>([](PrintWindow &) {});
    window.print();
    QFile file(settings.tempHtmlFile);
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QByteArray table = file.readAll();
    QVERIFY(!table.contains("<img"));
    QVERIFY(table.endsWith("</table>\r\n</body></html>\r\n"));
}

QTEST_MAIN(TestCompareWindow)
#include "tst_comparewindow.moc"
