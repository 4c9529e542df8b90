// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/configdialog.h"
#include "app/loadingwindow.h"
#include "app/widgetplacement.h"
#include "cipher/passwordcipher.h"

#include <QApplication>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QSignalSpy>
#include <QTest>
#include <QTimer>
#include <QToolButton>

using namespace Qt::StringLiterals;

class TestAppWindows : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void configShowsRefusesAndSaves();
    void loadingFailsThenOffersOptions();
    void loadingOffersTheUpdateOrHandsOver();
    void placementIsRestored();
};

void TestAppWindows::configShowsRefusesAndSaves()
{
    TestWorkspace workspace;
    SettingsStore &store = workspace.store();
    store.writeSetting(u"DBPath"_s, u"/srv/veltrix/"_s);
    store.writeSetting(u"AccPackage"_s, u"MYOB"_s);
    store.writeSetting(u"AccFilePath"_s, u"/books/acme.myo"_s);
    store.writeSetting(u"AccFileDriver"_s, u"MYOAU0801"_s);
    store.writeSetting(u"AccFileUser"_s, u"Administrator"_s);
    store.writeSetting(u"AccFilePass"_s,
                       PasswordCipher().encryptText(u"hunter2"_s, Settings::PasswordKey));

    ConfigDialog dialog(store, workspace.prompter());
    QCOMPARE(dialog.windowTitle(), u" System Configuration"_s);
    QCOMPARE(dialog.txtDBPath()->text(), u"/srv/veltrix/"_s);
    QVERIFY(dialog.optAccPackage(1)->isChecked());
    QVERIFY(!dialog.driverRow()->isHidden());
    QCOMPARE(dialog.txtAccFilePath()->text(), u"/books/acme.myo"_s);
    QCOMPARE(dialog.lstDriver()->currentText(), u"MYOAU0801"_s);
    QCOMPARE(dialog.txtAccUsername()->text(), u"Administrator"_s);
    QCOMPARE(dialog.txtAccPassword()->text(), u"hunter2"_s);
    QCOMPARE(dialog.txtAccPassword()->echoMode(), QLineEdit::Password);

    dialog.txtAccUsername()->setText(u"Admin"_s);
    dialog.optAccPackage(0)->click();
    QCOMPARE(dialog.packageName(), u"MoneyWorks"_s);
    // A MoneyWorks server takes a login as well; the driver is MYOB's alone.
    QVERIFY(!dialog.picLogin()->isHidden());
    QVERIFY(dialog.driverRow()->isHidden());
    QCOMPARE(dialog.lstDriver()->currentText(), u"MYOAU0801"_s);

    // Browsed paths are taken; a folder that does not exist is refused.
    dialog.show();
    workspace.prompter().scriptChosenPath(u"/books/acme.mwd5"_s);
    dialog.butBrowseFile()->click();
    QCOMPARE(dialog.txtAccFilePath()->text(), u"/books/acme.mwd5"_s);
    dialog.txtAccFilePath()->clear(); // no such file here
    workspace.prompter().scriptChosenPath(u"/no/such/folder"_s);
    dialog.butBrowsePath()->click();
    dialog.butBrowsePath()->click(); // cancelled: nothing chosen
    QCOMPARE(dialog.txtDBPath()->text(), u"/no/such/folder"_s);
    dialog.butOK()->click();
    QVERIFY(!dialog.saved());
    QVERIFY(dialog.isVisible());
    QCOMPARE(dialog.txtDBPath()->text(), u"/no/such/folder"_s + QDir::separator());
    QCOMPARE(workspace.prompter().messages().size(), 1);
    QCOMPARE(workspace.prompter().messages().first().title, u"Invalid Folder Path"_s);

    dialog.txtDBPath()->setText(workspace.sharedFolder());
    dialog.butOK()->click();
    QVERIFY(dialog.saved());
    QCOMPARE(store.readSetting(u"AccFileUser"_s), u"Admin"_s);
    QCOMPARE(store.readSetting(u"AccPackage"_s), u"MoneyWorks"_s);

    // An empty store selects nothing.
    TestWorkspace fresh;
    ConfigDialog empty(fresh.store(), fresh.prompter());
    QVERIFY(!empty.optAccPackage(0)->isChecked());
    QVERIFY(!empty.optAccPackage(1)->isChecked());
    QVERIFY(empty.picLogin()->isHidden());
}

void TestAppWindows::loadingFailsThenOffersOptions()
{
    TestWorkspace workspace;
    QVERIFY(QFile::copy(QStringLiteral(VELTRIX_NEW_DB), workspace.appFolder() + u"new.db"_s));
    LoadingWindow window(workspace.context(), workspace.prompter());
    QSignalSpy handedOver(&window, &LoadingWindow::startupSucceeded);
    QCOMPARE(window.windowTitle(), u" Veltrix"_s);
    QCOMPARE(window.lblVersion()->text(), u"Software Version 1.55"_s);
    QVERIFY(window.butOptions()->isHidden());
    window.show();
    QVERIFY(QTest::qWaitForWindowExposed(&window));
    window.startLoading();
    QVERIFY(window.tmrLoad()->isActive());
    // With nothing configured start-up fails and offers the options.
    QTRY_VERIFY(!window.lblStatus()->isHidden());
    const QString message = u"Your accounting package must be specified!"_s;
    QCOMPARE(window.lblStatus()->text(), message);
    QVERIFY(window.lblStatus()->styleSheet().contains(u"rgb(255, 0, 0)"_s));
    QVERIFY(window.butUpdate()->isHidden());
    QCOMPARE(window.butClose()->text(), u"E&xit"_s);
    QVERIFY(!window.butClose()->isHidden());
    QCOMPARE(window.focusWidget(), window.butOptions());
    QVERIFY(!workspace.prompter().isBusy());
    // Cancelled options change nothing.
    QTimer::singleShot(0, this, [] {
        auto *dialog = qobject_cast<ConfigDialog *>(QApplication::activeModalWidget());
        QVERIFY(dialog);
        dialog->reject();
    });
    window.butOptions()->click();
    QCOMPARE(window.lblStatus()->text(), message);
    QVERIFY(!window.butOptions()->isHidden());
    QVERIFY(!window.tmrLoad()->isActive());

    QTimer::singleShot(0, this, [&] {
        auto *dialog = qobject_cast<ConfigDialog *>(QApplication::activeModalWidget());
        QVERIFY(dialog);
        dialog->txtDBPath()->setText(workspace.sharedFolder());
        dialog->optAccPackage(0)->click();
        dialog->butOK()->click();
    });
    window.butOptions()->click();
    QVERIFY(window.lblStatus()->text().isEmpty());
    QVERIFY(window.butOptions()->isHidden());
    QVERIFY(window.butClose()->isHidden());
    QTRY_COMPARE(handedOver.count(), 1);
}

void TestAppWindows::loadingOffersTheUpdateOrHandsOver()
{
    TestWorkspace workspace;
    QVERIFY(workspace.configure());
    QVERIFY(workspace.setConfigRow(1, u"1.4"_s));
    {
        LoadingWindow window(workspace.context(), workspace.prompter());
        window.show();
        QVERIFY(QTest::qWaitForWindowExposed(&window));
        window.runSequence();
        QCOMPARE(window.lblStatus()->text(),
                 u"You must update the database to work with this version of Veltrix!"_s);
        QVERIFY(window.butOptions()->isHidden());
        QCOMPARE(window.focusWidget(), window.butUpdate());
        QVERIFY(!workspace.context().mainDatabase().isConnected());
    }

    // Once the database is up to date the start-up hands over; About shows both versions.
    QVERIFY(workspace.setConfigRow(1, u"1.55"_s));
    LoadingWindow starter(workspace.context(), workspace.prompter());
    QSignalSpy handedOver(&starter, &LoadingWindow::startupSucceeded);
    starter.show();
    starter.runSequence();
    QCOMPARE(handedOver.count(), 1);
    QVERIFY(!starter.isVisible());
    QVERIFY(workspace.context().mainDatabase().isConnected());

    QString databaseLabel;
    QString closeCaption;
    bool timerActive = true;
    QTimer::singleShot(0, this, [&] {
        auto *about = qobject_cast<LoadingWindow *>(QApplication::activeModalWidget());
        QVERIFY(about);
        databaseLabel =
            about->lblDBVersion()->isHidden() ? QString() : about->lblDBVersion()->text();
        closeCaption = about->butClose()->isHidden() ? QString() : about->butClose()->text();
        timerActive = about->tmrLoad()->isActive();
        about->butClose()->click();
    });
    LoadingWindow::showAbout(workspace.context(), workspace.prompter(), nullptr);
    QCOMPARE(databaseLabel, u"Database Version 1.55"_s);
    QCOMPARE(closeCaption, u"Close"_s);
    QVERIFY(!timerActive);
}

void TestAppWindows::placementIsRestored()
{
    TestWorkspace workspace;
    SettingsStore &store = workspace.store();
    {
        QWidget window;
        window.setObjectName(u"frmCompare"_s);
        window.move(120, 80);
        window.resize(500, 350);
        WidgetPlacement::saveWindowPlacement(window, store);
    }
    QWidget again;
    again.setObjectName(u"frmCompare"_s);
    WidgetPlacement::restoreWindowPlacement(again, store, true);
    QCOMPARE(again.pos(), QPoint(120, 80));
    QCOMPARE(again.size(), QSize(500, 350));

    // A maximised state is applied only when asked.
    store.writeSetting(u"frmPrintState"_s, u"2"_s, SettingsStore::FormsKey);
    for (const bool skipState : {true, false}) {
        QWidget window;
        window.setObjectName(u"frmPrint"_s);
        WidgetPlacement::restoreWindowPlacement(window, store, skipState);
        QCOMPARE(bool(window.windowState() & Qt::WindowMaximized), !skipState);
    }
}

QTEST_MAIN(TestAppWindows)
#include "tst_appwindows.moc"
