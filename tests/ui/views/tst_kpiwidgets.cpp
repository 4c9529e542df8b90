// Veltrix — KPI dashboard for small businesses.
#include "app/appcontext.h"
#include "app/demoworkspace.h"
#include "app/mainconnector.h"
#include "app/producecommand.h"
#include "app/settingsloader.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"
#include "grid/gridoperations.h"
#include "views/bargraphitem.h"
#include "views/grapharea.h"
#include "views/gridview.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"
#include "views/tooltippanel.h"

#include <QHeaderView>
#include <QLabel>
#include <QSignalSpy>
#include <QTemporaryDir>
#include <QTest>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

class TestKpiWidgets : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void barGeometry_data();
    void barGeometry();
    void graphPlacesBarsAndLabels();
    void tooltipPanelWidth_data();
    void tooltipPanelWidth();
    void gridViewFollowsTheModel();
    void summaryScreenshot();

private:
    NumberFormat m_numbers{QLocale(QLocale::English, QLocale::Australia)};
};

void TestKpiWidgets::initTestCase()
{
    QWidget probe;
    // The geometry below is worked out for the usual 15 twips per pixel.
    QCOMPARE(BarGraphItem::twipsPerPixelY(&probe), 15.0);
}

void TestKpiWidgets::barGeometry_data()
{
    QTest::addColumn<QString>("benchmark");
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("height");
    QTest::addColumn<int>("extra");
    QTest::addColumn<int>("lineY");
    QTest::newRow("<30 at 25") << u"<30"_s << 25.0 << 60 << 10 << 0;
    QTest::newRow(">20 at 25") << u">20"_s << 25.0 << 50 << 10 << 10;
    QTest::newRow("<30,>40 at 35") << u"<30,>40"_s << 35.0 << 70 << 10 << 10;
    QTest::newRow(">20,<10 at 5") << u">20,<10"_s << 5.0 << 40 << 30 << 0;
}

void TestKpiWidgets::barGeometry()
{
    QFETCH(QString, benchmark);
    QFETCH(double, value);
    QFETCH(int, height);
    QFETCH(int, extra);
    QFETCH(int, lineY);
    BarGraphItem bar(m_numbers);
    bar.setOptimalString(benchmark);
    bar.setActualValue(value);
    QCOMPARE(bar.height(), height);
    QCOMPARE(bar.width(), 58); // 864 twips
    QCOMPARE(bar.layout().extraHeight, extra);
    QCOMPARE(bar.layout().optimalLineY, lineY);

    // The benchmark must come first: a value set before it is not judged.
    BarGraphItem early(m_numbers);
    early.setActualValue(value);
    early.setOptimalString(benchmark);
    QCOMPARE(early.height(), 0);
}

void TestKpiWidgets::graphPlacesBarsAndLabels()
{
    GraphArea graph(m_numbers);
    graph.resize(graph.sizeHint());
    graph.setBars({{16, u">45,<35"_s, 47.5, u"1"_s, u"Panel labour gross profit %"_s},
                   {19, u">40,<30"_s, 37.0, u"2"_s, u"Panel net gross profit %"_s},
                   {3, u">40,<30"_s, 40.0, u"3"_s, u"Panel net gross profit %"_s}},
                  false);
    QCOMPARE(graph.bars().size(), 3);
    // Spread over the graph's width, each on the base line and named by its row below it.
    const int used = graph.bars().last()->geometry().right() - graph.bars().first()->x();
    QVERIFY(used >= (graph.width() - GraphArea::ScaleMargin) * 8 / 10);
    QCOMPARE(graph.bars().at(0)->y() + graph.bars().at(0)->height(), 220);
    QCOMPARE(graph.nameLabels().at(1)->text(), u"2"_s);
    QVERIFY(graph.nameLabels().at(1)->geometry().intersects(
        QRect(graph.bars().at(1)->x(), 220, graph.bars().at(1)->width(), 30)));
    QCOMPARE(graph.variantLabels().at(0)->text(), u"+2.5%"_s);
    QCOMPARE(graph.variantLabels().at(1)->text(), u"-3%"_s);
    QCOMPARE(graph.variantLabels().at(2)->text(), u"0%"_s);
    QVERIFY(graph.variantLabels().at(0)->y() < graph.bars().at(0)->y());
    QCOMPARE(graph.bars().at(1)->toolTip(),
             u"Panel net gross profit %\nValue: 37.0%\nOptimal: >40%\nVariant: -3%"_s);

    // Two periods of one Field share the width and touch.
    graph.setBars({{16, u">45"_s, 50.0}, {16, u">45"_s, 40.0}}, true, 2);
    QVERIFY(graph.variantLabels().isEmpty());
    QCOMPARE(graph.bars().at(1)->x(), graph.bars().at(0)->x() + graph.bars().at(0)->width());
    QVERIFY(graph.bars().at(0)->width() * 2 >= (graph.width() - GraphArea::ScaleMargin) * 7 / 10);
}

void TestKpiWidgets::tooltipPanelWidth_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("message");
    QTest::newRow("short title") << u"Net profit"_s << u"Gross profit less overheads."_s;
    QTest::newRow("long title, short text")
        << u"Booth running costs % of paint and materials sales, a very long label indeed"_s
        << u"Short."_s;
    QTest::newRow("no explanation") << u"Net profit"_s << QString();
}

void TestKpiWidgets::tooltipPanelWidth()
{
    QFETCH(QString, title);
    QFETCH(QString, message);
    QWidget window;
    window.resize(900, 600);
    window.show();
    QVERIFY(QTest::qWaitForWindowExposed(&window));
    TooltipPanel panel(&window);
    panel.showToolTip(title, message, QPoint(40, 60));
    const int titleWidth = panel.lblTooltipTitle()->width();
    const int messageWidth = panel.lblTooltipMessage()->width();
    QCOMPARE(messageWidth, std::max(TooltipPanel::MessageWidth, titleWidth));
    QCOMPARE(panel.width(), 2 * TooltipPanel::Margin + messageWidth);
    QCOMPARE(panel.height(), panel.lblTooltipMessage()->y() + panel.lblTooltipMessage()->height() +
                                 TooltipPanel::Margin);
    QCOMPARE(panel.pos(), QPoint(40, 60));
    QVERIFY(panel.isVisible());
    QTest::mouseClick(&panel, Qt::LeftButton);
    QVERIFY(!panel.isVisible());
}

void TestKpiWidgets::gridViewFollowsTheModel()
{
    GridModel grid;
    TabViewBuilder::addMainColumns(grid);
    GridView view(grid);
    const int row = grid.addRow();
    grid.setCellText(row, 1, u"16"_s);
    grid.addRow();
    grid.setRowVisible(2, false);
    QVERIFY(view.isColumnHidden(0)); // id: width 0
    QVERIFY(view.isColumnHidden(1)); // type
    QVERIFY(!view.isColumnHidden(4));
    QCOMPARE(view.columnWidth(4), 250);
    QVERIFY(view.isRowHidden(1));
    QCOMPARE(view.model()->headerData(6, Qt::Horizontal).toString(), u"Optimal %"_s);
    grid.setSelectedRow(1);
    QCOMPARE(view.selectionModel()->selectedRows().value(0).row(), 0);
}

void TestKpiWidgets::summaryScreenshot()
{
    // The demo shop's last financial year on the Summary tab, as the main window will show it.
    QTemporaryDir dir;
    QCOMPARE(DemoWorkspace::create(dir.filePath(u"demo"_s), QStringLiteral(VELTRIX_NEW_DB)),
             std::nullopt);
    RecordingPrompter prompter;
    AppContext context(std::make_unique<SettingsStore>(dir.filePath(u"demo/settings.ini"_s)),
                       prompter, AppLocations::inFolder(dir.filePath(u"app"_s)));
    context.setNumberFormat(m_numbers);
    QCOMPARE(loadSettings(context), QString());
    QCOMPARE(connectMainDatabase(context), QString());
    context.loginState() = LoginState{true, u"sysop"_s, 1, QString()};
    QCOMPARE(ProduceCommand(context).produce({7, 2025, 6, 2026}),
             ProduceCommand::Outcome::Produced);

    KpiTabView window(context);
    window.setWindowTitle(u"Summary"_s);
    window.resize(720, 660);
    window.show();
    QVERIFY(QTest::qWaitForWindowExposed(&window));
    window.showTab(TabViewBuilder::SummaryTab);
    GraphArea *graph = window.picGraph();
    QCOMPARE(window.lblTab()->text(), u"Summary"_s);
    QVERIFY(graph->isVisible());
    QCOMPARE(graph->bars().size(), 7);
    QSet<int> bands;
    for (const BarGraphItem *bar : graph->bars())
        bands << bar->band();
    QVERIFY(bands.size() >= 2);

    // A bar picked selects its row; the label picked explains the Field.
    QTest::mouseClick(graph->bars().at(2), Qt::LeftButton);
    QTRY_COMPARE(window.grid().cellText(window.grid().selectedRow(), 1), u"3"_s);
    window.explainRow(2);
    QVERIFY(window.picTooltip()->isVisible());
    QCOMPARE(window.picTooltip()->lblTooltipTitle()->text(), u"Panel labour gross profit %"_s);
    QVERIFY(window.picTooltip()->lblTooltipMessage()->text().startsWith(u"Panel labour sales"_s));

    // No figure is cut short, the labels take the width left, and a column the user widened
    // stays so on another tab.
    GridView *view = window.lstGrid();
    const int value = window.grid().columnIndex(u"value"_s);
    for (const int tab : {TabViewBuilder::FinancialTab, TabViewBuilder::SummaryTab}) {
        window.showTab(tab);
        for (int row = 1; row <= window.grid().rowCount(); ++row) {
            const QString text = window.grid().cellText(row, value);
            QVERIFY2(view->fontMetrics().horizontalAdvance(text) + 6 <=
                         view->columnWidth(value - 1),
                     qPrintable(text));
        }
    }
    int used = 0;
    for (int c = 0; c < view->model()->columnCount(); ++c)
        used += view->isColumnHidden(c) ? 0 : view->columnWidth(c);
    QVERIFY(used >= view->viewport()->width() - 2);
    view->horizontalHeader()->resizeSection(value - 1, 180);
    window.showTab(TabViewBuilder::FinancialTab);
    QCOMPARE(view->columnWidth(value - 1), 180);
    window.showTab(TabViewBuilder::SummaryTab);

    const QImage shot = window.grab().toImage();
    QVERIFY(!shot.isNull());
    const QString file = QStringLiteral(VELTRIX_BUILD_DIR) + u"/summary.png"_s;
    QVERIFY(shot.save(file));
    qInfo().noquote() << "Summary tab written to" << file;
}

QTEST_MAIN(TestKpiWidgets)
#include "tst_kpiwidgets.moc"
