// Veltrix — KPI dashboard for small businesses.
#include "loadingwindow.h"

#include "configdialog.h"
#include "webpages.h"

#include "app/appcontext.h"
#include "app/mainconnector.h"
#include "app/startupsequence.h"
#include "common/prompter.h"
#include "common/version.h"

#include <QApplication>
#include <QEvent>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QTimer>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

namespace {
constexpr int LoadDelayMs = 500;
}

LoadingWindow::LoadingWindow(AppContext &context, Prompter &prompter, QWidget *parent)
    : QDialog(parent)
    , m_context(context)
    , m_prompter(prompter)
{
    setObjectName(u"frmSplash"_s);
    setWindowTitle(u" Veltrix"_s);
    buildLayout();

    m_tmrLoad = new QTimer(this);
    m_tmrLoad->setObjectName(u"tmrLoad"_s);
    m_tmrLoad->setInterval(LoadDelayMs);
    connect(m_tmrLoad, &QTimer::timeout, this, &LoadingWindow::runSequence);

    m_lblVersion->setText(u"Software Version "_s + AppInfo::appVersion());
    const QString databaseVersion = m_context.mainDatabase().databaseVersion();
    m_lblDBVersion->setText(u"Database Version "_s + databaseVersion);
    m_lblDBVersion->setVisible(!databaseVersion.isEmpty());
}

void LoadingWindow::buildLayout()
{
    m_picTop = new QWidget(this);
    m_picTop->setObjectName(u"picTop"_s);
    m_picTop->setAutoFillBackground(true);
    QPalette banner = m_picTop->palette();
    banner.setColor(QPalette::Window, QColor(0x22, 0x2B, 0x38));
    m_picTop->setPalette(banner);
    m_picTop->setMinimumHeight(110);

    m_imgLogo = new QLabel(u"Veltrix"_s, m_picTop);
    m_imgLogo->setObjectName(u"imgLogo"_s);
    QFont logoFont = m_imgLogo->font();
    logoFont.setPointSizeF(logoFont.pointSizeF() * 3);
    logoFont.setBold(true);
    m_imgLogo->setFont(logoFont);
    m_imgLogo->setStyleSheet(u"color: #DD6800;"_s);
    m_imgLogo->adjustSize();
    m_picTop->installEventFilter(this);

    m_lblVersion = new QLabel(this);
    m_lblVersion->setObjectName(u"lblVersion"_s);
    m_lblDBVersion = new QLabel(this);
    m_lblDBVersion->setObjectName(u"lblDBVersion"_s);
    m_lblStatus = new QLabel(u"Loading, please stand by..."_s, this);
    m_lblStatus->setObjectName(u"lblStatus"_s);
    m_lblStatus->setWordWrap(true);
    m_lblStatus->setVisible(false);

    m_butOptions = new QPushButton(u"&Database Options"_s, this);
    m_butOptions->setObjectName(u"butOptions"_s);
    m_butUpdate = new QPushButton(u"Check for &Updates"_s, this);
    m_butUpdate->setObjectName(u"butUpdate"_s);
    m_butClose = new QPushButton(u"Close"_s, this);
    m_butClose->setObjectName(u"butClose"_s);
    for (QPushButton *button : {m_butOptions, m_butUpdate, m_butClose}) {
        button->setVisible(false);
        button->setAutoDefault(false);
    }
    connect(m_butOptions, &QPushButton::clicked, this, &LoadingWindow::openOptions);
    connect(m_butUpdate, &QPushButton::clicked, this, &LoadingWindow::openUpdatePage);
    connect(m_butClose, &QPushButton::clicked, this, &LoadingWindow::close);

    auto *buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(m_butOptions);
    buttons->addWidget(m_butUpdate);
    buttons->addWidget(m_butClose);

    auto *layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 12);
    layout->addWidget(m_picTop);
    auto *body = new QVBoxLayout;
    body->setContentsMargins(16, 8, 16, 0);
    body->addWidget(m_lblVersion);
    body->addWidget(m_lblDBVersion);
    body->addSpacing(8);
    body->addWidget(m_lblStatus);
    body->addStretch();
    body->addLayout(buttons);
    layout->addLayout(body);
    setMinimumSize(440, 280);
}

void LoadingWindow::showAbout(AppContext &context, Prompter &prompter, QWidget *owner)
{
    LoadingWindow about(context, prompter, owner);
    about.m_tmrLoad->stop();
    about.m_butClose->setVisible(true);
    about.exec();
}

void LoadingWindow::startLoading()
{
    m_tmrLoad->start();
}

void LoadingWindow::runSequence()
{
    m_tmrLoad->stop();
    m_lblStatus->setVisible(true);
    repaint();
    m_prompter.setBusyPointer();
    const StartupOutcome outcome = runStartupSequence(m_context);
    if (outcome.failed)
        m_lblStatus->setText(outcome.message);
    finishLoading(outcome.failed, outcome.updateNeeded);
}

void LoadingWindow::finishLoading(bool failed, bool updateNeeded)
{
    m_tmrLoad->stop();
    m_prompter.setNormalPointer();
    if (failed) {
        if (m_context.mainDatabase().isConnected())
            disconnectMainDatabase(m_context);
        m_lblStatus->setStyleSheet(u"color: rgb(255, 0, 0);"_s);
        m_butClose->setText(u"E&xit"_s);
        m_butClose->setVisible(true);
        QPushButton *wayOut = updateNeeded ? m_butUpdate : m_butOptions;
        wayOut->setVisible(true);
        wayOut->setFocus();
        return;
    }
    Q_EMIT startupSucceeded();
    close();
}

void LoadingWindow::openOptions()
{
    if (!ConfigDialog::modify(this, m_context.settingsStore(), m_prompter))
        return;
    // Run the whole sequence again with the new settings; the line stays red but empty until
    // there is something new to say.
    m_lblStatus->clear();
    m_butClose->setVisible(false);
    m_butOptions->setVisible(false);
    m_tmrLoad->start();
}

void LoadingWindow::openUpdatePage()
{
    WebPages::openUpdatePage(m_context, m_prompter, *this, true);
}

bool LoadingWindow::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == m_picTop && event->type() == QEvent::Resize)
        centreLogo();
    return QDialog::eventFilter(watched, event);
}

void LoadingWindow::centreLogo()
{
    m_imgLogo->move((m_picTop->width() - m_imgLogo->width()) / 2,
                    (m_picTop->height() - m_imgLogo->height()) / 2);
}
