// Veltrix — KPI dashboard for small businesses.
#include "comparewindow.h"

#include "bargraphitem.h"
#include "gridview.h"
#include "kpitabview.h"
#include "tabbuttons.h"

#include "app/appcontext.h"
#include "app/contextwiring.h"
#include "app/widgetplacement.h"
#include "common/numberformat.h"
#include "common/settingsstore.h"
#include "engine/rangeloader.h"
#include "report/gridreport.h"
#include "views/kpigrid.h"
#include "views/tabviewbuilder.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QLabel>
#include <QMenuBar>
#include <QPushButton>
#include <QStyle>
#include <QTimer>
#include <QVBoxLayout>

#include <cmath>

using namespace Qt::StringLiterals;

namespace {
constexpr int ProgressWidth = 300;
constexpr int ProgressHeight = 18;
constexpr int ProgressGap = 10;
} // namespace

CompareWindow::CompareWindow(AppContext &context, ComparisonRanges::Kind kind, int count,
                             QWidget *owner)
    : QDialog(owner)
    , m_context(context)
    , m_kind(kind)
    , m_count(std::clamp(count, 1, PeriodDataSet::SlotCount - 1))
    , m_tmrStart(new QTimer(this))
    , m_tabView(new KpiTabView(context, this, m_count))
    , m_tabButtons(new TabButtons(this))
    , m_picLoad(new QWidget(this))
    , m_lblLoad(new QLabel(m_picLoad))
    , m_lblLegend(new QLabel(this))
    , m_picProgress(new QWidget(m_picLoad))
    , m_shpProgress(new QWidget(m_picProgress))
{
    setObjectName(u"frmCompare"_s);
    setWindowTitle(u"The Big Picture"_s);

    auto *menu = new QMenuBar(this);
    menu->addAction(u"&Print"_s, this, &CompareWindow::print);
    menu->addAction(u"&Close"_s, this, &QDialog::accept);

    connect(m_tabButtons, &TabButtons::tabClicked, this, &CompareWindow::selectTab);
    auto *layout = new QVBoxLayout(this);
    layout->setMenuBar(menu);
    layout->addWidget(m_tabButtons);
    m_lblLegend->setObjectName(u"lblLegend"_s);
    m_lblLegend->setWordWrap(true);
    layout->addWidget(m_lblLegend);
    layout->addWidget(m_tabView, 1);

    m_picLoad->setObjectName(u"picLoad"_s);
    m_picLoad->setAutoFillBackground(true);
    m_lblLoad->setObjectName(u"lblLoad"_s);
    m_lblLoad->setAlignment(Qt::AlignCenter);
    const bool years = m_kind == ComparisonRanges::Kind::Years;
    const QString kindText =
        m_count == 1 ? (years ? u"Year"_s : u"Period"_s) : (years ? u"Years"_s : u"Periods"_s);
    m_lblLoad->setText(u"Please wait while we load the past '"_s + QString::number(m_count) +
                       u" "_s + kindText + u"' of data..."_s);
    m_picProgress->setObjectName(u"picProgress"_s);
    m_picProgress->setFixedSize(ProgressWidth, ProgressHeight);
    m_picProgress->setStyleSheet(
        u"#picProgress { border: 1px solid #808080; background: white; }"_s);
    m_shpProgress->setObjectName(u"shpProgress"_s);
    m_shpProgress->setStyleSheet(u"background: #3A7BD5;"_s);
    m_shpProgress->setGeometry(0, 0, 0, ProgressHeight);

    const double twipsPerPixel = BarGraphItem::twipsPerPixelY(this);
    setMinimumHeight(int(std::ceil(MinimumHeightTwips / twipsPerPixel)));
    resize(1000, 700);
    WidgetPlacement::restoreWindowPlacement(*this, m_context.settingsStore(), false);

    m_picLoad->show();
    m_picLoad->raise();
    layoutLoadingPanel();

    m_tmrStart->setSingleShot(true);
    m_tmrStart->setInterval(100);
    connect(m_tmrStart, &QTimer::timeout, this, &CompareWindow::loadPeriods);
    m_tmrStart->start();
}

CompareWindow::~CompareWindow() = default;

void CompareWindow::compareData(AppContext &context, QWidget *owner, const QString &kind, int count)
{
    const std::optional<ComparisonRanges::Kind> parsed = ComparisonRanges::kindFromText(kind);
    CompareWindow window(context, parsed.value_or(ComparisonRanges::Kind::Years), count, owner);
    window.exec();
}

QString CompareWindow::rangeHeader(const PeriodDataSet::Range &range, const QLocale &locale)
{
    // English regions abbreviate some months to four letters ("July", "Sept"); the headers
    // keep the three-letter forms so that the columns line up.
    const QLocale names = locale.language() == QLocale::English ? QLocale::c() : locale;
    return names.toString(range.start, u"MMM yy"_s) + u" - "_s +
           names.toString(range.end, u"MMM yy"_s);
}

void CompareWindow::loadPeriods()
{
    m_tmrStart->stop();
    PeriodDataSet &data = m_context.periodDataSet();
    GridModel &grid = m_tabView->grid();
    const QLocale &locale = m_context.numberFormat().locale();
    const double step = double(ProgressWidth) / m_count;
    grid.setColumnHeader(grid.columnIndex(u"value"_s), rangeHeader(data.range(0), locale));

    const QList<PeriodDataSet::Range> ranges =
        ComparisonRanges::earlierRanges(data.range(0), m_kind, m_count);
    for (int slot = 1; slot <= ranges.size(); ++slot) {
        const int column = grid.columnIndex(u"value"_s + QString::number(slot));
        grid.setColumnVisible(column, true);
        grid.setColumnHeader(column, rangeHeader(ranges[slot - 1], locale));
        ContextWiring::rangeLoader(m_context).loadSlot(slot, ranges[slot - 1].start,
                                                       ranges[slot - 1].end);
        m_shpProgress->resize(int(std::lround(step * slot)), ProgressHeight);
        // The window is modal: only its own repaints and input run here.
        QCoreApplication::processEvents();
        if (m_unloaded)
            return;
    }
    data.setCurrentSlot(0);
    QStringList periods;
    for (int slot = int(ranges.size()); slot >= 0; --slot)
        periods << m_tabView->periodName(slot);
    m_lblLegend->setText(
        u"Bars of each line, left to right: %1.&nbsp;&nbsp;&nbsp;<span style='background:%2'>"
        u"&nbsp;&nbsp;&nbsp;&nbsp;</span> the best period of a line: the highest figure, or the "
        u"lowest for costs and for shares that should stay under their benchmark."_s.arg(
            periods.join(u" · "_s).toHtmlEscaped(), KpiGrid::Highest.name()));
    selectTab(m_currentTab);
    m_picLoad->hide();
    m_loading = false;
    Q_EMIT loaded();
}

QPushButton *CompareWindow::tabButton(int tab) const
{
    return m_tabButtons->button(tab);
}

void CompareWindow::selectTab(int tab)
{
    m_currentTab = tab;
    m_tabButtons->setCurrent(tab);
    m_tabView->showTab(tab);
}

void CompareWindow::print()
{
    if (m_loading)
        return;
    GridReport::printGrid(m_context, this, *m_tabView);
}

void CompareWindow::layoutLoadingPanel()
{
    m_picLoad->setGeometry(rect());
    m_lblLoad->adjustSize();
    m_lblLoad->move((width() - m_lblLoad->width()) / 2, (height() - m_lblLoad->height()) / 2);
    m_picProgress->move((width() - ProgressWidth) / 2,
                        m_lblLoad->geometry().bottom() + ProgressGap);
}

void CompareWindow::resizeEvent(QResizeEvent *event)
{
    QDialog::resizeEvent(event);
    layoutLoadingPanel();
}

void CompareWindow::done(int result)
{
    if (!m_unloaded) {
        m_unloaded = true;
        m_tmrStart->stop();
        WidgetPlacement::saveWindowPlacement(*this, m_context.settingsStore());
    }
    QDialog::done(result);
}
