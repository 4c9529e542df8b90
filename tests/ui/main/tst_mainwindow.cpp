// Veltrix — KPI dashboard for small businesses.
#include "../setupedit.h"
#include "clirun.h"
#include "modalwindow.h"
#include "testworkspace.h"

#include "app/demoworkspace.h"
#include "common/fileoperations.h"
#include "database/configvalues.h"
#include "grid/gridmodel.h"
#include "grid/gridoperations.h"
#include "main/mainwindow.h"
#include "report/gridreport.h"
#include "report/printwindow.h"
#include "setup/hourlyratesdialog.h"
#include "setup/programsetupdialog.h"
#include "views/bargraphitem.h"
#include "views/comparewindow.h"
#include "views/grapharea.h"
#include "views/gridview.h"
#include "views/kpitabview.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDialog>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <QRegularExpression>
#include <QSqlQuery>
#include <QTest>

using namespace Qt::StringLiterals;
using GridOperations::findGridRow;

class TestMainWindow : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();
    void builtInAccountWithNoUsersAndStepButtons();
    void yearIsCheckedBeforeUse_data();
    void yearIsCheckedBeforeUse();
    void clockFormat();
    void typeAheadThenNetworkRequests();
    void produceShowsTheFiguresAndTheNextUserNothingOfThem();
    void loginFollowsTheAccount_data();
    void loginFollowsTheAccount();
    void mappingAndRatesReachTheNextProduce();

private:
    bool connectWorkspace()
    {
        return m_workspace->context().mainDatabase().isConnected() || m_workspace->connect();
    }
    std::unique_ptr<MainWindow> openWindow()
    {
        if (!connectWorkspace())
            return nullptr;
        m_workspace->prompter().clearMessages();
        return std::make_unique<MainWindow>(m_workspace->context(), m_workspace->prompter());
    }
    // The main window over a demo workspace written to the folder.
    std::unique_ptr<MainWindow> openOnDemo(const QString &folder)
    {
        if (DemoWorkspace::create(folder, QStringLiteral(VELTRIX_NEW_DB)))
            return nullptr;
        DemoWorkspace::configure(m_workspace->store(), folder);
        return openWindow();
    }
    void addUser(const QString &name)
    {
        QVERIFY(m_workspace->exec(
            u"INSERT INTO Users (UserName, Password, Type, Fields) VALUES (?, 'pw', 0, '1')"_s,
            {name}));
    }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestMainWindow::init()
{
    m_workspace = std::make_unique<TestWorkspace>(
        Clock::fixedAt(QDateTime(QDate(2026, 12, 7), QTime(10, 0))));
    QVERIFY(m_workspace->configure());
}

void TestMainWindow::cleanup()
{
    m_workspace.reset();
}

void TestMainWindow::builtInAccountWithNoUsersAndStepButtons()
{
    auto window = openWindow();
    QVERIFY(window);
    QCOMPARE(window->lstUsers()->currentText(), u"sysop"_s);
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    QCOMPARE(m_workspace->prompter().messages().first().title, u"No Users"_s);
    window->login(u"sysop"_s, u"sysop"_s);
    QVERIFY(window->menuSetup()->isEnabled());
    QCOMPARE(window->lblActiveUsers()->text(), u"0 users are logged in"_s);
    QCOMPARE(window->lstCompareType()->itemText(0), u"Year"_s); // "The Past 1 Year"
    window->lstCompareCount()->setCurrentIndex(1);
    QCOMPARE(window->lstCompareType()->itemText(1), u"Periods"_s);

    const auto select = [&](int month1, const QString &year1, int month2, const QString &year2) {
        window->lstMonth1()->setCurrentIndex(month1);
        window->lstYear1()->setEditText(year1);
        window->lstMonth2()->setCurrentIndex(month2);
        window->lstYear2()->setEditText(year2);
    };
    select(6, u"2004"_s, 5, u"2005"_s);
    window->stepPreviousYear();
    QCOMPARE(window->lstMonth1()->currentIndex(), 6);
    QCOMPARE(window->lstYear1()->currentText(), u"2003"_s);
    QCOMPARE(window->lstMonth2()->currentIndex(), 5);
    QCOMPARE(window->lstYear2()->currentText(), u"2004"_s);
    // No step goes back beyond January 1950.
    select(0, u"1950"_s, 0, u"1950"_s);
    m_workspace->prompter().clearMessages();
    window->stepPreviousMonth();
    QCOMPARE(m_workspace->prompter().messages().first().title, u"Limit Reached"_s);
    QCOMPARE(window->lstYear1()->currentText(), u"1950"_s);
}

void TestMainWindow::yearIsCheckedBeforeUse_data()
{
    QTest::addColumn<QString>("year"); // typed into the first year box
    QTest::addColumn<QString>("action");
    QTest::addColumn<QString>("title"); // of the one message shown; empty for none
    const QString produced = u"Cannot Produce KPI's"_s;
    QTest::newRow("F5 produces") << u"2005"_s << u"F5"_s << produced;
    QTest::newRow("Ctrl+Return produces") << u"2005"_s << u"Ctrl+Return"_s << produced;
    QTest::newRow("F5 with 1949") << u"1949"_s << u"F5"_s << u"Invalid Year"_s;
    QTest::newRow("menu with 19") << u"19"_s << u"menu"_s << u"Invalid Year"_s;
    QTest::newRow("step button with 1949") << u"1949"_s << u"step"_s << u"Invalid Year"_s;
    QTest::newRow("Tab out of 1949 twice") << u"1949"_s << u"Tab"_s << u"Invalid Year"_s;
    QTest::newRow("another application takes the focus") << u"1949"_s << u"away"_s << QString();
}

void TestMainWindow::yearIsCheckedBeforeUse()
{
    QFETCH(QString, year);
    QFETCH(QString, action);
    QFETCH(QString, title);
    auto window = openWindow();
    QVERIFY(window);
    window->show();
    QVERIFY(QTest::qWaitForWindowActive(window.get()));
    window->login(u"sysop"_s, u"sysop"_s);
    QComboBox *box = window->lstYear1();
    box->setFocus();
    box->lineEdit()->selectAll();
    QTest::keyClicks(box, year);
    QTest::keyClick(box, Qt::Key_Return);
    QCOMPARE(box->count(), 21); // a typed year is not added to the list
    m_workspace->prompter().clearMessages();
    QFocusEvent away(QEvent::FocusOut, Qt::ActiveWindowFocusReason);
    if (action == u"menu"_s)
        window->itemProduce()->trigger();
    else if (action == u"step"_s)
        window->stepPreviousYear();
    else if (action == u"away"_s)
        QApplication::sendEvent(box, &away);
    else if (action == u"Tab"_s) { // told once, the user may then leave
        QTest::keyClick(box, Qt::Key_Tab);
        QTRY_VERIFY(box->hasFocus());
        QTest::keyClick(box, Qt::Key_Tab);
    } else
        QTest::keySequence(window.get(), QKeySequence(action));
    QTest::qWait(20);
    QCOMPARE(m_workspace->prompter().messages().size(), title.isEmpty() ? 0 : 1);
    QCOMPARE(m_workspace->prompter().messages().value(0).title, title);
    QCOMPARE(box->hasFocus(), action != u"Tab"_s);
}

void TestMainWindow::clockFormat()
{
    QCOMPARE(MainWindow::clockText(QDateTime(QDate(2026, 12, 5), QTime(21, 5))),
             u"Saturday, 5 Dec 2026 9:05 PM"_s);
    QCOMPARE(MainWindow::clockText(QDateTime(QDate(2026, 9, 1), QTime(0, 7))),
             u"Tuesday, 1 Sep 2026 12:07 AM"_s);
}

void TestMainWindow::typeAheadThenNetworkRequests()
{
    QVERIFY(connectWorkspace());
    addUser(u"Anna"_s);
    addUser(u"Bob"_s);
    auto window = openWindow();
    QVERIFY(window);
    window->show();
    QVERIFY(QTest::qWaitForWindowExposed(window.get()));
    QLineEdit *box = window->lstUsers()->lineEdit();
    box->clear();
    box->setFocus();
    QTest::keyClick(box, Qt::Key_B);
    QCOMPARE(box->text(), u"Bob"_s);
    QCOMPARE(box->selectedText(), u"ob"_s);
    QTest::keyClick(box, Qt::Key_Backspace);
    QCOMPARE(box->text(), u"B"_s);

    // A counter reset asks every copy to log off, this one too.
    window->login(u"bob"_s, u"pw"_s);
    const ConfigValues config(m_workspace->context().mainDatabase(), m_workspace->prompter());
    bool withdrawnWhileOpen = false;
    m_workspace->prompter().setWhileShown([&](const RecordingPrompter::Message &message) {
        if (message.title != u"Network Request"_s)
            return;
        // The box stays open for two polls at most; this copy's own poll must withdraw the
        // request meanwhile.
        withdrawnWhileOpen = QTest::qWaitFor([&] { return config.getConfigValue(5).isEmpty(); },
                                             2 * UserPoll::IntervalMs + 500);
    });
    m_workspace->prompter().scriptAnswer(Prompter::Answer::Yes);
    window->resetUserCounter();
    QCOMPARE(config.getConfigValue(5), u"Logoff"_s);
    QTRY_VERIFY_WITH_TIMEOUT(withdrawnWhileOpen, 3 * UserPoll::IntervalMs);
    m_workspace->prompter().setWhileShown({});
    QVERIFY(!m_workspace->context().loginState().loggedIn);
    QCOMPARE(config.getConfigValue(4), u"0"_s);

    // A shutdown request ends the program, even while a dialog runs its own event loop.
    QDialog dialog(window.get());
    bool ended = false;
    window->setProgramEnd([&] {
        ended = true;
        dialog.reject();
    });
    QCOMPARE(ConfigValues(m_workspace->context().mainDatabase(), m_workspace->prompter())
                 .setConfigValue(5, u"Shutdown"_s),
             std::nullopt);
    QTimer::singleShot(0, window.get(), &MainWindow::pollUsers);
    QTimer::singleShot(10000, &dialog, &QDialog::reject);
    dialog.exec();
    QVERIFY(ended);
    QVERIFY(!window->isVisible());
    // Shut down in order: the database is closed.
    QVERIFY(!m_workspace->context().mainDatabase().isConnected());
}

void TestMainWindow::produceShowsTheFiguresAndTheNextUserNothingOfThem()
{
    QTemporaryDir dir;
    auto window = openOnDemo(dir.filePath(u"demo"_s));
    QVERIFY(window);
    window->show();
    // Workshop may see the Summary tab but for one percentage line.
    QSqlQuery query(m_workspace->context().mainDatabase().database());
    QVERIFY(query.exec(u"SELECT ID, Label FROM Fields WHERE Tab = 1 AND Type = 3 ORDER BY ID"_s) &&
            query.next());
    const QString line = query.value(0).toString();
    const QString label = query.value(1).toString();
    QVERIFY(query.exec(u"SELECT Fields FROM Users WHERE UserName = 'workshop'"_s) && query.next());
    QStringList allowed = query.value(0).toString().split(QRegularExpression(u"[#,]"_s));
    QVERIFY(allowed.removeAll(line) == 1);
    QVERIFY(query.exec(
        u"UPDATE Users SET Fields = '%1' WHERE UserName = 'workshop'"_s.arg(allowed.join(u','))));
    QVERIFY(query.exec(u"SELECT ID FROM Fields WHERE Type = 1"_s));
    while (query.next())
        allowed << query.value(0).toString(); // headings are not lines
    const auto showsOnlyAllowed = [&](KpiTabView &view) {
        for (int r = 1; r <= view.grid().rowCount(); ++r)
            QVERIFY(view.lstGrid()->isRowHidden(r - 1) ||
                    allowed.contains(view.grid().cellText(r, 1)));
        for (const BarGraphItem *bar : view.picGraph()->bars())
            QVERIFY(allowed.contains(QString::number(bar->tag())));
    };

    // Manager produces the last financial year.
    window->login(u"manager"_s, u"manager1"_s);
    window->lstMonth1()->setCurrentIndex(6);
    window->lstYear1()->setEditText(u"2025"_s);
    window->lstMonth2()->setCurrentIndex(5);
    window->lstYear2()->setEditText(u"2026"_s);
    window->produce();
    GridModel &shown = window->tabView()->grid();
    QVERIFY(shown.rowCount() > 5);
    QCOMPARE(shown.cellText(2, shown.columnIndex(u"label"_s)), u"Panel labour gross profit %"_s);
    // The same text veltrix-cli produce prints for this line and range.
    QCOMPARE(shown.cellText(2, shown.columnIndex(u"value"_s)), u"48.2%"_s);
    QCOMPARE(m_workspace->store().readSetting(u"M1"_s), u"6"_s);
    QCOMPARE(window->lblToDate()->text(), QString());
    // No figure is cut short ("$ …"), not even the widest of the Financial tab.
    window->selectTab(6);
    const GridView *view = window->tabView()->lstGrid();
    const int value = shown.columnIndex(u"value"_s) - 1;
    for (int r = 0; r < shown.rowCount(); ++r)
        QVERIFY(view->sizeHintForIndex(view->model()->index(r, value)).width() <=
                view->columnWidth(value));
    // July 2026 to June 2027 has not ended on 7 Dec 2026.
    window->stepFollowingYear();
    const QString title = u"1/7/26 to 30/6/27 (to date: 7 Dec 2026)"_s;
    QCOMPARE(GridReport::reportTitle(m_workspace->context()), title);
    QCOMPARE(window->lblToDate()->text(), u"Figures for "_s + title);
    window->stepPreviousYear();

    // Manager compares three years back; a network request logs everyone off while the
    // comparison is open.
    window->chkCompare()->setChecked(true);
    window->lstCompareCount()->setCurrentIndex(2);
    window->lstCompareType()->setCurrentIndex(1);
    whenModalOpens<CompareWindow>([&](CompareWindow &compare) {
        QTRY_VERIFY_WITH_TIMEOUT(!compare.isLoading(), 60000);
        const GridModel &grid = compare.tabView()->grid();
        QStringList headers;
        for (const QString &key : {u"value3"_s, u"value2"_s, u"value1"_s, u"value"_s})
            headers << grid.column(grid.columnIndex(key)).header;
        QCOMPARE(headers, (QStringList{u"Jul 22 - Jun 23"_s, u"Jul 23 - Jun 24"_s,
                                       u"Jul 24 - Jun 25"_s, u"Jul 25 - Jun 26"_s}));
        QVERIFY(!grid.column(grid.columnIndex(u"value4"_s)).visible);
        QVERIFY(!ConfigValues(m_workspace->context().mainDatabase(), m_workspace->prompter())
                     .setConfigValue(5, u"Logoff"_s));
        window->pollUsers();
        QVERIFY(!compare.isVisible());
    });
    window->produce();

    window->login(u"workshop"_s, u"panel1"_s);
    showsOnlyAllowed(*window->tabView());
    whenModalOpens<PrintWindow>([&](PrintWindow &) {
        QVERIFY(!FileOperations::readTextFile(m_workspace->context().settings().tempHtmlFile)
                     .contains(u"'>"_s + label + u"</td>"_s));
    });
    window->print();
    whenModalOpens<CompareWindow>([&](CompareWindow &compare) {
        QTRY_VERIFY_WITH_TIMEOUT(!compare.isLoading(), 60000);
        showsOnlyAllowed(*compare.tabView());
    });
    window->produce();
}

void TestMainWindow::loginFollowsTheAccount_data()
{
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("welcome"); // empty: refused
    QTest::addColumn<bool>("menu");
    QTest::addColumn<bool>("mapping");
    QTest::newRow("built-in account") << u"sysop"_s << u"sysop"_s << u"sysop"_s << true << true;
    QTest::newRow("administrator in another case")
        << u"MANAGER"_s << u"manager1"_s << u"manager"_s << true << false;
    QTest::newRow("standard user")
        << u"workshop"_s << u"panel1"_s << u"workshop"_s << false << false;
    QTest::newRow("wrong password") << u"manager"_s << u"Manager1"_s << QString() << false << false;
}

void TestMainWindow::loginFollowsTheAccount()
{
    QFETCH(QString, user);
    QFETCH(QString, password);
    QFETCH(QString, welcome);
    QFETCH(bool, menu);
    QFETCH(bool, mapping);
    QTemporaryDir dir;
    auto window = openOnDemo(dir.filePath(u"demo"_s));
    QVERIFY(window);
    window->login(user, password);
    QCOMPARE(window->menuSetup()->isEnabled(), menu);
    QCOMPARE(window->itemSetupUsers()->isEnabled(), menu);
    QCOMPARE(window->itemSetupMapping()->isEnabled(), mapping);
    QCOMPARE(window->itemPrint()->isEnabled(), !welcome.isEmpty());
    const auto &messages = m_workspace->prompter().messages();
    if (welcome.isEmpty()) {
        QCOMPARE(messages.size(), 1);
        QCOMPARE(messages.first().title, u"Login Failed"_s);
        QCOMPARE(messages.first().text,
                 u"Login failed! Ensure your username and password are correct!"_s);
        QVERIFY(!m_workspace->context().loginState().loggedIn);
        return;
    }
    QCOMPARE(window->lblLoggedIn()->text(), u"Welcome, "_s + welcome);
    const QString counted =
        welcome == u"sysop"_s ? u"0 users are logged in"_s : u"1 user is logged in"_s;
    QCOMPARE(window->lblActiveUsers()->text(), counted);
    // A log-off the database cannot record leaves the session as it was; the built-in account
    // is not counted, so its log-off records nothing.
    QSqlQuery sql(m_workspace->context().mainDatabase().database());
    QVERIFY(sql.exec(u"ALTER TABLE Config RENAME TO Gone"_s));
    const bool builtIn = welcome == u"sysop"_s;
    QCOMPARE(window->logoff(true), builtIn);
    if (!builtIn) {
        QVERIFY(messages.last().title.startsWith(u"Logoff Error"_s));
        QCOMPARE(window->lblActiveUsers()->text(), counted);
        QVERIFY(window->itemLogoff()->isEnabled());
    }
    QVERIFY(sql.exec(u"ALTER TABLE Gone RENAME TO Config"_s));
    window->logoff(true);
    QCOMPARE(ConfigValues(m_workspace->context().mainDatabase(), m_workspace->prompter())
                 .getConfigValue(4),
             u"0"_s);
    QVERIFY(!window->menuSetup()->isEnabled());
    QVERIFY(!window->itemPrint()->isEnabled());
    QVERIFY(!window->itemLogoff()->isEnabled());
}

namespace {

// veltrix-cli produce's display text of each Field, by ID.
QHash<QString, QString> cliFigures(const QString &settings, const QString &home)
{
    const CliRun run = runCli({u"produce"_s, u"--settings"_s, settings, u"--from"_s, u"2025-07"_s,
                               u"--to"_s, u"2026-06"_s, u"--user"_s, u"sysop"_s, u"--password"_s,
                               u"sysop"_s, u"--format"_s, u"json"_s},
                              home);
    QHash<QString, QString> figures;
    for (const QJsonValue &record : QJsonDocument::fromJson(run.out.toUtf8()).array())
        figures.insert(record[u"id"_s].toString(), record[u"display"_s].toString());
    return figures;
}

} // namespace

void TestMainWindow::mappingAndRatesReachTheNextProduce()
{
    QTemporaryDir dir;
    const QString demo = dir.filePath(u"demo"_s);
    auto window = openOnDemo(demo);
    QVERIFY(window);
    window->login(u"sysop"_s, u"sysop"_s);
    window->produce();
    const auto valueOf = [&](const QString &id) {
        window->selectTab(0);
        GridModel &grid = window->tabView()->grid();
        return grid.cellText(findGridRow(grid, 1, id), grid.columnIndex(u"value"_s));
    };
    const QString salesBefore = valueOf(u"13"_s);
    const QString hoursBefore = valueOf(u"62"_s);

    // Panel labour sales now also take the paint labour account; panel labour costs $50 an
    // hour.
    whenModalOpens<ProgramSetupDialog>([](ProgramSetupDialog &dialog) {
        const int row = findGridRow(dialog.setup().grid(ProgramSetup::Mapping), 1, u"13"_s);
        editCell(dialog.lstA(), dialog.txtEdit(), row, 4, u" 4-1100+4-1200 "_s);
        dialog.butOK()->click();
    });
    window->itemSetupMapping()->trigger();
    whenModalOpens<HourlyRatesDialog>([](HourlyRatesDialog &dialog) {
        editCell(dialog.lstRates(), dialog.txtEdit(), 1, 3, u"50"_s);
        dialog.butOK()->click();
    });
    window->itemSetupHours()->trigger();
    QVERIFY(m_workspace->prompter().messages().isEmpty());

    window->produce();
    const QString salesAfter = valueOf(u"13"_s);
    const QString hoursAfter = valueOf(u"62"_s);
    QVERIFY(salesAfter != salesBefore);
    QVERIFY(hoursAfter != hoursBefore);
    const QHash<QString, QString> cli = cliFigures(demo + u"/settings.ini"_s, dir.path());
    QCOMPARE(cli.value(u"13"_s), salesAfter);
    QCOMPARE(cli.value(u"62"_s), hoursAfter);
    window->logoff(true);
}

QTEST_MAIN(TestMainWindow)
#include "tst_mainwindow.moc"
