// Veltrix — KPI dashboard for small businesses.
#include "modalwindow.h"
#include "testworkspace.h"

#include "app/demoworkspace.h"
#include "app/producecommand.h"
#include "main/mainwindow.h"
#include "report/gifencoder.h"
#include "report/printwindow.h"
#include "views/bargraphitem.h"
#include "views/comparewindow.h"
#include "views/grapharea.h"
#include "views/kpigrid.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QTest>
#include <QTextBrowser>
#include <QTimer>

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
    void graphBarsTouchPerFieldAndStretch();
    void highestPeriodIsHighlighted();
    void printFromTheGraphTab();
    void mainWindowOpensTheComparison();

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
    QTest::newRow("periods ending in February")
        << u"Periods"_s << 4 << QList<int>{3, 2024, 4, 2024}
        << QStringList{u"Mar 24 - Apr 24"_s, u"Jan 24 - Feb 24"_s, u"Nov 23 - Dec 23"_s,
                       u"Sep 23 - Oct 23"_s, u"Jul 23 - Aug 23"_s};
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
    if (kind == u"Periods"_s && range[0] == 3) {
        // Moved to the last day of February, not 30 February.
        QCOMPARE(m_workspace->context().periodDataSet().range(1).end, QDate(2024, 2, 29));
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

void TestCompareWindow::graphBarsTouchPerFieldAndStretch()
{
    produce(7, 2025, 6, 2026);
    CompareWindow window(m_workspace->context(), ComparisonRanges::Kind::Years, 2);
    window.resize(900, 700);
    window.show();
    QVERIFY(waitUntilLoaded(window));
    window.selectTab(TabViewBuilder::SummaryTab);
    GraphArea *graph = window.tabView()->picGraph();
    QVERIFY(graph->isVisible());
    const QList<BarGraphItem *> &bars = graph->bars();
    QCOMPARE(bars.size() % 3, 0);
    QVERIFY(bars.size() >= 6);
    QVERIFY(graph->variantLabels().isEmpty());
    const auto checkLayout = [&] {
        for (int n = 1; n < bars.size(); ++n) {
            const int previousRight = bars[n - 1]->x() + bars[n - 1]->width();
            const int gap = bars[n]->x() - previousRight;
            if (bars[n]->tag() == bars[n - 1]->tag())
                QVERIFY(gap >= 0 && gap <= 1);
            else
                QVERIFY(gap >= bars[n]->width() / 4);
        }
        const int right = bars.last()->x() + bars.last()->width();
        QVERIFY(right <= graph->width());
        QVERIFY(right - bars.first()->x() >= (graph->width() - GraphArea::ScaleMargin) * 8 / 10);
    };
    checkLayout();
    const int narrow = bars.first()->width();
    window.resize(1400, 700);
    QCoreApplication::processEvents();
    checkLayout();
    QVERIFY(bars.first()->width() > narrow);

    // Picking a bar selects its Field's row.
    bars[4]->setFocus(Qt::MouseFocusReason);
    QCoreApplication::processEvents();
    const GridModel &grid = window.tabView()->grid();
    QCOMPARE(grid.cellText(grid.selectedRow(), 1).toLongLong(), bars[4]->tag());
}

void TestCompareWindow::highestPeriodIsHighlighted()
{
    produce(7, 2025, 6, 2026);
    CompareWindow window(m_workspace->context(), ComparisonRanges::Kind::Years, 4);
    window.show();
    QVERIFY(waitUntilLoaded(window));
    const GridModel &grid = window.tabView()->grid();
    const int label = grid.columnIndex(u"label"_s);
    const int row = [&] {
        for (int r = 1; r <= grid.rowCount(); ++r) {
            if (grid.cellText(r, label) == u"Repair orders invoiced"_s)
                return r;
        }
        return 0;
    }();
    QVERIFY(row > 0);
    // 920, 873, 894, 1,107 and 1,158 repair orders: the produced year is the highest.
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"value"_s)), u"1,158"_s);
    QCOMPARE(grid.cell(row, grid.columnIndex(u"value"_s)).back, KpiGrid::Highest);
    QVERIFY(grid.cell(row, grid.columnIndex(u"value4"_s)).back != KpiGrid::Highest);
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"average"_s)), u"990"_s);
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

void TestCompareWindow::mainWindowOpensTheComparison()
{
    m_workspace->context().loginState() = LoginState{};
    MainWindow main(m_workspace->context(), m_workspace->prompter());
    main.login(u"manager"_s, u"manager1"_s);
    main.lstMonth1()->setCurrentIndex(6);
    main.lstYear1()->setEditText(u"2025"_s);
    main.lstMonth2()->setCurrentIndex(5);
    main.lstYear2()->setEditText(u"2026"_s);
    main.chkCompare()->setChecked(true);
    main.lstCompareCount()->setCurrentIndex(2);
    main.lstCompareType()->setCurrentIndex(1);

    QStringList headers;
    whenModalOpens<CompareWindow>([&](CompareWindow &window) {
        QVERIFY(waitUntilLoaded(window));
        const GridModel &grid = window.tabView()->grid();
        for (const QString &key : {u"value3"_s, u"value2"_s, u"value1"_s, u"value"_s}) {
            const GridModel::Column &column = grid.column(grid.columnIndex(key));
            if (column.visible)
                headers << column.header;
        }
    });
    main.produce();
    QCOMPARE(headers, (QStringList{u"Jul 22 - Jun 23"_s, u"Jul 23 - Jun 24"_s, u"Jul 24 - Jun 25"_s,
                                   u"Jul 25 - Jun 26"_s}));
    main.logoff(true);
}

QTEST_MAIN(TestCompareWindow)
#include "tst_comparewindow.moc"
