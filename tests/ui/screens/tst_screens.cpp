// Veltrix — KPI dashboard for small businesses.
// Pictures of the windows as a user sees them, at the screen the test runs on (one screen
// configuration per ctest entry), under build/screenshots/, and the geometry they must keep:
// every window inside the screen, no figure cut short, the graph's bars over the graph's width.
#include "testworkspace.h"

#include "app/demoworkspace.h"
#include "app/widgetplacement.h"
#include "main/mainwindow.h"
#include "report/gridhtml.h"
#include "report/gridreport.h"
#include "report/pagesetup.h"
#include "report/reportrenderer.h"
#include "views/bargraphitem.h"
#include "views/comparewindow.h"
#include "views/grapharea.h"
#include "views/gridview.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"

#include <QComboBox>
#include <QDir>
#include <QPdfWriter>
#include <QProcess>
#include <QScreen>
#include <QSignalSpy>
#include <QTest>

using namespace Qt::StringLiterals;

class TestScreens : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void mainWindowOnEveryTab();
    void comparisonOfFourYears();
    void printedPages();

private:
    void save(QWidget &window, const QString &name);
    static void checkView(const KpiTabView &view, const QString &where);
    QRect screenArea() const { return QGuiApplication::primaryScreen()->availableGeometry(); }

    TestWorkspace m_workspace{Clock::fixedAt(QDateTime(QDate(2026, 12, 7), QTime(10, 0)))};
    QString m_folder;
    QString m_suffix;
    std::unique_ptr<MainWindow> m_main;
};

void TestScreens::initTestCase()
{
    const QScreen *screen = QGuiApplication::primaryScreen();
    m_suffix = u"-ratio%1"_s.arg(screen->devicePixelRatio());
    m_folder = QStringLiteral(VELTRIX_BUILD_DIR) + u"/screenshots"_s;
    QVERIFY(QDir().mkpath(m_folder));
    QVERIFY(m_workspace.configure());
    const QString demo = m_workspace.path(u"demo"_s);
    QCOMPARE(DemoWorkspace::create(demo, QStringLiteral(VELTRIX_NEW_DB)), std::nullopt);
    DemoWorkspace::configure(m_workspace.store(), demo);
    QVERIFY(m_workspace.connect());
    m_main = std::make_unique<MainWindow>(m_workspace.context(), m_workspace.prompter());
    WidgetPlacement::fitToScreen(*m_main);
    QVERIFY(screenArea().contains(m_main->frameGeometry()));
    m_main->showMaximized();
    QVERIFY(QTest::qWaitForWindowExposed(m_main.get()));
    m_main->login(u"manager"_s, u"manager1"_s);
    m_main->lstMonth1()->setCurrentIndex(6);
    m_main->lstYear1()->setEditText(u"2025"_s);
    m_main->lstMonth2()->setCurrentIndex(5);
    m_main->lstYear2()->setEditText(u"2026"_s);
    m_main->produce();
    QVERIFY(m_main->tabView()->grid().rowCount() > 5);
}

void TestScreens::save(QWidget &window, const QString &name)
{
    const QString file = m_folder + u'/' + name + m_suffix + u".png"_s;
    QVERIFY2(window.grab().save(file), qPrintable(file));
}

void TestScreens::checkView(const KpiTabView &view, const QString &where)
{
    const GridModel &grid = view.grid();
    const GridView *table = view.lstGrid();
    for (int c = 1; c <= grid.columnCount(); ++c) {
        if (table->isColumnHidden(c - 1) || c == grid.columnIndex(u"label"_s))
            continue;
        for (int r = 1; r <= grid.rowCount(); ++r) {
            const QString text = grid.cellText(r, c);
            QVERIFY2(table->fontMetrics().horizontalAdvance(text) < table->columnWidth(c - 1),
                     qPrintable(where + u": "_s + text));
        }
    }
    const GraphArea *graph = view.picGraph();
    if (!graph->isVisible() || graph->bars().isEmpty())
        return;
    const int used = graph->bars().last()->geometry().right() - graph->bars().first()->x();
    QVERIFY2(used >= (graph->width() - GraphArea::ScaleMargin) * 8 / 10, qPrintable(where));
}

void TestScreens::mainWindowOnEveryTab()
{
    for (int tab = 0; tab < TabViewBuilder::TabCount; ++tab) {
        m_main->selectTab(tab);
        checkView(*m_main->tabView(), u"tab %1"_s.arg(tab));
        save(*m_main, u"main-tab%1"_s.arg(tab));
    }
    m_main->selectTab(TabViewBuilder::SummaryTab);
    QVERIFY(screenArea().contains(m_main->frameGeometry()));
}

void TestScreens::comparisonOfFourYears()
{
    CompareWindow window(m_workspace.context(), ComparisonRanges::Kind::Years, 4, m_main.get());
    window.show();
    QVERIFY(QTest::qWaitForWindowExposed(&window));
    QSignalSpy loaded(&window, &CompareWindow::loaded);
    QVERIFY(!window.isLoading() || loaded.wait(20000));
    window.selectTab(TabViewBuilder::SummaryTab);
    QVERIFY(screenArea().contains(window.frameGeometry()));
    checkView(*window.tabView(), u"comparison"_s);
    save(window, u"compare-summary"_s);
}

void TestScreens::printedPages()
{
    // All lines over several pages, and the Summary with its graph's picture, which keeps the
    // graph's size whatever the screen's density.
    for (const int tab : {0, int(TabViewBuilder::SummaryTab)}) {
        m_main->selectTab(tab);
        const QString picture = GridReport::graphPicture(m_workspace.context(), *m_main->tabView());
        QCOMPARE(picture.isEmpty(), tab == 0);
        const QString name = m_folder + u"/print-tab%1"_s.arg(tab) + m_suffix;
        {
            QPdfWriter writer(name + u".pdf"_s);
            PrintOptions options;
            options.printBackground = true;
            const QString page = GridHtml::reportPage(m_main->tabView()->grid(), u"id"_s, picture);
            QCOMPARE(ReportRenderer(page, m_folder).print(writer, options) >= 2, tab == 0);
        }
        QProcess render;
        render.start(u"pdftoppm"_s, {u"-png"_s, u"-r"_s, u"80"_s, u"-f"_s, u"1"_s, u"-l"_s, u"2"_s,
                                     name + u".pdf"_s, name});
        QVERIFY(render.waitForFinished(60000));
        QCOMPARE(render.exitCode(), 0);
    }
}

QTEST_MAIN(TestScreens)
#include "tst_screens.moc"
