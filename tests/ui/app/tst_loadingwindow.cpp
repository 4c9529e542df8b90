// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/configdialog.h"
#include "app/loadingwindow.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QSignalSpy>
#include <QSqlQuery>
#include <QTest>
#include <QTimer>

using namespace Qt::StringLiterals;

class TestLoadingWindow : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void startsWaitingThenOffersOptions();
    void updateStateOffersUpdate();
    void optionsCancelledOrSaved();
    void successHandsOverAndAboutShowsBothVersions();
};

void TestLoadingWindow::startsWaitingThenOffersOptions()
{
    TestWorkspace workspace;
    LoadingWindow window(workspace.context(), workspace.prompter());
    QCOMPARE(window.windowTitle(), u" Veltrix"_s);
    QCOMPARE(window.lblVersion()->text(), u"Software Version 1.55"_s);
    QVERIFY(window.lblDBVersion()->isHidden());
    QVERIFY(window.lblStatus()->isHidden());
    QCOMPARE(window.lblStatus()->text(), u"Loading, please stand by..."_s);
    QVERIFY(window.butOptions()->isHidden());
    QVERIFY(window.butUpdate()->isHidden());
    QVERIFY(window.butClose()->isHidden());
    QCOMPARE(window.tmrLoad()->interval(), 500);
    QVERIFY(!window.tmrLoad()->isActive());
    window.show();
    QVERIFY(QTest::qWaitForWindowExposed(&window));
    window.startLoading();
    QVERIFY(window.tmrLoad()->isActive());
    // With nothing configured start-up fails and offers the options.
    QTRY_VERIFY(!window.lblStatus()->isHidden());
    QCOMPARE(window.lblStatus()->text(), u"Your accounting package must be specified!"_s);
    QVERIFY(window.lblStatus()->styleSheet().contains(u"rgb(255, 0, 0)"_s));
    QVERIFY(!window.butOptions()->isHidden());
    QVERIFY(window.butUpdate()->isHidden());
    QVERIFY(!window.butClose()->isHidden());
    QCOMPARE(window.butClose()->text(), u"E&xit"_s);
    QCOMPARE(window.focusWidget(), window.butOptions());
    QVERIFY(!window.tmrLoad()->isActive());
    QVERIFY(!workspace.prompter().isBusy());
}

void TestLoadingWindow::updateStateOffersUpdate()
{
    TestWorkspace workspace;
    QVERIFY(workspace.configure());
    QVERIFY(workspace.setConfigRow(1, u"1.4"_s));
    LoadingWindow window(workspace.context(), workspace.prompter());
    window.show();
    QVERIFY(QTest::qWaitForWindowExposed(&window));
    window.runSequence();
    QCOMPARE(window.lblStatus()->text(),
             u"You must update the database to work with this version of Veltrix!"_s);
    QVERIFY(!window.butUpdate()->isHidden());
    QVERIFY(window.butOptions()->isHidden());
    QCOMPARE(window.focusWidget(), window.butUpdate());
    QVERIFY(!workspace.context().mainDatabase().isConnected());
}

void TestLoadingWindow::optionsCancelledOrSaved()
{
    TestWorkspace workspace;
    QVERIFY(QFile::copy(QStringLiteral(VELTRIX_NEW_DB), workspace.appFolder() + u"new.db"_s));
    LoadingWindow window(workspace.context(), workspace.prompter());
    QSignalSpy handedOver(&window, &LoadingWindow::startupSucceeded);
    window.show();
    window.runSequence();
    QVERIFY(!window.butOptions()->isHidden());
    const QString message = window.lblStatus()->text();
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
    QVERIFY(window.tmrLoad()->isActive());
    QTRY_COMPARE(handedOver.count(), 1);
}

void TestLoadingWindow::successHandsOverAndAboutShowsBothVersions()
{
    TestWorkspace workspace;
    QVERIFY(workspace.configure());
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

QTEST_MAIN(TestLoadingWindow)
#include "tst_loadingwindow.moc"
