// Veltrix — KPI dashboard for small businesses.
#include "grapharea.h"

#include "bargraphitem.h"

#include "common/numberformat.h"
#include "views/barlayout.h"
#include "views/kpievaluation.h"

#include <QLabel>
#include <QPainter>

#include <cmath>

namespace {
// The scale in twips: the base line and ten grid lines above it every 300 twips.
constexpr int ScaleWidth = 10050;
constexpr int ScaleLines[] = {3300, 3000, 2700, 2400, 2100, 1800, 1500, 1200, 900, 600, 315};
constexpr int LabelGap = 8;
} // namespace

GraphArea::GraphArea(const NumberFormat &numbers, QWidget *parent)
    : QWidget(parent)
    , m_numbers(numbers)
{
    setAutoFillBackground(true);
    QPalette background = palette();
    background.setColor(QPalette::Window, Qt::white);
    setPalette(background);
}

int GraphArea::toPixelsX(int twips) const
{
    return int(std::lround(twips / BarGraphItem::twipsPerPixelX(this)));
}

int GraphArea::toPixelsY(int twips) const
{
    return int(std::lround(twips / BarGraphItem::twipsPerPixelY(this)));
}

QSize GraphArea::sizeHint() const
{
    return {ScaleMargin + toPixelsX(ScaleWidth),
            toPixelsY(ScaleLines[0]) + fontMetrics().height() + 6};
}

void GraphArea::setBars(const QList<BarSpec> &specs, bool compare)
{
    m_compare = compare;
    qDeleteAll(m_bars);
    qDeleteAll(m_labels);
    qDeleteAll(m_names);
    m_bars.clear();
    m_labels.clear();
    m_names.clear();

    for (qsizetype n = 0; n < specs.size(); ++n) {
        const BarSpec &wanted = specs[n];
        auto *bar = new BarGraphItem(m_numbers, this);
        bar->setTag(wanted.fieldId);
        bar->setOptimalString(wanted.benchmark);
        bar->setActualValue(wanted.value);
        bar->setAutoWidth(false);
        connect(bar, &BarGraphItem::focused, this, &GraphArea::barFocused);
        const QString variant = BarLayout::tooltip(bar->variantValue(), m_numbers);
        QStringList tip{wanted.label.isEmpty() ? wanted.name : wanted.label};
        if (!wanted.period.isEmpty())
            tip << wanted.period;
        tip << tr("Value: %1%").arg(m_numbers.locale().toString(wanted.value, 'f', 1))
            << tr("Optimal: %1").arg(KpiEvaluation::benchmarkCellText(wanted.benchmark))
            << tr("Variant: %1").arg(variant);
        bar->setToolTip(tip.join(u'\n'));
        bar->show();
        m_bars << bar;
        if (!compare) {
            auto *label = new QLabel(variant, this);
            label->adjustSize();
            label->show();
            m_labels << label;
        }
        if (n == 0 || specs[n - 1].fieldId != wanted.fieldId) {
            auto *name = new QLabel(wanted.name, this);
            name->setAlignment(Qt::AlignHCenter | Qt::AlignTop);
            name->setToolTip(wanted.label);
            name->show();
            m_names << name;
        }
    }
    layoutBars();
}

void GraphArea::layoutBars()
{
    QList<qint64> ids;
    for (const BarGraphItem *bar : std::as_const(m_bars))
        ids << bar->tag();
    const int baseLine = toPixelsY(ScaleLines[0]);
    const BarLayout::Spread spread = BarLayout::spreadBars(ids, width() - ScaleMargin);
    for (int n = 0; n < m_bars.size(); ++n) {
        BarGraphItem *bar = m_bars[n];
        const int height = bar->layout().columnHeight;
        bar->setGeometry(ScaleMargin + spread.lefts[n], baseLine - height, spread.barWidth, height);
        if (n < m_labels.size()) {
            QLabel *label = m_labels[n];
            label->move(bar->x() + (bar->width() - label->width()) / 2,
                        bar->y() - label->height() - toPixelsY(LabelGap));
        }
    }
    for (int g = 0; g < m_names.size() && g < spread.groups.size(); ++g) {
        const auto [left, right] = spread.groups[g];
        m_names[g]->setGeometry(ScaleMargin + left, baseLine + 2, right - left,
                                fontMetrics().height() + 2);
    }
}

void GraphArea::resizeEvent(QResizeEvent *event)
{
    QWidget::resizeEvent(event);
    layoutBars();
}

int GraphArea::scaleRight() const
{
    return width();
}

void GraphArea::paintEvent(QPaintEvent *)
{
    QPainter painter(this);
    const int right = scaleRight();
    for (int i = 0; i < 11; ++i) {
        painter.setPen(i == 0 ? QColor(0x80, 0x80, 0x80) : QColor(0xE0, 0xE0, 0xE0));
        const int y = toPixelsY(ScaleLines[i]);
        painter.drawLine(ScaleMargin, y, right, y);
        if (i > 0) {
            painter.setPen(QColor(0x60, 0x60, 0x60));
            painter.drawText(QRect(0, y - 7, ScaleMargin - 4, 14),
                             Qt::AlignRight | Qt::AlignVCenter, QString::number(i * 10));
        }
    }
}
