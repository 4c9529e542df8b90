// Veltrix — KPI dashboard for small businesses.
#include "widgetplacement.h"

#include "common/windowplacement.h"

#include <QScreen>
#include <QWidget>

namespace WidgetPlacement {

namespace {

WindowPlacement placementFor(const QWidget &window, SettingsStore &store)
{
    const QScreen *screen = window.screen();
    const double dpi = screen ? screen->logicalDotsPerInch() : 96.0;
    return WindowPlacement(store, WindowPlacement::twipsPerPixelAt(dpi));
}

QRect availableArea(const QWidget &window)
{
    const QScreen *screen = window.screen();
    return screen ? screen->availableGeometry() : QRect();
}

} // namespace

void fitToScreen(QWidget &window)
{
    const QRect area = availableArea(window);
    const QRect fitted = WindowPlacement::centredOver(window.size(), QRect(), area);
    window.move(fitted.topLeft());
    window.resize(fitted.size());
}

void saveWindowPlacement(const QWidget &window, SettingsStore &store)
{
    WindowPlacement::State state = WindowPlacement::State::Normal;
    if (window.isMinimized())
        state = WindowPlacement::State::Minimised;
    else if (window.isMaximized())
        state = WindowPlacement::State::Maximised;
    const QRect normal(window.pos(), window.size());
    placementFor(window, store).save(window.objectName(), normal, state);
}

void restoreWindowPlacement(QWidget &window, SettingsStore &store, bool skipState)
{
    const WindowPlacement placement = placementFor(window, store);
    const QRect area = availableArea(window);
    QRect restored = placement.restore(window.objectName(), QRect(window.pos(), window.size()));
    if (!placement.hasSavedPosition(window.objectName())) {
        const QWidget *parent = window.parentWidget() ? window.parentWidget()->window() : nullptr;
        restored = WindowPlacement::centredOver(restored.size(),
                                                parent ? parent->frameGeometry() : QRect(), area);
    }
    restored = WindowPlacement::fittedInto(restored, area);
    window.move(restored.topLeft());
    window.resize(restored.size());
    if (!skipState &&
        placement.savedState(window.objectName()) == WindowPlacement::State::Maximised)
        window.setWindowState(window.windowState() | Qt::WindowMaximized);
}

} // namespace WidgetPlacement
