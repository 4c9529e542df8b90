// Veltrix — KPI dashboard for small businesses.
#include "webpageopener.h"

#include "common/settingsstore.h"

#include <QDesktopServices>
#include <QDir>
#include <QHostInfo>
#include <QProcess>
#include <QStandardPaths>
#include <QUrl>

using namespace Qt::StringLiterals;

namespace {

QString encoded(const QString &value)
{
    return QString::fromLatin1(QUrl::toPercentEncoding(value));
}

constexpr int QuitWaitMs = 3000;

} // namespace

WebPageOpener::WebPageOpener(QString profileFolder)
    : m_profileFolder(std::move(profileFolder))
{}

WebPageOpener::~WebPageOpener()
{
    closeWindow();
}

QString WebPageOpener::findChromium()
{
    for (const QString &name : {u"chromium"_s, u"chromium-browser"_s, u"google-chrome"_s,
                                u"google-chrome-stable"_s, u"chrome"_s, u"msedge"_s}) {
        const QString path = QStandardPaths::findExecutable(name);
        if (!path.isEmpty())
            return path;
    }
    return {};
}

std::optional<DbError> WebPageOpener::openWebPage(const QString &url, const QSize &size,
                                                  const QRect &screen)
{
    closeWindow();
    const QString program = m_browserProgram.isEmpty() ? findChromium() : m_browserProgram;
    if (program.isEmpty()) {
        // No browser that can show a bare window: the desktop's own browser shows the page.
        if (QDesktopServices::openUrl(QUrl(url)))
            return std::nullopt;
        return DbError{-2147024894, u"No web browser could be started to show "_s + url};
    }

    QStringList arguments{u"--app="_s + url,
                          u"--window-size=%1,%2"_s.arg(size.width()).arg(size.height()),
                          u"--no-first-run"_s, u"--no-default-browser-check"_s};
    if (!screen.isEmpty()) {
        const int left = screen.left() + (screen.width() - size.width()) / 2;
        const int top = screen.top() + (screen.height() - size.height()) / 2;
        arguments << u"--window-position=%1,%2"_s.arg(left).arg(top);
    }
    if (!m_profileFolder.isEmpty()) {
        QDir().mkpath(m_profileFolder);
        arguments << u"--user-data-dir="_s + m_profileFolder;
    }

    m_browser = std::make_unique<QProcess>();
    m_browser->setProgram(program);
    m_browser->setArguments(arguments);
    m_browser->start();
    if (!m_browser->waitForStarted()) {
        const QString reason = m_browser->errorString();
        m_browser.reset();
        return DbError{-2147024894, u"The web browser could not be started: "_s + reason};
    }
    return std::nullopt;
}

void WebPageOpener::closeWindow()
{
    if (!m_browser)
        return;
    if (m_browser->state() != QProcess::NotRunning) {
        m_browser->terminate();
        if (!m_browser->waitForFinished(QuitWaitMs)) {
            m_browser->kill();
            m_browser->waitForFinished(QuitWaitMs);
        }
    }
    m_browser.reset();
}

bool WebPageOpener::hasWindow() const
{
    return m_browser && m_browser->state() != QProcess::NotRunning;
}

QString WebPageOpener::updatePageUrl(const QString &host, const QString &appVersion,
                                     const QString &databaseVersion, bool fromLoadingWindow)
{
    const QString path = fromLoadingWindow ? u"/vx/mw/updates.php"_s : u"/vx/updates.php"_s;
    return u"http://"_s + host + path + u"?appver="_s + encoded(appVersion) + u"&dbver="_s +
           encoded(databaseVersion);
}

QString WebPageOpener::coachingPageUrl(const QString &host, const QString &siteName)
{
    return u"http://"_s + host + u"/vx/mw/coaching.php?site="_s + encoded(siteName);
}

QString WebPageOpener::webHost(const SettingsStore &store)
{
    return store.readSetting(u"WebHost"_s, {}, u"www.veltrix.com.au"_s);
}

QString WebPageOpener::siteName(const SettingsStore &store)
{
    return store.readSetting(u"SiteName"_s, {}, QHostInfo::localHostName());
}
