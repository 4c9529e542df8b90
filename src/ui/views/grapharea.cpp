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

void GraphArea::setBars(const QList<BarSpec> &specs, bool compare)
{
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
}

void GraphArea::paintEvent(QPaintEvent *)
{
    QPainter painter(this);
    const int right = ScaleMargin + toPixelsX(ScaleWidth);
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
