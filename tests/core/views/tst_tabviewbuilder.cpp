// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/contextwiring.h"
#include "engine/usualsign.h"
#include "grid/gridoperations.h"
#include "views/kpigrid.h"
#include "views/tabviewbuilder.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestTabViewBuilder : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();
    void rowTypes_data();
    void rowTypes();
    void headingsAreStyledAndBarsSigned();
    void everyFigureHasAUsualSign();
    void usersSeeTheirLines();
    void missingRecordIsReported();
    void averages_data();
    void averages();

private:
    AppContext &context() { return m_workspace->context(); }
    int rowOf(const GridModel &grid, qint64 id) const
    {
        return GridOperations::findGridRow(grid, 1, QString::number(id));
    }
    void build(GridModel &grid, int tab)
    {
        TabViewBuilder::addMainColumns(grid);
        ContextWiring::tabViewBuilder(context(), grid).buildTabView(tab, 0);
    }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestTabViewBuilder::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    QVERIFY(m_workspace->connect());
    context().setNumberFormat(NumberFormat(QLocale(QLocale::English, QLocale::Australia)));
    context().loginState() = LoginState{true, u"sysop"_s, 1, QString()};
    PeriodDataSet &data = context().periodDataSet();
    data.storeAccountFigure(13, -12000.4, 2); // panel labour sales: income
    data.storeAccountFigure(14, 5000.25, 2);  // panel wages: expense
    data.storeFieldValue(16, 0.583, 1);       // 58.3 %, benchmark >45,<35
    data.storeFieldValue(19, 0.31, 1);        // 31 %, benchmark >40,<30: yellow
    data.storeFieldValue(3, 0.25, 1);         // 25 %: red
    data.storeFieldValue(62, -3.0, 4);        // hours below zero
    data.storeFieldValue(15, -1234.5, 0);     // money below zero
    data.storeFieldValue(18, 0.0, 0);         // zero money
    data.storeAccountFigure(17, -300.0, 2);   // consumables account in credit
    data.storeAccountFigure(22, 0.0, 2);      // paint wages: nothing posted
    data.storeFieldValue(28, -0.05, 1);       // negative margin, benchmark >30,<20
    m_workspace->prompter().clearMessages();
}

void TestTabViewBuilder::cleanup()
{
    m_workspace.reset();
}

void TestTabViewBuilder::rowTypes_data()
{
    QTest::addColumn<qint64>("id");
    QTest::addColumn<QString>("value");
    QTest::addColumn<QColor>("back");
    QTest::addColumn<QColor>("fore");
    QTest::addColumn<bool>("bold");
    QTest::addColumn<int>("alignment");
    QTest::addColumn<QString>("benchmark");
    QTest::addColumn<QString>("variant");
    QTest::addColumn<QColor>("variantBack");

    const QColor none;
    QTest::newRow("income account") << qint64(13) << u"$ 12,000.40"_s << KpiGrid::AccountAbove
                                    << none << false << 0 << QString() << QString() << none;
    QTest::newRow("expense account") << qint64(14) << u"$ 5,000.25"_s << KpiGrid::AccountBelow
                                     << none << false << 0 << QString() << QString() << none;
    QTest::newRow("percentage met") << qint64(16) << u"58.3%"_s << KpiGrid::Percentage << none
                                    << true << 1 << u">45%"_s << u"13.3%"_s << KpiGrid::Green;
    QTest::newRow("percentage short") << qint64(19) << u"31%"_s << KpiGrid::Percentage << none
                                      << true << 1 << u">40%"_s << u"-9%"_s << KpiGrid::Yellow;
    QTest::newRow("percentage without data") << qint64(24) << QString() << KpiGrid::Percentage
                                             << none << true << 1 << u">45%"_s << QString() << none;
    QTest::newRow("hours below zero")
        << qint64(62) << u"-3"_s << KpiGrid::Poor << KpiGrid::NegativeText << true << 0 << QString()
        << QString() << none;
    QTest::newRow("profit below zero")
        << qint64(15) << u"$ -1,234.50"_s << KpiGrid::Poor << KpiGrid::NegativeText << true << 0
        << QString() << QString() << none;
    QTest::newRow("cost account in credit") << qint64(17) << u"$ -300.00"_s << KpiGrid::Poor << none
                                            << false << 0 << QString() << QString() << none;
    QTest::newRow("account with nothing posted")
        << qint64(22) << QString() << none << none << false << 0 << QString() << QString() << none;
    QTest::newRow("negative margin") << qint64(28) << u"-5%"_s << KpiGrid::Poor << none << true << 1
                                     << u">30%"_s << u"-35%"_s << KpiGrid::Red;
    QTest::newRow("money of zero")
        << qint64(18) << QString() << none << none << false << 0 << QString() << QString() << none;
}

void TestTabViewBuilder::rowTypes()
{
    QFETCH(qint64, id);
    QFETCH(QString, value);
    QFETCH(QColor, back);
    QFETCH(QColor, fore);
    QFETCH(bool, bold);
    QFETCH(int, alignment);
    QFETCH(QString, benchmark);
    QFETCH(QString, variant);
    QFETCH(QColor, variantBack);

    GridModel grid;
    build(grid, 2);
    const int row = rowOf(grid, id);
    QVERIFY(row > 0);
    QVERIFY(grid.isRowVisible(row));
    const GridModel::Cell &cell = grid.cell(row, grid.columnIndex(u"value"_s));
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"value"_s)), value);
    QCOMPARE(cell.back.value_or(QColor()), back);
    QCOMPARE(cell.fore.value_or(QColor()), fore);
    QCOMPARE(cell.font.has_value() && cell.font->bold, bold);
    QCOMPARE(cell.alignment, alignment);
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"benchmark"_s)), benchmark);
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"variant"_s)), variant);
    QCOMPARE(grid.cell(row, grid.columnIndex(u"variant"_s)).back.value_or(QColor()), variantBack);
    QVERIFY(m_workspace->prompter().messages().isEmpty());
}

void TestTabViewBuilder::headingsAreStyledAndBarsSigned()
{
    GridModel grid;
    build(grid, 2);
    const int rowColumn = grid.columnIndex(u"row"_s);
    const int labelColumn = grid.columnIndex(u"label"_s);
    QCOMPARE(grid.cellText(1, labelColumn), u"PANEL LABOUR"_s);
    QCOMPARE(grid.cell(1, labelColumn).back, GridOperations::HeadingBack);
    QCOMPARE(grid.cellText(1, rowColumn), QString());
    QCOMPARE(grid.cellText(2, rowColumn), u"1"_s);
    QCOMPARE(grid.cellText(2, labelColumn), u"Panel labour sales"_s);
    // The next heading does not count; the lines under it go on from where they were.
    const int paintHeading = rowOf(grid, 20);
    QCOMPARE(grid.cellText(paintHeading + 1, rowColumn),
             QString::number(grid.cellText(paintHeading - 1, rowColumn).toInt() + 1));
    QCOMPARE(grid.cell(2, rowColumn).back, QColor(0xC0, 0xC0, 0xC0));
    QCOMPARE(grid.cell(2, labelColumn).back, QColor(0xF0, 0xF0, 0xF0));

    // The bars are judged on the signed figures.
    QMap<qint64, double> values;
    for (const auto &bar : ContextWiring::tabViewBuilder(context(), grid).graphBars(grid))
        values.insert(bar.fieldId, bar.value);
    QCOMPARE(values.value(16), 58.3);
    QCOMPARE(values.value(28), -5.0);
}

void TestTabViewBuilder::usersSeeTheirLines()
{
    // Two groups, one ID twice: the lines listed show, with every heading.
    context().loginState() = LoginState{true, u"bob"_s, 0, u"13,16#16"_s};
    GridModel grid;
    build(grid, 2);
    QList<qint64> shown;
    for (int row = 1; row <= grid.rowCount(); ++row) {
        if (grid.isRowVisible(row))
            shown << grid.cellText(row, 1).toLongLong();
    }
    std::sort(shown.begin(), shown.end());
    QCOMPARE(shown, (QList<qint64>{12, 13, 16, 20, 29}));
    // With nothing produced every row shows.
    context().periodDataSet().clearCurrent();
    GridModel empty;
    build(empty, 2);
    for (int row = 1; row <= empty.rowCount(); ++row)
        QVERIFY(empty.isRowVisible(row));
}

void TestTabViewBuilder::everyFigureHasAUsualSign()
{
    RecordSet &fields = context().mainDatabase().fieldsRecordset();
    QVERIFY(!fields.moveFirst());
    for (; !fields.eof(); fields.moveNext()) {
        const qint64 id = fields.value(u"ID"_s).toLongLong();
        const bool heading = fields.value(u"Type"_s).toInt() == 1;
        QVERIFY2(heading || UsualSign::of(id) != UsualSign::Unknown,
                 qPrintable(QString::number(id)));
    }
}

void TestTabViewBuilder::missingRecordIsReported()
{
    GridModel grid;
    TabViewBuilder::addMainColumns(grid);
    const int row = grid.addRow();
    grid.setCellText(row, 1, u"9999"_s);
    grid.setCellText(row, 2, u"3"_s);
    grid.setCellText(row, 3, u">10"_s);
    context().periodDataSet().storeFieldValue(9999, 0.5, 1);
    KpiGrid(grid, context().periodDataSet(), context().mainDatabase(), m_workspace->prompter(),
            context().numberFormat())
        .fillValueColumn(u"value"_s, true);
    const QList<RecordingPrompter::Message> &messages = m_workspace->prompter().messages();
    QCOMPARE(messages.size(), 1);
    QCOMPARE(messages.first().text, u"Could not find record with ID 9999"_s);
    QCOMPARE(messages.first().title, u"Benchmark Error"_s);
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"variant"_s)), QString());
    QCOMPARE(grid.cellText(row, grid.columnIndex(u"value"_s)), u"50%"_s);
}

void TestTabViewBuilder::averages_data()
{
    QTest::addColumn<qint64>("id");
    QTest::addColumn<QString>("benchmark");
    QTest::addColumn<QList<double>>("values"); // slots 0 to 2
    QTest::addColumn<int>("type");
    QTest::addColumn<int>("highlighted"); // slot, or -1
    QTest::addColumn<QString>("average");
    QTest::addColumn<QColor>("averageBack");
    const QColor grey = KpiGrid::AverageBack;
    QTest::newRow("highest in slot 1")
        << qint64(500) << QString() << QList<double>{0, 5, 5} << 4 << 1 << u"5"_s << grey;
    QTest::newRow("all zero") << qint64(500) << QString() << QList<double>{0, 0, 0} << 4 << -1
                              << QString() << grey;
    QTest::newRow("money") << qint64(500) << QString() << QList<double>{100, 300, 200} << 5 << 1
                           << u"$ 200.00"_s << grey;
    QTest::newRow("percentage") << qint64(500) << QString() << QList<double>{0.1, 0.2, 0.3} << 3
                                << 2 << u"20.0%"_s << grey;
    QTest::newRow("tie keeps the earliest")
        << qint64(500) << QString() << QList<double>{7, 7, 1} << 4 << 0 << u"5"_s << grey;
    QTest::newRow("a loss month lowers the average profit")
        << qint64(110) << QString() << QList<double>{-22480.57, 10690.10, 0} << 5 << 1
        << u"$ -5,895.24"_s << KpiGrid::Poor;
    QTest::newRow("the smaller cost is the better")
        << qint64(89) << QString() << QList<double>{-300, -100, -200} << 5 << 1 << u"$ 200.00"_s
        << grey;
    QTest::newRow("an at-most share is better lower")
        << qint64(109) << u"<20,>26"_s << QList<double>{0.25, 0.18, 0.3} << 3 << 1 << u"24.3%"_s
        << grey;
    QTest::newRow("an at-least margin is better higher")
        << qint64(111) << u">8,<4"_s << QList<double>{-0.16, 0.02, 0} << 3 << 1 << u"-7.0%"_s
        << KpiGrid::Poor;
}

void TestTabViewBuilder::averages()
{
    QFETCH(qint64, id);
    QFETCH(QString, benchmark);
    QFETCH(QList<double>, values);
    QFETCH(int, type);
    QFETCH(int, highlighted);
    QFETCH(QString, average);
    QFETCH(QColor, averageBack);
    PeriodDataSet &data = context().periodDataSet();
    GridModel grid;
    for (const QString &key :
         {u"id"_s, u"type"_s, u"data"_s, u"value"_s, u"value1"_s, u"value2"_s, u"average"_s})
        grid.addColumn(key, key, 0, 50, true);
    const int row = grid.addRow();
    grid.setCellText(row, 1, QString::number(id));
    grid.setCellText(row, 2, QString::number(type));
    grid.setCellText(row, 3, benchmark);
    for (int slot = 0; slot < 3; ++slot) {
        data.setCurrentSlot(quint8(slot));
        data.clearCurrent();
        data.storeFieldValue(id, values[slot], type == 3 ? 1 : 0);
    }
    KpiGrid(grid, data, context().mainDatabase(), m_workspace->prompter(), context().numberFormat())
        .computeAverages(2);
    for (int slot = 0; slot < 3; ++slot) {
        const int column = slot + 4;
        QCOMPARE(grid.cell(row, column).back.value_or(QColor()),
                 slot == highlighted ? KpiGrid::Highest : QColor());
    }
    QCOMPARE(grid.cell(row, 7).back, averageBack);
    QCOMPARE(grid.cellText(row, 7), average);
    QCOMPARE(data.currentSlot(), quint8(2));
}

QTEST_GUILESS_MAIN(TestTabViewBuilder)
#include "tst_tabviewbuilder.moc"
