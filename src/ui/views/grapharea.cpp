// Veltrix — KPI dashboard for small businesses.
#include "grapharea.h"

#include "bargraphitem.h"

#include "views/barlayout.h"

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
    return {ScaleMargin + toPixelsX(ScaleWidth), toPixelsY(ScaleLines[0]) + 20};
}

void GraphArea::setBars(const QList<BarSpec> &specs, bool compare, int periods)
{
    m_compare = compare;
    m_periods = std::max(1, periods);
    qDeleteAll(m_bars);
    qDeleteAll(m_labels);
    m_bars.clear();
    m_labels.clear();

    QList<qint64> ids;
    QList<int> heights;
    for (const BarSpec &wanted : specs) {
        auto *bar = new BarGraphItem(m_numbers, this);
        bar->setTag(wanted.fieldId);
        bar->setOptimalString(wanted.benchmark);
        bar->setActualValue(wanted.value);
        connect(bar, &BarGraphItem::focused, this, &GraphArea::barFocused);
        m_bars << bar;
        ids << wanted.fieldId;
        heights << bar->layout().columnHeight;
    }
    const QList<BarLayout::Placement> places =
        BarLayout::placeBars(ids, heights, BarGraphItem::twipsPerPixelX(this),
                             BarGraphItem::twipsPerPixelY(this), compare);
    for (int n = 0; n < m_bars.size(); ++n) {
        BarGraphItem *bar = m_bars[n];
        bar->move(ScaleMargin + toPixelsX(places[n].left), toPixelsY(places[n].top));
        const QString tip = BarLayout::tooltip(bar->variantValue(), m_numbers);
        bar->setToolTip(tip);
        bar->show();
        if (compare)
            continue;
        auto *label = new QLabel(tip, this);
        label->adjustSize();
        label->move(bar->x(), bar->y() - label->height() - toPixelsY(LabelGap));
        label->show();
        m_labels << label;
    }
    if (compare)
        layoutCompareBars();
}

void GraphArea::layoutCompareBars()
{
    QList<qint64> ids;
    for (const BarGraphItem *bar : std::as_const(m_bars))
        ids << bar->tag();
    const double tpp = BarGraphItem::twipsPerPixelX(this);
    const int innerTwips = int(std::lround((width() - ScaleMargin) * tpp));
    const BarLayout::CompareLayout layout =
        BarLayout::layoutCompareBars(ids, m_periods, BarLayout::FirstLeft, innerTwips);
    for (int n = 0; n < m_bars.size(); ++n) {
        BarGraphItem *bar = m_bars[n];
        bar->setAutoWidth(false);
        const int left = ScaleMargin + toPixelsX(layout.lefts[n]);
        const int right = ScaleMargin + toPixelsX(layout.lefts[n] + layout.barWidth);
        bar->setGeometry(left, bar->y(), std::max(1, right - left), bar->height());
    }
}

void GraphArea::resizeEvent(QResizeEvent *event)
{
    QWidget::resizeEvent(event);
    if (m_compare)
        layoutCompareBars();
}

int GraphArea::scaleRight() const
{
    // A comparison stretches its scale over the whole width; the main graph keeps its own.
    return m_compare ? width() : ScaleMargin + toPixelsX(ScaleWidth);
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
