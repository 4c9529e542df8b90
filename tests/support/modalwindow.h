// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QApplication>
#include <QDialog>
#include <QTimer>

#include <functional>

// Modal windows run their own event loop; a test acts in them from a timer. Runs the action
// on the first modal window of type T that opens, then rejects it if it is still open.
template<typename T> void whenModalOpens(std::function<void(T &)> action)
{
    auto *poll = new QTimer;
    QObject::connect(poll, &QTimer::timeout, poll, [poll, action] {
        if (auto *window = qobject_cast<T *>(QApplication::activeModalWidget())) {
            poll->stop();
            poll->deleteLater();
            action(*window);
            if (window->isVisible())
                window->reject();
        }
    });
    poll->start(10);
}
