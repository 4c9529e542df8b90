// Veltrix — KPI dashboard for small businesses.
#include "common/settingsstore.h"
#include "engine/rangeselection.h"

#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;
using RangeSelection::Selection;

Q_DECLARE_METATYPE(Selection)

namespace {
constexpr int ThisYear = 2026;
using Step = std::function<std::optional<Selection>(const Selection &)>;

QList<int> fields(const std::optional<Selection> &selection)
{
    if (!selection)
        return {};
    return {selection->firstMonth, selection->firstYear, selection->lastMonth, selection->lastYear};
}
} // namespace

class TestRangeSelection : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void steps_data();
    void steps();
    void years_data();
    void years();
    void remembered_data();
    void remembered();
};

void TestRangeSelection::steps_data()
{
    QTest::addColumn<QString>("step");
    QTest::addColumn<Selection>("from");
    QTest::addColumn<std::optional<Selection>>("to");
    QTest::newRow("back a month from March") << u"previous month"_s << Selection{3, 2005, 6, 2005}
                                             << std::optional(Selection{2, 2005, 2, 2005});
    QTest::newRow("back from January") << u"previous month"_s << Selection{1, 2005, 1, 2005}
                                       << std::optional(Selection{12, 2004, 12, 2004});
    QTest::newRow("back from January 1950")
        << u"previous month"_s << Selection{1, 1950, 3, 1950} << std::optional<Selection>();
    QTest::newRow("on from December this year")
        << u"following month"_s << Selection{12, ThisYear, 12, ThisYear}
        << std::optional<Selection>();
    QTest::newRow("on from December last year")
        << u"following month"_s << Selection{12, 2025, 12, 2025}
        << std::optional(Selection{1, 2026, 1, 2026});
    QTest::newRow("beyond today within this year")
        << u"following month"_s << Selection{11, ThisYear, 11, ThisYear}
        << std::optional(Selection{12, ThisYear, 12, ThisYear});
    QTest::newRow("financial year back") << u"previous year"_s << Selection{7, 2004, 6, 2005}
                                         << std::optional(Selection{7, 2003, 6, 2004});
    QTest::newRow("back from 1950")
        << u"previous year"_s << Selection{7, 1950, 6, 1951} << std::optional<Selection>();
    QTest::newRow("a range in one year moves on a year")
        << u"following year"_s << Selection{3, 2005, 5, 2005}
        << std::optional(Selection{3, 2006, 5, 2007});
    QTest::newRow("on from this year")
        << u"following year"_s << Selection{1, ThisYear, 6, ThisYear} << std::optional<Selection>();
}

void TestRangeSelection::steps()
{
    QFETCH(QString, step);
    QFETCH(Selection, from);
    QFETCH(std::optional<Selection>, to);
    const QHash<QString, Step> steps = {
        {u"previous month"_s, RangeSelection::previousMonth},
        {u"following month"_s,
         [](const Selection &s) { return RangeSelection::followingMonth(s, ThisYear); }},
        {u"previous year"_s, RangeSelection::previousYear},
        {u"following year"_s,
         [](const Selection &s) { return RangeSelection::followingYear(s, ThisYear); }},
    };
    QCOMPARE(fields(steps.value(step)(from)), fields(to));
}

void TestRangeSelection::years_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("valid");
    QTest::newRow("1950") << u"1950"_s << true;
    QTest::newRow("1949") << u"1949"_s << false;
    QTest::newRow("this year") << u"2026"_s << true;
    QTest::newRow("next year") << u"2027"_s << false;
    QTest::newRow("words") << u"last year"_s << false;
}

void TestRangeSelection::years()
{
    QFETCH(QString, text);
    QFETCH(bool, valid);
    QCOMPARE(RangeSelection::isValidYear(text, ThisYear), valid);
    QCOMPARE(RangeSelection::invalidYearMessage(ThisYear),
             u"The specified year is invalid! The year must be between 1950 and the current "
             u"year 2026"_s);
}

void TestRangeSelection::remembered_data()
{
    QTest::addColumn<QStringList>("stored");   // M1, M2, Y1, Y2 ("-" for missing)
    QTest::addColumn<QStringList>("expected"); // months 1-12 and years; empty if unusable
    QTest::newRow("nothing remembered") << QStringList{u"-"_s, u"-"_s, u"-"_s, u"-"_s}
                                        << QStringList{u"1"_s, u"1"_s, u"2026"_s, u"2026"_s};
    QTest::newRow("a financial year") << QStringList{u"6"_s, u"5"_s, u"2025"_s, u"2026"_s}
                                      << QStringList{u"7"_s, u"6"_s, u"2025"_s, u"2026"_s};
    QTest::newRow("month not a number") << QStringList{u"x"_s, u"11"_s, u"2024"_s, u"24"_s}
                                        << QStringList{u"1"_s, u"12"_s, u"2024"_s, u"2026"_s};
    QTest::newRow("month out of range")
        << QStringList{u"12"_s, u"0"_s, u"2024"_s, u"2024"_s} << QStringList();
}

void TestRangeSelection::remembered()
{
    QFETCH(QStringList, stored);
    QFETCH(QStringList, expected);
    QTemporaryDir dir;
    SettingsStore store(dir.filePath(u"settings.ini"_s));
    const QStringList names{u"M1"_s, u"M2"_s, u"Y1"_s, u"Y2"_s};
    for (int i = 0; i < 4; ++i) {
        if (stored[i] != u"-"_s)
            store.writeSetting(names[i], stored[i]);
    }
    const auto choice = RangeSelection::remembered(store, ThisYear);
    QStringList shown;
    if (choice) {
        shown << QString::number(choice->firstMonth) << QString::number(choice->lastMonth)
              << choice->firstYear << choice->lastYear;
    }
    QCOMPARE(shown, expected);
}

QTEST_GUILESS_MAIN(TestRangeSelection)
#include "tst_rangeselection.moc"
