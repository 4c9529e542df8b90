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

// What the window system adds around a window, as seen on one already shown; a window not yet
// shown is decorated the same way.
QMargins frameMargins(const QWidget *shown)
{
    if (!shown || !shown->isVisible())
        return {};
    const QRect frame = shown->frameGeometry();
    const QRect inner = shown->geometry();
    return {inner.left() - frame.left(), inner.top() - frame.top(), frame.right() - inner.right(),
            frame.bottom() - inner.bottom()};
}

// Places the window's frame at the rectangle: its position includes the frame, its size not.
void placeFrame(QWidget &window, const QRect &frame, const QMargins &margins)
{
    window.move(frame.topLeft());
    window.resize(frame.marginsRemoved(margins).size());
}

} // namespace

void fitToScreen(QWidget &window)
{
    const QRect area = availableArea(window);
    const QRect fitted = WindowPlacement::centredOver(window.size(), QRect(), area);
    placeFrame(window, fitted, {});
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
    const QWidget *parent = window.parentWidget() ? window.parentWidget()->window() : nullptr;
    const QMargins margins = frameMargins(parent);
    QRect restored = placement.restore(window.objectName(), QRect(window.pos(), window.size()));
    restored.setSize(restored.size().grownBy(margins));
    if (!placement.hasSavedPosition(window.objectName())) {
        restored = WindowPlacement::centredOver(restored.size(),
                                                parent ? parent->frameGeometry() : QRect(), area);
    }
    placeFrame(window, WindowPlacement::fittedInto(restored, area), margins);
    if (!skipState &&
        placement.savedState(window.objectName()) == WindowPlacement::State::Maximised)
        window.setWindowState(window.windowState() | Qt::WindowMaximized);
}

} // namespace WidgetPlacement
