// Veltrix — KPI dashboard for small businesses.
#include "common/settingsstore.h"
#include "common/windowplacement.h"

#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

class TestWindowPlacement : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void twipsPerPixel_data();
    void twipsPerPixel();
    void savesNormalWindowInTwips();
    void maximisedKeepsLastNormalGeometry();
    void minimisedRecordsNothing();
    void restoreAppliesOnlyWholeNumbers_data();
    void restoreAppliesOnlyWholeNumbers();
    void roundTripAtHighDensity();

private:
    std::unique_ptr<QTemporaryDir> m_dir;
    std::unique_ptr<SettingsStore> m_store;
};

void TestWindowPlacement::init()
{
    m_dir = std::make_unique<QTemporaryDir>();
    m_store = std::make_unique<SettingsStore>(m_dir->filePath(u"settings.ini"_s));
}

void TestWindowPlacement::twipsPerPixel_data()
{
    QTest::addColumn<double>("dpi");
    QTest::addColumn<double>("twips");
    QTest::newRow("96 dpi") << 96.0 << 15.0;
    QTest::newRow("120 dpi") << 120.0 << 12.0;
    QTest::newRow("144 dpi") << 144.0 << 10.0;
    QTest::newRow("unknown") << 0.0 << 15.0;
}

void TestWindowPlacement::twipsPerPixel()
{
    QFETCH(double, dpi);
    QFETCH(double, twips);
    QCOMPARE(WindowPlacement::twipsPerPixelAt(dpi), twips);
}

void TestWindowPlacement::savesNormalWindowInTwips()
{
    WindowPlacement placement(*m_store, 15.0);
    placement.save(u"frmCompare"_s, QRect(100, 50, 640, 480), WindowPlacement::State::Normal);
    const QString forms = SettingsStore::FormsKey;
    QCOMPARE(m_store->readSetting(u"frmCompareLeft"_s, forms), u"1500"_s);
    QCOMPARE(m_store->readSetting(u"frmCompareTop"_s, forms), u"750"_s);
    QCOMPARE(m_store->readSetting(u"frmCompareWidth"_s, forms), u"9600"_s);
    QCOMPARE(m_store->readSetting(u"frmCompareHeight"_s, forms), u"7200"_s);
    QCOMPARE(m_store->readSetting(u"frmCompareState"_s, forms), u"0"_s);
    QCOMPARE(placement.restore(u"frmCompare"_s, QRect()), QRect(100, 50, 640, 480));
}

void TestWindowPlacement::maximisedKeepsLastNormalGeometry()
{
    WindowPlacement placement(*m_store, 15.0);
    placement.save(u"frmPrint"_s, QRect(10, 20, 300, 200), WindowPlacement::State::Normal);
    placement.save(u"frmPrint"_s, QRect(0, 0, 1920, 1080), WindowPlacement::State::Maximised);
    QCOMPARE(placement.restore(u"frmPrint"_s, QRect()), QRect(10, 20, 300, 200));
    QCOMPARE(placement.savedState(u"frmPrint"_s), WindowPlacement::State::Maximised);
}

void TestWindowPlacement::minimisedRecordsNothing()
{
    WindowPlacement placement(*m_store, 15.0);
    placement.save(u"frmPrint"_s, QRect(10, 20, 300, 200), WindowPlacement::State::Minimised);
    QCOMPARE(m_store->readSetting(u"frmPrintTop"_s, SettingsStore::FormsKey), QString());
    QCOMPARE(m_store->readSetting(u"frmPrintState"_s, SettingsStore::FormsKey), QString());
    QCOMPARE(placement.savedState(u"frmPrint"_s), std::nullopt);
}

void TestWindowPlacement::restoreAppliesOnlyWholeNumbers_data()
{
    QTest::addColumn<QString>("top");
    QTest::addColumn<QString>("width");
    QTest::addColumn<QRect>("expected");
    const QRect current(5, 6, 70, 80);
    QTest::newRow("both") << u"300"_s << u"1500"_s << QRect(5, 20, 100, 80);
    QTest::newRow("missing top") << QString() << u"1500"_s << QRect(5, 6, 100, 80);
    QTest::newRow("words") << u"high"_s << u"wide"_s << current;
    QTest::newRow("fraction") << u"300.5"_s << u"1500"_s << QRect(5, 6, 100, 80);
    QTest::newRow("negative top") << u"-150"_s << QString() << QRect(5, -10, 70, 80);
}

void TestWindowPlacement::restoreAppliesOnlyWholeNumbers()
{
    QFETCH(QString, top);
    QFETCH(QString, width);
    QFETCH(QRect, expected);
    m_store->writeSetting(u"frmCompareTop"_s, top, SettingsStore::FormsKey);
    m_store->writeSetting(u"frmCompareWidth"_s, width, SettingsStore::FormsKey);
    QCOMPARE(WindowPlacement(*m_store, 15.0).restore(u"frmCompare"_s, QRect(5, 6, 70, 80)),
             expected);
}

void TestWindowPlacement::roundTripAtHighDensity()
{
    WindowPlacement(*m_store, 10.0)
        .save(u"frmCompare"_s, QRect(33, 44, 555, 666), WindowPlacement::State::Normal);
    QCOMPARE(m_store->readSetting(u"frmCompareWidth"_s, SettingsStore::FormsKey), u"5550"_s);
    QCOMPARE(WindowPlacement(*m_store, 10.0).restore(u"frmCompare"_s, QRect()),
             QRect(33, 44, 555, 666));
}

QTEST_GUILESS_MAIN(TestWindowPlacement)
#include "tst_windowplacement.moc"
