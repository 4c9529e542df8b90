// Veltrix — KPI dashboard for small businesses.
#include "mainwindow.h"

#include "app/configdialog.h"
#include "app/contextwiring.h"
#include "app/loadingwindow.h"
#include "app/webpages.h"
#include "report/gridreport.h"
#include "report/printwindow.h"
#include "setup/hourlyratesdialog.h"
#include "setup/programsetupdialog.h"
#include "users/useraccountsdialog.h"
#include "views/comparewindow.h"
#include "views/gridview.h"
#include "views/kpitabview.h"
#include "views/tabbuttons.h"

#include "app/appcontext.h"
#include "app/mainconnector.h"
#include "app/producecommand.h"
#include "app/shutdown.h"
#include "common/errorreporter.h"
#include "common/prompter.h"
#include "common/settingsstore.h"
#include "database/configvalues.h"
#include "database/recordoperations.h"
#include "engine/rangeselection.h"
#include "users/loginservice.h"
#include "users/loginsession.h"
#include "users/usercounter.h"
#include "views/kpigrid.h"
#include "views/tabviewbuilder.h"

#include <QAction>
#include <QCheckBox>
#include <QCloseEvent>
#include <QComboBox>
#include <QCoreApplication>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QKeySequence>
#include <QLabel>
#include <QMenuBar>
#include <QPushButton>
#include <QStackedWidget>
#include <QStatusBar>
#include <QTimer>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

MainWindow::MainWindow(AppContext &context, Prompter &prompter, QWidget *parent)
    : QMainWindow(parent)
    , m_context(context)
    , m_prompter(prompter)
    , m_endProgram([] { QCoreApplication::exit(0); })
{
    setObjectName(u"frmMain"_s);
    setWindowTitle(u"Veltrix"_s);
    buildMenus();

    m_pages = new QStackedWidget(this);
    m_pages->addWidget(buildLoginPanel());
    m_pages->addWidget(buildKpiPanel());
    setCentralWidget(m_pages);

    m_lblLoggedIn = new QLabel(this);
    m_lblActiveUsers = new QLabel(this);
    m_lblDT = new QLabel(this);
    statusBar()->addWidget(m_lblLoggedIn, 1);
    statusBar()->addWidget(m_lblActiveUsers, 1);
    m_lblToDate = new QLabel(this);
    m_lblToDate->setObjectName(u"lblToDate"_s);
    statusBar()->addWidget(m_lblToDate, 2);
    statusBar()->addPermanentWidget(m_lblDT);

    m_tmrUsers = new QTimer(this);
    m_tmrUsers->setInterval(UserPoll::IntervalMs);
    connect(m_tmrUsers, &QTimer::timeout, this, &MainWindow::pollUsers);
    m_tmrDT = new QTimer(this);
    m_tmrDT->setInterval(1000);
    connect(m_tmrDT, &QTimer::timeout, this, &MainWindow::updateClock);

    updateLoginState();
    restoreSelection();
    m_picLogin->loadUserList(true);
    updateClock();
    m_tmrUsers->start();
    m_tmrDT->start();
    resize(1000, 760);
}

void MainWindow::buildMenus()
{
    QMenu *file = menuBar()->addMenu(u"&File"_s);
    m_itemLogoff = file->addAction(u"&Logoff"_s, this, [this] { logoff(true); });
    // The produce button's own key, Alt+P, is also the Parts tab's, so it only moves the
    // focus; these keys always produce and print.
    m_itemProduce = file->addAction(u"Produce &KPI"_s, this, &MainWindow::produce);
    m_itemProduce->setShortcuts({QKeySequence(Qt::Key_F5), QKeySequence(Qt::CTRL | Qt::Key_Return),
                                 QKeySequence(Qt::CTRL | Qt::Key_Enter)});
    m_itemPrint = file->addAction(u"&Print"_s, this, &MainWindow::print);
    m_itemPrint->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_P));
    file->addSeparator();
    file->addAction(u"&Exit"_s, this, &QWidget::close);

    QMenu *tools = menuBar()->addMenu(u"&Tools"_s);
    tools->addAction(u"Check For &Updates"_s, this,
                     [this] { WebPages::openUpdatePage(m_context, m_prompter, *this, false); });
    tools->addAction(u"&Reset User Counter"_s, this, &MainWindow::resetUserCounter);

    QMenu *setup = menuBar()->addMenu(u"&Setup"_s);
    m_menuSetup = setup->menuAction();
    m_itemSetupHours = setup->addAction(u"&Labour Hours"_s, this,
                                        [this] { HourlyRatesDialog::showModal(m_context, this); });
    m_itemSetupMapping = setup->addAction(
        u"&Account Mapping"_s, this, [this] { ProgramSetupDialog::showModal(m_context, this); });
    setup->addSeparator();
    m_itemSetupUsers = setup->addAction(u"&User Accounts"_s, this,
                                        [this] { UserAccountsDialog::showModal(m_context, this); });
    setup->addAction(u"System &Configuration"_s, this, [this] {
        if (ConfigDialog::modify(this, m_context.settingsStore(), m_prompter)) {
            m_prompter.message(u"You must restart the program for the changes to take effect!"_s,
                               u"Program Restart Required"_s, Prompter::Icon::Information);
        }
    });

    QMenu *help = menuBar()->addMenu(u"&Help"_s);
    help->addAction(u"&About"_s, this,
                    [this] { LoadingWindow::showAbout(m_context, m_prompter, this); });
    help->addSeparator();
    help->addAction(u"&Contents"_s);
    help->addAction(u"&Book Coaching"_s, this,
                    [this] { WebPages::openCoachingPage(m_context, m_prompter, *this); });
}

QWidget *MainWindow::buildLoginPanel()
{
    auto *page = new QWidget(this);
    m_picLogin =
        new LoginPanel(m_context.mainDatabase(), m_context.settingsStore(), m_prompter, page);
    connect(m_picLogin, &LoginPanel::loginRequested, this, &MainWindow::login);
    auto *centre = new QGridLayout(page);
    centre->addWidget(m_picLogin, 0, 0, Qt::AlignCenter);
    return page;
}

QWidget *MainWindow::buildKpiPanel()
{
    m_kpiPanel = new QWidget(this);
    m_dateRange = new DateRangeChooser(m_context.numberFormat().locale(),
                                       m_context.settings().currentYear, m_prompter, m_kpiPanel);
    connect(m_dateRange, &DateRangeChooser::stepped, this, &MainWindow::produce);
    auto *butProduce = new QPushButton(u"&Produce KPI"_s, m_kpiPanel);
    butProduce->setObjectName(u"butProduce"_s);
    butProduce->setToolTip(u"Produce the KPIs of the chosen months (%1 or %2)"_s.arg(
        m_itemProduce->shortcuts().at(0).toString(QKeySequence::NativeText),
        m_itemProduce->shortcuts().at(1).toString(QKeySequence::NativeText)));
    connect(butProduce, &QPushButton::clicked, this, &MainWindow::produce);
    m_chkCompare = new QCheckBox(u"See The Big Picture"_s, m_kpiPanel);
    m_chkCompare->setToolTip(u"Lets you compare data from your selected period with past data"_s);
    m_lstCompareCount = new QComboBox(m_kpiPanel);
    m_lstCompareCount->addItems({u"1"_s, u"2"_s, u"3"_s, u"4"_s});
    m_lstCompareType = new QComboBox(m_kpiPanel);
    m_lstCompareType->addItems({u"Years"_s, u"Periods"_s});
    m_lstCompareCount->setEnabled(false);
    m_lstCompareType->setEnabled(false);
    connect(m_chkCompare, &QCheckBox::toggled, this, [this](bool on) {
        m_lstCompareCount->setEnabled(on);
        m_lstCompareType->setEnabled(on);
    });
    // "The Past 1 Year", "The Past 2 Years".
    connect(m_lstCompareCount, &QComboBox::currentIndexChanged, this, [this](int index) {
        const bool one = index == 0;
        m_lstCompareType->setItemText(0, one ? u"Year"_s : u"Years"_s);
        m_lstCompareType->setItemText(1, one ? u"Period"_s : u"Periods"_s);
    });
    m_lstCompareType->setItemText(0, u"Year"_s);
    m_lstCompareType->setItemText(1, u"Period"_s);

    auto *dates = new QHBoxLayout;
    dates->addWidget(m_dateRange);
    dates->addWidget(butProduce);
    dates->addStretch();

    // The comparison's choice ends the tab buttons' row: the dates' row is full on a small screen.
    auto *tabs = new QHBoxLayout;
    m_tabButtons = new TabButtons(m_kpiPanel);
    connect(m_tabButtons, &TabButtons::tabClicked, this, &MainWindow::selectTab);
    tabs->addWidget(m_tabButtons, 1);
    tabs->addWidget(m_chkCompare);
    tabs->addWidget(new QLabel(u"The Past"_s, m_kpiPanel));
    tabs->addWidget(m_lstCompareCount);
    tabs->addWidget(m_lstCompareType);

    // The colour legend: what the cells' colours say.
    auto *legend = new QWidget(m_kpiPanel);
    legend->setObjectName(u"picCoding"_s);
    auto *legendRow = new QHBoxLayout(legend);
    legendRow->setContentsMargins(0, 0, 0, 0);
    legendRow->addWidget(new QLabel(u"<b>Colour Coding</b>"_s, legend));
    const std::pair<QString, QColor> entries[] = {{u"Poor %"_s, KpiGrid::Red},
                                                  {u"Income $"_s, KpiGrid::AccountAbove},
                                                  {u"Expense $"_s, KpiGrid::AccountBelow},
                                                  {u"Percentage %"_s, KpiGrid::Percentage},
                                                  {u"Good %"_s, KpiGrid::Green},
                                                  {u"Average %"_s, KpiGrid::Yellow}};
    for (const auto &[caption, colour] : entries) {
        auto *entry = new QLabel(caption, legend);
        entry->setStyleSheet(
            u"background: %1; padding: 2px 6px; border: 1px solid #B0B0B0;"_s.arg(colour.name()));
        legendRow->addWidget(entry);
    }

    m_tabView = new KpiTabView(m_context, m_kpiPanel);
    // Beside the tab's caption rather than the tab buttons, so that a narrow screen keeps both.
    m_tabView->setCaptionCompanion(legend);
    auto *layout = new QVBoxLayout(m_kpiPanel);
    layout->addLayout(dates);
    layout->addLayout(tabs);
    layout->addWidget(m_tabView, 1);
    return m_kpiPanel;
}

void MainWindow::restoreSelection()
{
    const std::optional<RangeSelection::Remembered> remembered =
        RangeSelection::remembered(m_context.settingsStore(), m_context.settings().currentYear);
    if (!remembered) {
        ErrorReporter(m_prompter).reportError(380, u"Invalid property value"_s, u"Form Load"_s);
        return;
    }
    m_dateRange->showRemembered(*remembered);
}

void MainWindow::updateLoginState()
{
    const LoginState &login = m_context.loginState();
    m_pages->setCurrentIndex(login.loggedIn ? 1 : 0);
    statusBar()->setVisible(login.loggedIn);
    const bool administrator = login.loggedIn && login.currentUserType == 1;
    m_menuSetup->setEnabled(administrator);
    m_itemSetupUsers->setEnabled(administrator);
    m_itemSetupMapping->setEnabled(login.loggedIn &&
                                   login.currentUser == LoginService::BuiltInUser);
    m_itemLogoff->setEnabled(login.loggedIn);
    m_itemProduce->setEnabled(login.loggedIn);
    m_itemPrint->setEnabled(login.loggedIn);
}

void MainWindow::login(const QString &userName, const QString &password)
{
    const std::optional<QString> count =
        ContextWiring::loginSession(m_context).login(userName, password);
    if (!count) {
        m_prompter.message(LoginService::LoginFailedMessage, u"Login Failed"_s,
                           Prompter::Icon::Exclamation);
        return;
    }
    m_lblLoggedIn->setText(u"Welcome, "_s + m_context.loginState().currentUser);
    m_lblActiveUsers->setText(UserCounter::loggedInText(*count));
    updateLoginState();
    selectTab(TabViewBuilder::SummaryTab);
}

bool MainWindow::logoff(bool reset)
{
    if (!ContextWiring::loginSession(m_context).logoff(reset))
        return false;
    if (!reset)
        return true;
    // The next user sees nothing of this one's session.
    closeSessionWindows();
    m_tabView->clear();
    updateLoginState();
    m_lblLoggedIn->clear();
    m_lblActiveUsers->clear();
    m_lblToDate->clear();
    m_picLogin->reset();
    return true;
}

void MainWindow::closeSessionWindows()
{
    // The innermost first: a print window may stand over the comparison window.
    const QList<QDialog *> dialogs = findChildren<QDialog *>();
    for (auto it = dialogs.crbegin(); it != dialogs.crend(); ++it) {
        QDialog *dialog = *it;
        if (dialog->isVisible() &&
            (qobject_cast<CompareWindow *>(dialog) || qobject_cast<PrintWindow *>(dialog)))
            dialog->reject();
    }
}

void MainWindow::selectTab(int tab)
{
    m_currentTab = tab;
    m_tabButtons->setCurrent(tab);
    m_tabView->showTab(tab);
}

void MainWindow::produce()
{
    if (!m_dateRange->checkYears())
        return;
    if (ProduceCommand(m_context).produce(m_dateRange->selection()) !=
        ProduceCommand::Outcome::Produced)
        return;
    selectTab(m_currentTab);
    updateToDateNote();
    if (m_chkCompare->isChecked()) {
        // The kinds by their own names, whatever the list says for one period.
        CompareWindow::compareData(
            m_context, this, m_lstCompareType->currentIndex() == 0 ? u"Years"_s : u"Periods"_s,
            m_lstCompareCount->currentText().toInt());
    }
}

void MainWindow::updateToDateNote()
{
    const QDate end = m_context.periodDataSet().range(0).end;
    const bool beyondToday = end.isValid() && end > m_context.clock().today();
    m_lblToDate->setText(beyondToday ? u"Figures for "_s + GridReport::reportTitle(m_context)
                                     : QString());
}

void MainWindow::print()
{
    GridReport::printGrid(m_context, this, *m_tabView);
}

void MainWindow::stepPreviousMonth()
{
    m_dateRange->stepPreviousMonth();
}

void MainWindow::stepFollowingMonth()
{
    m_dateRange->stepFollowingMonth();
}

void MainWindow::stepPreviousYear()
{
    m_dateRange->stepPreviousYear();
}

void MainWindow::stepFollowingYear()
{
    m_dateRange->stepFollowingYear();
}

void MainWindow::pollUsers()
{
    if (!m_context.mainDatabase().isConnected())
        return;
    const UserPoll::Result result =
        m_poll.tick(ConfigValues(m_context.mainDatabase(), m_prompter), m_context.isBusy());
    m_lblActiveUsers->setText(UserCounter::loggedInText(result.activeUsers));
    switch (result.action) {
    case UserPoll::Action::Logoff:
        if (!logoff(true))
            break;
        tellLater(u"You have been logged off due to a network request that requires all users "
                  u"to logoff!"_s);
        break;
    case UserPoll::Action::Shutdown:
        close();
        m_endProgram();
        break;
    case UserPoll::Action::Disconnect:
        logoff(true);
        m_picLogin->hide();
        disconnectMainDatabase(m_context);
        tellLater(u"You have been disconnected due to a network request that requires all users "
                  u"to disconnect from the database!"_s);
        break;
    case UserPoll::Action::None:
        break;
    }
}

void MainWindow::tellLater(const QString &text)
{
    // Not from inside the poll: a timer does not fire again while its own slot runs, so a box
    // opened here would stop this copy's poll, and the withdrawal of the request, until OK.
    QTimer::singleShot(0, this, [this, text] {
        m_prompter.message(text, u"Network Request"_s, Prompter::Icon::Information);
    });
}

void MainWindow::resetUserCounter()
{
    const Prompter::Answer answer = m_prompter.message(
        u"Warning: This will disconnect and logoff all active users!\r\n\r\nOnly reset the user "
        u"counter if the displayed # of logged on users is incorrect\r\nAre you sure you want to "
        u"Reset the User Counter?"_s,
        u"Reset User Counter"_s, Prompter::Icon::Exclamation, Prompter::Buttons::YesNo);
    if (answer != Prompter::Answer::Yes)
        return;
    if (const auto error = UserCounter(m_context.mainDatabase()).reset())
        ErrorReporter(m_prompter).reportError(error->number, error->description, u"Update"_s);
}

QString MainWindow::clockText(const QDateTime &moment)
{
    // English names whatever the region; the C locale's month abbreviations are the three
    // letters the clock has room for ("Sep", not "Sept").
    return QLocale::c().toString(moment, u"dddd, d MMM yyyy h:mm AP"_s);
}

void MainWindow::updateClock()
{
    const QString text = clockText(m_context.clock().now());
    if (m_lblDT->text() != text)
        m_lblDT->setText(text);
}

void MainWindow::closeEvent(QCloseEvent *event)
{
    if (!m_shutDown) {
        m_shutDown = true;
        m_tmrUsers->stop();
        m_tmrDT->stop();
        shutDown(m_context);
    }
    event->accept();
}
