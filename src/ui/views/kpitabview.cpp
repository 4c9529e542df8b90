// Veltrix — KPI dashboard for small businesses.
#include "kpitabview.h"

#include "grapharea.h"
#include "gridview.h"
#include "tooltippanel.h"

#include "app/appcontext.h"
#include "app/contextwiring.h"
#include "database/recordoperations.h"
#include "grid/gridoperations.h"
#include "views/kpigrid.h"
#include "views/tabviewbuilder.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

KpiTabView::KpiTabView(AppContext &context, QWidget *parent, int pastCount)
    : QWidget(parent)
    , m_context(context)
    , m_pastCount(pastCount)
    , m_caption(new QLabel(this))
    , m_graph(new GraphArea(context.numberFormat(), this))
    , m_gridView(new GridView(m_grid, this))
    , m_tooltip(new TooltipPanel(this))
{
    m_caption->setObjectName(u"lblTab"_s);
    QFont captionFont = m_caption->font();
    captionFont.setBold(true);
    captionFont.setPointSizeF(captionFont.pointSizeF() * 1.3);
    m_caption->setFont(captionFont);
    m_graph->setObjectName(u"picGraph"_s);
    m_gridView->setObjectName(u"lstGrid"_s);
    if (m_pastCount > 0)
        TabViewBuilder::addCompareColumns(m_grid);
    else
        TabViewBuilder::addMainColumns(m_grid);
    // The figures take the width they need; the labels take the rest of the window.
    m_gridView->setFittedColumn(m_grid.columnIndex(u"label"_s));

    auto *layout = new QVBoxLayout(this);
    m_captionRow = new QHBoxLayout;
    m_captionRow->addWidget(m_caption);
    m_captionRow->addStretch();
    layout->addLayout(m_captionRow);
    layout->addWidget(m_graph);
    layout->addWidget(m_gridView, 1);

    connect(m_graph, &GraphArea::barFocused, this, &KpiTabView::selectField);
    connect(m_gridView, &GridView::cellPicked, this, [this](int row, int column) {
        if (column == m_grid.columnIndex(u"label"_s))
            explainRow(row);
    });
}

KpiTabView::~KpiTabView()
{
    // The grid view shows m_grid: it must go before the grid does, not with the other
    // children after it, or closing the window would draw from a grid that is gone.
    delete m_gridView;
}

void KpiTabView::showTab(int tab)
{
    m_tab = tab;
    m_caption->setText(TabViewBuilder::tabCaptions().value(tab).remove(u'&'));
    m_gridView->hide();
    TabViewBuilder builder = ContextWiring::tabViewBuilder(m_context, m_grid);
    builder.buildTabView(tab, m_pastCount);
    if (m_pastCount > 0) {
        KpiGrid(m_grid, m_context.periodDataSet(), m_context.mainDatabase(), m_context.prompter(),
                m_context.numberFormat())
            .computeAverages(m_pastCount);
    }
    m_gridView->show();
    if (tab == TabViewBuilder::SummaryTab) {
        QList<GraphArea::BarSpec> bars;
        const int rowColumn = m_grid.columnIndex(u"row"_s);
        const int labelColumn = m_grid.columnIndex(u"label"_s);
        for (const TabViewBuilder::GraphBar &bar : builder.graphBars(m_grid, m_pastCount)) {
            const int row = GridOperations::findGridRow(m_grid, 1, QString::number(bar.fieldId));
            bars << GraphArea::BarSpec{bar.fieldId,
                                       bar.benchmark,
                                       bar.value,
                                       m_grid.cellText(row, rowColumn),
                                       m_grid.cellText(row, labelColumn),
                                       m_pastCount > 0 ? periodName(bar.slot) : QString()};
        }
        m_graph->setBars(bars, m_pastCount > 0);
    }
    m_graph->setVisible(tab == TabViewBuilder::SummaryTab);
}

void KpiTabView::setCaptionCompanion(QWidget *widget)
{
    m_captionRow->addWidget(widget);
}

QString KpiTabView::periodName(int slot) const
{
    const PeriodDataSet::Range range = m_context.periodDataSet().range(slot);
    const QLocale &locale = m_context.numberFormat().locale();
    const QString first = locale.toString(range.start, u"MMM yyyy"_s);
    const QString last = locale.toString(range.end, u"MMM yyyy"_s);
    return first == last ? first : first + u" – "_s + last;
}

void KpiTabView::clear()
{
    m_grid.clear();
    m_graph->setBars({}, m_pastCount > 0);
    m_tooltip->hide();
    m_caption->clear();
}

void KpiTabView::selectField(qint64 fieldId)
{
    m_grid.setSelectedRow(GridOperations::findGridRow(m_grid, 1, QString::number(fieldId)));
    m_gridView->setFocus();
}

void KpiTabView::explainRow(int row)
{
    MainDatabase &database = m_context.mainDatabase();
    RecordSet &fields = database.fieldsRecordset();
    const qint64 id = m_grid.cellText(row, 1).toLongLong();
    if (!RecordOperations(database, m_context.prompter()).findRecordById(fields, id))
        return;
    const QString message = fields.value(u"tooltip"_s).toString();
    const QString title = m_grid.cellText(row, m_grid.columnIndex(u"label"_s));
    const QRect cell = m_gridView->cellRect(row, m_grid.columnIndex(u"label"_s));
    const QPoint underCell =
        m_gridView->viewport()->mapTo(this, QPoint(cell.left(), cell.bottom() + 1));
    m_tooltip->showToolTip(title, message, underCell);
}
