// Veltrix — KPI dashboard for small businesses.
#include "app/widgetplacement.h"
#include "common/settingsstore.h"

#include <QTemporaryDir>
#include <QTest>
#include <QWidget>

using namespace Qt::StringLiterals;

class TestWidgetPlacement : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void restoresWhereTheWindowWas();
    void maximisedStateIsAppliedOnlyWhenAsked();
};

void TestWidgetPlacement::restoresWhereTheWindowWas()
{
    QTemporaryDir dir;
    SettingsStore store(dir.filePath(u"settings.ini"_s));
    {
        QWidget window;
        window.setObjectName(u"frmCompare"_s);
        window.move(120, 80);
        window.resize(500, 350);
        WidgetPlacement::saveWindowPlacement(window, store);
    }
    QVERIFY(!store.readSetting(u"frmCompareWidth"_s, SettingsStore::FormsKey).isEmpty());

    QWidget again;
    again.setObjectName(u"frmCompare"_s);
    WidgetPlacement::restoreWindowPlacement(again, store, true);
    QCOMPARE(again.pos(), QPoint(120, 80));
    QCOMPARE(again.size(), QSize(500, 350));
}

void TestWidgetPlacement::maximisedStateIsAppliedOnlyWhenAsked()
{
    QTemporaryDir dir;
    SettingsStore store(dir.filePath(u"settings.ini"_s));
    store.writeSetting(u"frmPrintState"_s, u"2"_s, SettingsStore::FormsKey);

    QWidget skipped;
    skipped.setObjectName(u"frmPrint"_s);
    WidgetPlacement::restoreWindowPlacement(skipped, store, true);
    QVERIFY(!(skipped.windowState() & Qt::WindowMaximized));

    QWidget applied;
    applied.setObjectName(u"frmPrint"_s);
    WidgetPlacement::restoreWindowPlacement(applied, store, false);
    QVERIFY(applied.windowState() & Qt::WindowMaximized);
}

QTEST_MAIN(TestWidgetPlacement)
#include "tst_widgetplacement.moc"
