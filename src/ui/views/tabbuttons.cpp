// Veltrix — KPI dashboard for small businesses.
#include "tabbuttons.h"

#include "views/tabviewbuilder.h"

#include <QHBoxLayout>
#include <QPushButton>

TabButtons::TabButtons(QWidget *parent)
    : QWidget(parent)
{
    auto *layout = new QHBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    const QStringList captions = TabViewBuilder::tabCaptions();
    for (int tab = 0; tab < captions.size(); ++tab) {
        auto *button = new QPushButton(captions[tab], this);
        button->setCheckable(true);
        button->setAutoExclusive(true);
        button->setAutoDefault(false);
        connect(button, &QPushButton::clicked, this, [this, tab] { Q_EMIT tabClicked(tab); });
        m_buttons << button;
        // As narrow as the caption allows: seven buttons must share a small screen's width.
        button->setMinimumWidth(
            button->fontMetrics().horizontalAdvance(QString(captions[tab]).remove(u'&')) + 16);
        layout->addWidget(button);
    }
    layout->addStretch();
}

void TabButtons::setCurrent(int tab)
{
    m_buttons.at(tab)->setChecked(true);
}
