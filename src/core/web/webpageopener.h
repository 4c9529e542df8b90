// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QRect>
#include <QSize>
#include <QString>
#include <QStringList>

#include <memory>
#include <optional>

class QProcess;
class SettingsStore;

// Opens one of the maker's web pages in a bare browser window of a given size, centred: an
// installed Chromium or Chrome in app mode, else the desktop's default browser. Opening a page
// closes the window opened before.
class WebPageOpener
{
public:
    // The browser's own profile lives in the given folder, so that the window is a process of
    // ours that can be closed again.
    explicit WebPageOpener(QString profileFolder = {});
    ~WebPageOpener();
    WebPageOpener(const WebPageOpener &) = delete;
    WebPageOpener &operator=(const WebPageOpener &) = delete;

    void setProfileFolder(const QString &folder) { m_profileFolder = folder; }
    // A particular browser program instead of the one found on the system.
    void setBrowserProgram(const QString &program) { m_browserProgram = program; }

    // The screen to centre on; an empty rectangle leaves the position to the browser.
    std::optional<DbError> openWebPage(const QString &url, const QSize &size, const QRect &screen);
    void closeWindow();
    bool hasWindow() const;

    static QString findChromium();

    // The pages. Values are percent-encoded, so a site name with "&" or a space arrives whole.
    static QString updatePageUrl(const QString &host, const QString &appVersion,
                                 const QString &databaseVersion, bool fromLoadingWindow);
    static QString coachingPageUrl(const QString &host, const QString &siteName);
    static QString webHost(const SettingsStore &store);
    static QString siteName(const SettingsStore &store);

    static constexpr QSize UpdateWindowSize{600, 400};
    static constexpr QSize CoachingWindowSize{600, 600};

private:
    QString m_profileFolder;
    QString m_browserProgram;
    std::unique_ptr<QProcess> m_browser;
};
