// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QList>
#include <QWidget>

class QPushButton;

// The row of tab buttons over a KPI view: "All", "Summary" and the other tabs, one pressed.
class TabButtons : public QWidget
{
    Q_OBJECT

public:
    explicit TabButtons(QWidget *parent = nullptr);

    // Shows the tab's button pressed, without announcing it.
    void setCurrent(int tab);
    QPushButton *button(int tab) const { return m_buttons.at(tab); }

Q_SIGNALS:
    void tabClicked(int tab);

private:
    QList<QPushButton *> m_buttons;
};
