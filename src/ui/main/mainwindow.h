// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "daterangechooser.h"
#include "loginpanel.h"
#include "users/userpoll.h"

#include <QMainWindow>

#include <functional>

class AppContext;
class KpiTabView;
class Prompter;
class QAction;
class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QStackedWidget;
class QTimer;
class TabButtons;

// frmMain: the login panel, then the KPI views with the choice of months, the Produce
// command, the tabs, the graph and the grid, with the menus and a status bar. It composes
// the panels and carries out what they ask for.
class MainWindow : public QMainWindow
{
    Q_OBJECT

public:
    MainWindow(AppContext &context, Prompter &prompter, QWidget *parent = nullptr);

    void login(const QString &userName, const QString &password);
    // False when the log-off could not be recorded (reported); the session then goes on.
    bool logoff(bool reset);
    void produce();
    void print();
    void stepPreviousMonth();
    void stepFollowingMonth();
    void stepPreviousYear();
    void stepFollowingYear();
    void pollUsers();
    void resetUserCounter();
    // What ends the program after a "Shutdown" request has shut it down in order; by
    // default the event loops are left.
    void setProgramEnd(std::function<void()> end) { m_endProgram = std::move(end); }
    void selectTab(int tab);

    // The controls, by the names the rest of the program knows them.
    QComboBox *lstUsers() const { return m_picLogin->lstUsers(); }
    QLineEdit *txtPassword() const { return m_picLogin->txtPassword(); }
    QWidget *picLogin() const { return m_picLogin; }
    QWidget *kpiPanel() const { return m_kpiPanel; }
    QComboBox *lstMonth1() const { return m_dateRange->lstMonth1(); }
    QComboBox *lstMonth2() const { return m_dateRange->lstMonth2(); }
    QComboBox *lstYear1() const { return m_dateRange->lstYear1(); }
    QComboBox *lstYear2() const { return m_dateRange->lstYear2(); }
    QCheckBox *chkCompare() const { return m_chkCompare; }
    QComboBox *lstCompareCount() const { return m_lstCompareCount; }
    QComboBox *lstCompareType() const { return m_lstCompareType; }
    KpiTabView *tabView() const { return m_tabView; }
    QLabel *lblLoggedIn() const { return m_lblLoggedIn; }
    QLabel *lblActiveUsers() const { return m_lblActiveUsers; }
    QLabel *lblDT() const { return m_lblDT; }
    QLabel *lblToDate() const { return m_lblToDate; }
    QAction *itemProduce() const { return m_itemProduce; }
    QAction *itemLogoff() const { return m_itemLogoff; }
    QAction *itemPrint() const { return m_itemPrint; }
    QAction *itemSetupHours() const { return m_itemSetupHours; }
    QAction *itemSetupMapping() const { return m_itemSetupMapping; }
    QAction *itemSetupUsers() const { return m_itemSetupUsers; }
    QAction *menuSetup() const { return m_menuSetup; }

    static QString clockText(const QDateTime &moment);

protected:
    void closeEvent(QCloseEvent *event) override;

private:
    void buildMenus();
    QWidget *buildLoginPanel();
    QWidget *buildKpiPanel();
    void restoreSelection();
    void updateLoginState();
    void updateClock();
    void tellLater(const QString &text);
    void updateToDateNote();
    // The comparison and print windows show the session's lines; they close with it.
    void closeSessionWindows();

    AppContext &m_context;
    Prompter &m_prompter;
    UserPoll m_poll;
    int m_currentTab = 0;

    QStackedWidget *m_pages = nullptr;
    LoginPanel *m_picLogin = nullptr;
    QWidget *m_kpiPanel = nullptr;
    DateRangeChooser *m_dateRange = nullptr;
    QCheckBox *m_chkCompare = nullptr;
    QComboBox *m_lstCompareCount = nullptr;
    QComboBox *m_lstCompareType = nullptr;
    TabButtons *m_tabButtons = nullptr;
    KpiTabView *m_tabView = nullptr;
    QLabel *m_lblLoggedIn = nullptr;
    QLabel *m_lblActiveUsers = nullptr;
    QLabel *m_lblDT = nullptr;
    QLabel *m_lblToDate = nullptr;
    QAction *m_itemProduce = nullptr;
    QAction *m_itemLogoff = nullptr;
    QAction *m_itemPrint = nullptr;
    QAction *m_menuSetup = nullptr;
    QAction *m_itemSetupUsers = nullptr;
    QAction *m_itemSetupHours = nullptr;
    QAction *m_itemSetupMapping = nullptr;
    QTimer *m_tmrUsers = nullptr;
    QTimer *m_tmrDT = nullptr;
    bool m_shutDown = false;
    std::function<void()> m_endProgram;
};
