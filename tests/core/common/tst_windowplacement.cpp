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
    void savesNormalWindowInTwips_data();
    void savesNormalWindowInTwips();
    void maximisedAndMinimised();
    void fitsTheScreen_data();
    void fitsTheScreen();
    void restoreAppliesOnlyWholeNumbers_data();
    void restoreAppliesOnlyWholeNumbers();

private:
    std::unique_ptr<QTemporaryDir> m_dir;
    std::unique_ptr<SettingsStore> m_store;
};

void TestWindowPlacement::init()
{
    m_dir = std::make_unique<QTemporaryDir>();
    m_store = std::make_unique<SettingsStore>(m_dir->filePath(u"settings.ini"_s));
}

void TestWindowPlacement::savesNormalWindowInTwips_data()
{
    QTest::addColumn<double>("dpi"); // of the screen the window is on
    QTest::addColumn<QRect>("geometry");
    QTest::addColumn<QStringList>("stored"); // left, top, width, height
    QTest::newRow("96 dpi") << 96.0 << QRect(100, 50, 640, 480)
                            << QStringList{u"1500"_s, u"750"_s, u"9600"_s, u"7200"_s};
    QTest::newRow("120 dpi") << 120.0 << QRect(10, 20, 30, 40)
                             << QStringList{u"120"_s, u"240"_s, u"360"_s, u"480"_s};
    QTest::newRow("144 dpi") << 144.0 << QRect(33, 44, 555, 666)
                             << QStringList{u"330"_s, u"440"_s, u"5550"_s, u"6660"_s};
    QTest::newRow("unknown: as at 96")
        << 0.0 << QRect(1, 2, 3, 4) << QStringList{u"15"_s, u"30"_s, u"45"_s, u"60"_s};
}

void TestWindowPlacement::savesNormalWindowInTwips()
{
    QFETCH(double, dpi);
    QFETCH(QRect, geometry);
    QFETCH(QStringList, stored);
    const double twips = WindowPlacement::twipsPerPixelAt(dpi);
    WindowPlacement(*m_store, twips)
        .save(u"frmCompare"_s, geometry, WindowPlacement::State::Normal);
    QStringList written;
    for (const QString &key : {u"Left"_s, u"Top"_s, u"Width"_s, u"Height"_s})
        written << m_store->readSetting(u"frmCompare"_s + key, SettingsStore::FormsKey);
    QCOMPARE(written, stored);
    QCOMPARE(m_store->readSetting(u"frmCompareState"_s, SettingsStore::FormsKey), u"0"_s);
    QCOMPARE(WindowPlacement(*m_store, twips).restore(u"frmCompare"_s, QRect()), geometry);
}

void TestWindowPlacement::maximisedAndMinimised()
{
    WindowPlacement placement(*m_store, 15.0);
    // Minimised records nothing.
    placement.save(u"frmPrint"_s, QRect(10, 20, 300, 200), WindowPlacement::State::Minimised);
    QCOMPARE(m_store->readSetting(u"frmPrintTop"_s, SettingsStore::FormsKey), QString());
    QCOMPARE(placement.savedState(u"frmPrint"_s), std::nullopt);
    // Maximised keeps the last normal geometry.
    placement.save(u"frmPrint"_s, QRect(10, 20, 300, 200), WindowPlacement::State::Normal);
    placement.save(u"frmPrint"_s, QRect(0, 0, 1920, 1080), WindowPlacement::State::Maximised);
    QCOMPARE(placement.restore(u"frmPrint"_s, QRect()), QRect(10, 20, 300, 200));
    QCOMPARE(placement.savedState(u"frmPrint"_s), WindowPlacement::State::Maximised);
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

void TestWindowPlacement::fitsTheScreen_data()
{
    QTest::addColumn<QRect>("wanted");
    QTest::addColumn<QRect>("parent"); // invalid: placed before, keep its place
    QTest::addColumn<QRect>("expected");
    const QRect area(0, 0, 933, 600); // 1400 x 900 at 150 %, less nothing
    QTest::newRow("larger than the screen") << QRect(0, 0, 1000, 760) << QRect() << area;
    QTest::newRow("fits where it is")
        << QRect(10, 20, 400, 300) << QRect() << QRect(10, 20, 400, 300);
    QTest::newRow("saved on a wider screen")
        << QRect(1500, 700, 400, 300) << QRect() << QRect(533, 300, 400, 300);
    QTest::newRow("above and left of the screen")
        << QRect(-50, -40, 400, 300) << QRect() << QRect(0, 0, 400, 300);
    QTest::newRow("new window over its parent")
        << QRect(0, 0, 400, 300) << QRect(100, 100, 600, 400) << QRect(200, 150, 400, 300);
    QTest::newRow("parent near the edge")
        << QRect(0, 0, 400, 300) << QRect(700, 400, 200, 200) << QRect(533, 300, 400, 300);
}

void TestWindowPlacement::fitsTheScreen()
{
    QFETCH(QRect, wanted);
    QFETCH(QRect, parent);
    QFETCH(QRect, expected);
    const QRect area(0, 0, 933, 600);
    const QRect placed = parent.isValid()
                             ? WindowPlacement::centredOver(wanted.size(), parent, area)
                             : WindowPlacement::fittedInto(wanted, area);
    QCOMPARE(placed, expected);
}

QTEST_GUILESS_MAIN(TestWindowPlacement)
#include "tst_windowplacement.moc"
