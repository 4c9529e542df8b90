// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QFrame>

class QLabel;

// picTooltip: explains a KPI Field in a small panel opened under the picked "Field" cell, with
// the Field's label as title and its explanation below. A click on it, or taking the focus
// elsewhere, closes it.
class TooltipPanel : public QFrame
{
    Q_OBJECT

public:
    explicit TooltipPanel(QWidget *parent = nullptr);

    // Shows the panel with its top left corner at the point (the parent's coordinates).
    void showToolTip(const QString &title, const QString &message, const QPoint &topLeft);

    QLabel *lblTooltipTitle() const { return m_title; }
    QLabel *lblTooltipMessage() const { return m_message; }

    static constexpr int Margin = 8;
    static constexpr int MessageWidth = 260;

protected:
    void mousePressEvent(QMouseEvent *event) override;
    void focusOutEvent(QFocusEvent *event) override;

private:
    QLabel *m_title;
    QLabel *m_message;
};
