// Veltrix — KPI dashboard for small businesses.
#include "bargraphitem.h"

#include <QImage>
#include <QPainter>
#include <QScreen>

#include <array>

namespace {

struct Look
{
    QColor column; // light shade of the body
    QColor extra;  // stronger shade of the marked span
    QColor line;
    QColor lineBelow;
};

// Red, yellow, green, by band.
const std::array<Look, 3> Looks = {{
    {QColor(0xFF, 0x98, 0x87), QColor(0xF1, 0x5E, 0x49), QColor(0xCA, 0x4B, 0x35),
     QColor(0xFF, 0xDF, 0xDA)},
    {QColor(0xFF, 0xE5, 0x6D), QColor(0xE3, 0xC1, 0x2F), QColor(0xC3, 0xA6, 0x20),
     QColor(0xFF, 0xF4, 0xC5)},
    {QColor(0xC8, 0xFF, 0x51), QColor(0xAA, 0xF3, 0x10), QColor(0x73, 0xAC, 0x00),
     QColor(0xEC, 0xFF, 0xBE)},
}};

// A 54 x 20 picture shading the colour from its lighter edges to the full colour in the
// middle, so that the stretched bar looks rounded.
QImage barPicture(const QColor &colour)
{
    QImage image(54, 20, QImage::Format_RGB32);
    for (int x = 0; x < image.width(); ++x) {
        const double distance = std::abs(x - 26.5) / 26.5;
        const QColor shade = colour.lighter(100 + int(35 * distance * distance));
        for (int y = 0; y < image.height(); ++y)
            image.setPixelColor(x, y, shade);
    }
    return image;
}

} // namespace

BarGraphItem::BarGraphItem(const NumberFormat &numbers, QWidget *parent)
    : QWidget(parent)
    , m_numbers(numbers)
{
    setFocusPolicy(Qt::StrongFocus);
    setAutoWidth(true);
}

double BarGraphItem::twipsPerPixelY(const QWidget *widget)
{
    const QScreen *screen = widget ? widget->screen() : nullptr;
    return screen ? 1440.0 / screen->logicalDotsPerInchY() : 15.0;
}

double BarGraphItem::twipsPerPixelX(const QWidget *widget)
{
    const QScreen *screen = widget ? widget->screen() : nullptr;
    return screen ? 1440.0 / screen->logicalDotsPerInchX() : 15.0;
}

void BarGraphItem::setAutoWidth(bool on)
{
    m_autoWidth = on;
    if (on) {
        const double tpp = twipsPerPixelX(this);
        resize(int(std::lround(BarLayout::barWidthTwips(tpp) / tpp)), height());
    }
}

void BarGraphItem::setActualValue(double value)
{
    m_actual = value;
    m_bar = BarLayout::layoutBar(m_optimalString, value, twipsPerPixelY(this), m_numbers, m_tag);
    resize(width(), m_bar.columnHeight);
    update();
}

void BarGraphItem::paintEvent(QPaintEvent *)
{
    if (m_bar.columnHeight <= 0)
        return;
    const Look &look = Looks.at(std::min<int>(m_bar.evaluation.band, 2));
    QPainter painter(this);
    painter.drawImage(QRect(0, 0, width(), height()), barPicture(look.column));
    if (m_bar.extraVisible) {
        const QRect extra(0, 0, width(), m_bar.extraHeight);
        painter.drawImage(extra, barPicture(look.extra));
        painter.setPen(look.line);
        painter.drawRect(extra.adjusted(0, 0, -1, -1));
    }
    painter.setPen(look.line);
    painter.drawLine(0, m_bar.optimalLineY, width() - 1, m_bar.optimalLineY);
    painter.setPen(look.lineBelow);
    painter.drawLine(0, m_bar.optimalLineY + 1, width() - 1, m_bar.optimalLineY + 1);
    if (hasFocus()) {
        painter.setPen(QPen(palette().highlight(), 1, Qt::DotLine));
        painter.drawRect(rect().adjusted(0, 0, -1, -1));
    }
}

void BarGraphItem::focusInEvent(QFocusEvent *event)
{
    QWidget::focusInEvent(event);
    update();
    Q_EMIT focused(m_tag);
}

void BarGraphItem::mousePressEvent(QMouseEvent *event)
{
    setFocus(Qt::MouseFocusReason);
    QWidget::mousePressEvent(event);
}
