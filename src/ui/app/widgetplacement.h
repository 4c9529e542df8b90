// Veltrix — KPI dashboard for small businesses.
#pragma once

class QWidget;
class SettingsStore;

// Window placement for real windows, named by their object name.
namespace WidgetPlacement {

// Call when the window closes.
void saveWindowPlacement(const QWidget &window, SettingsStore &store);
// Call before the window is first shown. With skipState the saved maximised state is ignored.
void restoreWindowPlacement(QWidget &window, SettingsStore &store, bool skipState);

} // namespace WidgetPlacement
