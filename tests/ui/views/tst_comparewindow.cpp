// Veltrix — KPI dashboard for small businesses.
#include "modalwindow.h"
#include "testworkspace.h"

#include "app/demoworkspace.h"
#include "app/producecommand.h"
#include "common/fileoperations.h"
#include "grid/gridoperations.h"
#include "report/gifencoder.h"
#include "report/printwindow.h"
#include "views/bargraphitem.h"
#include "views/comparewindow.h"
#include "views/grapharea.h"
#include "views/kpigrid.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"

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
    void loadsEarlierPeriodsIntoColumnsAndPrints();
    void fourYearsMatchTheirOwnProduceAndTheHighestIsMarked();

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

void TestCompareWindow::loadsEarlierPeriodsIntoColumnsAndPrints()
{
    produce(1, 2026, 3, 2026);
    CompareWindow window(m_workspace->context(), ComparisonRanges::Kind::Periods, 1);
    QCOMPARE(window.lblLoad()->text(),
             u"Please wait while we load the past '1 Period' of data..."_s);
    window.show();
    QVERIFY(window.picLoad()->isVisible());
    QCOMPARE(window.shpProgress()->width(), 0);
    QVERIFY(waitUntilLoaded(window));
    // The legend names every period, oldest first, and explains the highlight.
    QCOMPARE(window.lblLegend()->text().count(u" · "_s), 1);
    QVERIFY(window.lblLegend()->text().contains(KpiGrid::Highest.name()));
    QVERIFY(!window.picLoad()->isVisible());
    QCOMPARE(window.shpProgress()->width(), window.shpProgress()->parentWidget()->width());

    const GridModel &grid = window.tabView()->grid();
    QCOMPARE(grid.column(grid.columnIndex(u"value"_s)).header, u"Jan 26 - Mar 26"_s);
    QCOMPARE(grid.column(grid.columnIndex(u"value1"_s)).header, u"Oct 25 - Dec 25"_s);
    for (const QString &hidden : {u"value2"_s, u"value3"_s, u"value4"_s})
        QVERIFY(!grid.column(grid.columnIndex(hidden)).visible);
    QCOMPARE(window.tabView()->currentTab(), 0);
    QVERIFY(window.tabButton(0)->isChecked());

    // Printed from the graph tab, the page has the graph's picture.
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
    QCOMPARE(header, u"Summary: 1/1/26 to 31/3/26"_s);
    QVERIFY(shown.contains(u"Panel labour gross profit %"_s));

    const QString page = FileOperations::readTextFile(settings.tempHtmlFile);
    const QString picture = u"<p align='left'><img src='"_s + settings.tempBmpFile + u"'></p>"_s;
    QVERIFY(page.contains(picture));
    QVERIFY(page.indexOf(picture) > page.indexOf(u"</table>"_s));
    QVERIFY(page.contains(u"Oct 25 - Dec 25"_s));
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

void TestCompareWindow::fourYearsMatchTheirOwnProduceAndTheHighestIsMarked()
{
    // What the comparison shows for a year back is what producing that year shows.
    produce(7, 2024, 6, 2025);
    KpiTabView single(m_workspace->context());
    single.showTab(0);
    const GridModel &alone = single.grid();
    QStringList expected;
    for (int row = 1; row <= alone.rowCount(); ++row)
        expected << alone.cellText(row, alone.columnIndex(u"value"_s));
    QVERIFY(expected.contains(u"53%"_s));

    produce(7, 2025, 6, 2026);
    CompareWindow window(m_workspace->context(), ComparisonRanges::Kind::Years, 4);
    QCOMPARE(window.lblLoad()->text(),
             u"Please wait while we load the past '4 Years' of data..."_s);
    window.resize(900, 700);
    window.show();
    QVERIFY(waitUntilLoaded(window));
    const GridModel &grid = window.tabView()->grid();
    QStringList shown;
    for (int row = 1; row <= grid.rowCount(); ++row)
        shown << grid.cellText(row, grid.columnIndex(u"value1"_s));
    QCOMPARE(shown, expected);
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

QTEST_MAIN(TestCompareWindow)
#include "tst_comparewindow.moc"
