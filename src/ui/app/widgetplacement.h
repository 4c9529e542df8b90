// Veltrix — KPI dashboard for small businesses.
#pragma once

class QWidget;
class SettingsStore;

// Window placement for real windows, named by their object name.
namespace WidgetPlacement {

// Call when the window closes.
void saveWindowPlacement(const QWidget &window, SettingsStore &store);
// Call before the window is first shown. With skipState the saved maximised state is ignored.
// A window never placed before opens centred over its parent; every window fits the screen.
void restoreWindowPlacement(QWidget &window, SettingsStore &store, bool skipState);
// A window at its own size, or the screen's when that is smaller, centred on the screen.
void fitToScreen(QWidget &window);

} // namespace WidgetPlacement
