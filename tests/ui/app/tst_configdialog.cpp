// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/configdialog.h"
#include "cipher/passwordcipher.h"

#include <QComboBox>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTest>
#include <QToolButton>

using namespace Qt::StringLiterals;

class TestConfigDialog : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void showsTheStoredSettings();
    void switchingPackageHidesButKeepsTheLogin();
    void browsingFillsTheBoxes();
    void failedCheckKeepsTheDialogOpen();
};

void TestConfigDialog::showsTheStoredSettings()
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
    QVERIFY(!dialog.picLogin()->isHidden());
    QCOMPARE(dialog.txtAccFilePath()->text(), u"/books/acme.myo"_s);
    QCOMPARE(dialog.lstDriver()->currentText(), u"MYOAU0801"_s);
    QCOMPARE(dialog.txtAccUsername()->text(), u"Administrator"_s);
    QCOMPARE(dialog.txtAccPassword()->text(), u"hunter2"_s);
    QCOMPARE(dialog.txtAccPassword()->echoMode(), QLineEdit::Password);
    QCOMPARE(dialog.butBrowsePath()->toolTip(),
             u"Choose the folder that contains the main.db file"_s);
}

void TestConfigDialog::switchingPackageHidesButKeepsTheLogin()
{
    TestWorkspace workspace;
    ConfigDialog dialog(workspace.store(), workspace.prompter());
    dialog.optAccPackage(1)->click();
    QCOMPARE(dialog.packageName(), u"MYOB"_s);
    QVERIFY(!dialog.picLogin()->isHidden());
    QVERIFY(!dialog.driverRow()->isHidden());
    dialog.txtAccUsername()->setText(u"Admin"_s);
    dialog.lstDriver()->setEditText(u"MYOAU0901"_s);
    dialog.optAccPackage(0)->click();
    QCOMPARE(dialog.packageName(), u"MoneyWorks"_s);
    // A MoneyWorks server takes a login as well; the driver is MYOB's alone.
    QVERIFY(!dialog.picLogin()->isHidden());
    QVERIFY(dialog.driverRow()->isHidden());
    QCOMPARE(dialog.lstDriver()->currentText(), u"MYOAU0901"_s);

    dialog.txtDBPath()->setText(workspace.sharedFolder());
    dialog.butOK()->click();
    QVERIFY(dialog.saved());
    QCOMPARE(workspace.store().readSetting(u"AccFileUser"_s), u"Admin"_s);
    QCOMPARE(workspace.store().readSetting(u"AccPackage"_s), u"MoneyWorks"_s);
}

void TestConfigDialog::browsingFillsTheBoxes()
{
    TestWorkspace workspace;
    ConfigDialog dialog(workspace.store(), workspace.prompter());
    // An empty store selects nothing.
    QCOMPARE(dialog.txtDBPath()->text(), QString());
    QVERIFY(!dialog.optAccPackage(0)->isChecked());
    QVERIFY(!dialog.optAccPackage(1)->isChecked());
    QVERIFY(dialog.picLogin()->isHidden());
    dialog.txtDBPath()->setText(u"/old"_s);
    workspace.prompter().scriptChosenPath(u"/srv/shared"_s);
    dialog.butBrowsePath()->click();
    QCOMPARE(dialog.txtDBPath()->text(), u"/srv/shared"_s);
    dialog.butBrowsePath()->click(); // cancelled: nothing chosen
    QCOMPARE(dialog.txtDBPath()->text(), u"/srv/shared"_s);

    workspace.prompter().scriptChosenPath(u"/books/acme.mwd5"_s);
    dialog.butBrowseFile()->click();
    QCOMPARE(dialog.txtAccFilePath()->text(), u"/books/acme.mwd5"_s);
}

void TestConfigDialog::failedCheckKeepsTheDialogOpen()
{
    TestWorkspace workspace;
    ConfigDialog dialog(workspace.store(), workspace.prompter());
    dialog.show();
    dialog.txtDBPath()->setText(u"/no/such/folder"_s);
    dialog.optAccPackage(0)->click();
    dialog.butOK()->click();
    QVERIFY(!dialog.saved());
    QVERIFY(dialog.isVisible());
    QCOMPARE(dialog.txtDBPath()->text(), u"/no/such/folder"_s + QDir::separator());
    QCOMPARE(workspace.prompter().messages().size(), 1);
    QCOMPARE(workspace.prompter().messages().first().title, u"Invalid Folder Path"_s);
}

QTEST_MAIN(TestConfigDialog)
#include "tst_configdialog.moc"
