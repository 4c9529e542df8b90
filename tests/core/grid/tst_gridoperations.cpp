// Veltrix — KPI dashboard for small businesses.
#include "common/numberformat.h"
#include "grid/gridoperations.h"

#include <QSignalSpy>
#include <QTest>

using namespace Qt::StringLiterals;
using namespace GridOperations;

namespace {

// A setup list: id, type, label, value.
void addRows(GridModel &grid, const QList<QStringList> &rows)
{
    for (const QStringList &cells : rows) {
        const int row = grid.addRow();
        for (int c = 0; c < cells.size(); ++c)
            grid.setCellText(row, c + 1, cells[c]);
    }
}

} // namespace

class TestGridOperations : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void sortTypesByKey_data();
    void sortTypesByKey();
    void sortsByType();
    void formatSetupList();
    void fitColumn_data();
    void fitColumn();
    void rowsAreFoundByIdOrText();
    void cellStylesAndRedraw();
};

void TestGridOperations::sortTypesByKey_data()
{
    QTest::addColumn<QString>("key");
    QTest::addColumn<int>("sortType");
    QTest::newRow("id") << u"id"_s << 100;
    QTest::newRow("id inside a word") << u"Valid"_s << 100;
    QTest::newRow("order") << u"Order"_s << 100;
    QTest::newRow("date created") << u"datecreated"_s << 254;
    QTest::newRow("update amount: a number first") << u"updateamount"_s << 100;
    QTest::newRow("label") << u"label"_s << 103;
}

void TestGridOperations::sortTypesByKey()
{
    QFETCH(QString, key);
    QFETCH(int, sortType);
    GridModel grid;
    grid.addColumn(key, key, GridModel::AlignLeft, 50, true);
    setupGrid(grid);
    QCOMPARE(grid.column(1).sortType, sortType);
    QCOMPARE(grid.column(1).dateFormat.isEmpty(), sortType != 254);
}

void TestGridOperations::sortsByType()
{
    GridModel grid;
    grid.addColumn(u"id"_s, QString(), 0, 10, true);
    grid.addColumn(u"name"_s, QString(), 0, 10, true);
    grid.addColumn(u"datecreated"_s, QString(), 0, 10, true);
    // Dates as the program writes them, in an order that text comparison gets wrong.
    addRows(grid, {{u"10"_s, u"bob"_s, u"30 Jan 2027 10:00 AM"_s},
                   {u"9"_s, u"Anna"_s, u"5 Dec 2026 9:05 AM"_s},
                   {u"100"_s, u"carl"_s, u"5 Dec 2026 8:59 PM"_s}});
    setupGrid(grid);
    grid.setSelectedRow(1); // bob
    sortGrid(grid, 1, true);
    QCOMPARE(grid.cellText(1, 1), u"9"_s);
    QCOMPARE(grid.cellText(3, 1), u"100"_s); // numbers, not text
    QCOMPARE(grid.column(1).tag, u"ASCEND"_s);
    QCOMPARE(grid.cellText(grid.selectedRow(), 2), u"bob"_s);
    sortGrid(grid, 2, false);
    QCOMPARE(grid.cellText(1, 2), u"carl"_s);
    QCOMPARE(grid.cellText(3, 2), u"Anna"_s);
    QCOMPARE(grid.column(2).tag, QString());
    sortGrid(grid, 3, true);
    QCOMPARE(grid.cellText(1, 2), u"Anna"_s);
    QCOMPARE(grid.cellText(2, 2), u"carl"_s);
}

void TestGridOperations::formatSetupList()
{
    GridModel grid;
    for (const QString &key : {u"id"_s, u"type"_s, u"label"_s, u"data"_s})
        grid.addColumn(key, key, 0, 50, true);
    addRows(grid, {{u"1"_s, u"1"_s, u"Heading A"_s},
                   {u"2"_s, u"1"_s, u"Heading B"_s},
                   {u"3"_s, u"2"_s, u"Item"_s},
                   {u"4"_s, u"1"_s, u"Last heading"_s}});
    GridOperations::formatSetupList(grid, 4);
    QCOMPARE(grid.rowCount(), 3);
    QCOMPARE(grid.cellText(1, 3), u"Heading B"_s);
    QCOMPARE(grid.cell(1, 3).back, HeadingBack);
    QCOMPARE(grid.cell(2, 4).back, EditableBack);
    QCOMPARE(grid.cellText(3, 3), u"Last heading"_s);
    QCOMPARE(grid.cell(3, 3).back, HeadingBack);
}

void TestGridOperations::fitColumn_data()
{
    QTest::addColumn<int>("gridWidth");
    QTest::addColumn<bool>("border");
    QTest::addColumn<int>("width");
    QTest::newRow("room left") << 500 << false << 500 - 150 - 16;
    QTest::newRow("with a border") << 500 << true << 500 - 150 - 16 - 4;
    QTest::newRow("others wider than the grid") << 100 << false << 16;
}

void TestGridOperations::fitColumn()
{
    QFETCH(int, gridWidth);
    QFETCH(bool, border);
    QFETCH(int, width);
    GridModel grid;
    grid.addColumn(u"a"_s, QString(), 0, 100, true);
    grid.addColumn(u"hidden"_s, QString(), 0, 999, false);
    grid.addColumn(u"b"_s, QString(), 0, 50, true);
    grid.addColumn(u"fit"_s, QString(), 0, 10, true);
    QCOMPARE(GridOperations::fitColumn(grid, 4, gridWidth, 16, border), width);
    QCOMPARE(grid.column(4).width, width);
}

void TestGridOperations::rowsAreFoundByIdOrText()
{
    GridModel grid;
    grid.addColumn(u"id"_s, QString(), 0, 10, true);
    grid.addColumn(u"name"_s, QString(), 0, 10, true);
    GridOperations::selectRowById(grid, 1); // no rows: nothing happens
    QCOMPARE(grid.selectedRow(), 0);
    QCOMPARE(findGridRow(grid, 2, u"x"_s), 0);
    addRows(grid, {{u"3"_s, u"Anna"_s}, {u"7"_s, u"BOB"_s}, {u"9"_s, u"bob"_s}});
    GridOperations::selectRowById(grid, 7);
    QCOMPARE(grid.selectedRow(), 2);
    // An ID not listed, or none, selects the first row.
    for (const qint64 id : {qint64(99), qint64(0)}) {
        grid.setSelectedRow(3);
        GridOperations::selectRowById(grid, id);
        QCOMPARE(grid.selectedRow(), 1);
    }
    QCOMPARE(findGridRow(grid, 2, u"bob"_s), 2); // the first, whatever its case
    QCOMPARE(findGridRow(grid, 2, u"carl"_s), 0);
}

void TestGridOperations::cellStylesAndRedraw()
{
    GridModel grid;
    grid.setFont({u"Arial"_s, 10.0, false});
    grid.addColumn(u"a"_s, QString(), 0, 10, true);
    grid.addRow();
    setCellStyle(grid, 1, 1, QColor(Qt::red), false);
    setCellStyle(grid, 1, 1, std::nullopt, true);
    QCOMPARE(grid.cell(1, 1).back, QColor(Qt::red));
    QVERIFY(grid.cell(1, 1).font->bold);
    QCOMPARE(grid.cell(1, 1).font->pointSize, 10.0);
    setHeadingStyle(grid, 1, 1);
    QCOMPARE(grid.cell(1, 1).font->pointSize, 11.0);
    QCOMPARE(grid.cell(1, 1).fore, QColor(Qt::white));
    grid.setCellText(1, 1, u"12.5"_s);
    const NumberFormat numbers(QLocale(QLocale::English, QLocale::Australia));
    QCOMPARE(getCellNumber(grid, 1, 1, numbers), 12.5);
    grid.setCellText(1, 1, u"n/a"_s);
    QCOMPARE(getCellNumber(grid, 1, 1, numbers), 0.0);

    // Changes made while redrawing is off are announced once, when it is back on.
    QSignalSpy changes(&grid, &GridModel::contentChanged);
    grid.setRedraw(false);
    for (int i = 0; i < 5; ++i)
        grid.setCellText(grid.addRow(), 1, QString::number(i));
    QCOMPARE(changes.count(), 0);
    grid.setRedraw(true);
    QCOMPARE(changes.count(), 1);
}

QTEST_GUILESS_MAIN(TestGridOperations)
#include "tst_gridoperations.moc"
