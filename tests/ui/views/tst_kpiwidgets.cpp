// Veltrix — KPI dashboard for small businesses.
#include "app/appcontext.h"
#include "app/demoworkspace.h"
#include "app/mainconnector.h"
#include "app/producecommand.h"
#include "app/settingsloader.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"
#include "views/bargraphitem.h"
#include "views/grapharea.h"
#include "views/gridview.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"
#include "views/tooltippanel.h"

#include <QHeaderView>
#include <QLabel>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

class TestKpiWidgets : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void graphPlacesBarsAndLabels();
    void gridViewFollowsTheModel();
    void summaryTab();

private:
    NumberFormat m_numbers{QLocale(QLocale::English, QLocale::Australia)};
};

void TestKpiWidgets::initTestCase()
{
    QWidget probe;
    // The geometry below is worked out for the usual 15 twips per pixel.
    QCOMPARE(BarGraphItem::twipsPerPixelY(&probe), 15.0);
}

void TestKpiWidgets::graphPlacesBarsAndLabels()
{
    GraphArea graph(m_numbers);
    graph.resize(graph.sizeHint());
    graph.setBars({{16, u">45,<35"_s, 47.5, u"1"_s, u"Panel labour gross profit %"_s, {}},
                   {19, u">40,<30"_s, 37.0, u"2"_s, u"Panel net gross profit %"_s, {}}},
                  false);
    QCOMPARE(graph.bars().size(), 2);
    // Each bar stands on the base line, named by its row below it, its variant above it.
    const BarGraphItem *bar = graph.bars().at(1);
    QCOMPARE(bar->y() + bar->height(), 220);
    QCOMPARE(graph.nameLabels().at(1)->text(), u"2"_s);
    QVERIFY(
        graph.nameLabels().at(1)->geometry().intersects(QRect(bar->x(), 220, bar->width(), 30)));
    QCOMPARE(graph.variantLabels().at(1)->text(), u"-3%"_s);
    QVERIFY(graph.variantLabels().at(1)->y() < bar->y());
    QCOMPARE(bar->toolTip(),
             u"Panel net gross profit %\nValue: 37.0%\nOptimal: >40%\nVariant: -3%"_s);

    // The benchmark must come first: a value set before it is not judged.
    BarGraphItem early(m_numbers);
    early.setActualValue(25.0);
    early.setOptimalString(u"<30"_s);
    QCOMPARE(early.height(), 0);
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

void TestKpiWidgets::summaryTab()
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
    TooltipPanel *panel = window.picTooltip();
    QVERIFY(panel->isVisible());
    QCOMPARE(panel->lblTooltipTitle()->text(), u"Panel labour gross profit %"_s);
    QVERIFY(panel->lblTooltipMessage()->text().startsWith(u"Panel labour sales"_s));
    const int messageWidth = panel->lblTooltipMessage()->width();
    QCOMPARE(messageWidth, std::max(TooltipPanel::MessageWidth, panel->lblTooltipTitle()->width()));
    QCOMPARE(panel->width(), 2 * TooltipPanel::Margin + messageWidth);
    QCOMPARE(panel->height(), panel->lblTooltipMessage()->y() +
                                  panel->lblTooltipMessage()->height() + TooltipPanel::Margin);
    QTest::mouseClick(panel, Qt::LeftButton);
    QVERIFY(!panel->isVisible());

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
}

QTEST_MAIN(TestKpiWidgets)
#include "tst_kpiwidgets.moc"
