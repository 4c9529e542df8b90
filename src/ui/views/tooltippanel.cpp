// Veltrix — KPI dashboard for small businesses.
#include "tooltippanel.h"

#include <QLabel>

TooltipPanel::TooltipPanel(QWidget *parent)
    : QFrame(parent)
    , m_title(new QLabel(this))
    , m_message(new QLabel(this))
{
    setObjectName(QStringLiteral("picTooltip"));
    setFrameShape(QFrame::Box);
    setFocusPolicy(Qt::StrongFocus);
    setAutoFillBackground(true);
    QPalette colours = palette();
    colours.setColor(QPalette::Window, QColor(0xFF, 0xFF, 0xE1));
    setPalette(colours);

    m_title->setObjectName(QStringLiteral("lblTooltipTitle"));
    QFont bold = m_title->font();
    bold.setBold(true);
    m_title->setFont(bold);
    m_title->move(Margin, Margin);
    m_message->setObjectName(QStringLiteral("lblTooltipMessage"));
    m_message->setWordWrap(true);
    m_message->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    hide();
}

void TooltipPanel::showToolTip(const QString &title, const QString &message, const QPoint &topLeft)
{
    m_title->setText(title);
    m_title->adjustSize();
    // The message is at least as wide as the title; its height follows its text.
    const int width = std::max(MessageWidth, m_title->width());
    m_message->setText(message);
    m_message->setFixedWidth(width);
    m_message->setFixedHeight(message.isEmpty() ? 0 : m_message->heightForWidth(width));
    m_message->move(Margin, m_title->y() + m_title->height() + Margin / 2);

    resize(2 * Margin + width, m_message->y() + m_message->height() + Margin);
    move(topLeft);
    show();
    raise();
    setFocus(Qt::OtherFocusReason);
}

void TooltipPanel::mousePressEvent(QMouseEvent *event)
{
    QFrame::mousePressEvent(event);
    hide();
}

void TooltipPanel::focusOutEvent(QFocusEvent *event)
{
    QFrame::focusOutEvent(event);
    hide();
}
