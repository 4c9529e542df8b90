// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "app/producecommand.h"
#include "users/userpoll.h"

#include <QHash>
#include <QMainWindow>
#include <QSet>

#include <functional>
#include <optional>

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
// command, the tabs, the graph and the grid, with the menus and a status bar.
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
    QComboBox *lstUsers() const { return m_lstUsers; }
    QLineEdit *txtPassword() const { return m_txtPassword; }
    QWidget *picLogin() const { return m_picLogin; }
    QWidget *kpiPanel() const { return m_kpiPanel; }
    QComboBox *lstMonth1() const { return m_lstMonth1; }
    QComboBox *lstMonth2() const { return m_lstMonth2; }
    QComboBox *lstYear1() const { return m_lstYear1; }
    QComboBox *lstYear2() const { return m_lstYear2; }
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
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void buildMenus();
    QWidget *buildLoginPanel();
    QWidget *buildKpiPanel();
    void restoreSelection();
    void loadUserList(bool withMessage);
    void updateLoginState();
    void showSelection(int firstMonth, int firstYear, int lastMonth, int lastYear);
    void step(const std::function<
              std::optional<ProduceCommand::Selection>(const ProduceCommand::Selection &)> &next);
    void updateClock();
    void tellLater(const QString &text);
    void updateToDateNote();
    // Typed years are checked before a command uses them; false after saying which is wrong.
    bool checkYears();
    bool isRefusable(const QComboBox *box) const;
    void refuseYear(QComboBox *box);
    // The comparison and print windows show the session's lines; they close with it.
    void closeSessionWindows();

    AppContext &m_context;
    Prompter &m_prompter;
    UserPoll m_poll;
    int m_currentTab = 0;
    bool m_deletingUserName = false;
    // The year boxes whose text the user typed. Only typed years are checked: the year
    // buttons may choose the year after the current one as the end of a financial year.
    QSet<const QComboBox *> m_typedYears;
    // The invalid text each year box was last refused for, so that leaving it again is not
    // refused again: the user is told once and never held in the box.
    QHash<const QComboBox *, QString> m_refusedYears;

    QStackedWidget *m_pages = nullptr;
    QWidget *m_picLogin = nullptr;
    QWidget *m_kpiPanel = nullptr;
    QComboBox *m_lstUsers = nullptr;
    QLineEdit *m_txtPassword = nullptr;
    QComboBox *m_lstMonth1 = nullptr;
    QComboBox *m_lstMonth2 = nullptr;
    QComboBox *m_lstYear1 = nullptr;
    QComboBox *m_lstYear2 = nullptr;
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
