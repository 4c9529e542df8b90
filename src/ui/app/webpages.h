// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QSize>
#include <QString>

class AppContext;
class Prompter;
class QWidget;

// Opens one of the maker's pages centred on the window's screen; a failure is reported under
// "Update", whichever page it was.
namespace WebPages {

void open(AppContext &context, Prompter &prompter, const QWidget &window, const QString &url,
          const QSize &size);
// The update page; the loading window asks on the path for databases that need updating.
void openUpdatePage(AppContext &context, Prompter &prompter, const QWidget &window,
                    bool fromLoadingWindow);
void openCoachingPage(AppContext &context, Prompter &prompter, const QWidget &window);

} // namespace WebPages
