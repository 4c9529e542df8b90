// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/mainconnector.h"
#include "app/settingsloader.h"
#include "setup/celleditor.h"
#include "setup/hourlyratesdialog.h"
#include "setup/programsetupdialog.h"
#include "views/gridview.h"

#include <QPushButton>
#include <QSqlQuery>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

// A second copy of the program working on the same database.
class OtherCopy
{
public:
    explicit OtherCopy(const QString &file)
        : m_name(u"other-copy-%1"_s.arg(quintptr(this)))
    {
        QSqlDatabase database = QSqlDatabase::addDatabase(u"QSQLITE"_s, m_name);
        database.setDatabaseName(file);
        database.open();
    }
    ~OtherCopy() { QSqlDatabase::removeDatabase(m_name); }

    bool exec(const QString &sql, const QVariantList &values = {})
    {
        QSqlQuery query(QSqlDatabase::database(m_name));
        query.prepare(sql);
        for (const QVariant &value : values)
            query.addBindValue(value);
        return query.exec();
    }
    QVariant value(const QString &sql, const QVariantList &values = {})
    {
        QSqlQuery query(QSqlDatabase::database(m_name));
        query.prepare(sql);
        for (const QVariant &value : values)
            query.addBindValue(value);
        return query.exec() && query.next() ? query.value(0) : QVariant();
    }

private:
    QString m_name;
};

// Clicks a cell as the user would, which asks the grid to edit its row.
void clickCell(GridView *view, int row, int column)
{
    const QRect cell = view->cellRect(row, column);
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, cell.center());
}

void typeInto(CellEditor *editor, const QString &text, Qt::Key end)
{
    QVERIFY(editor->isOpen());
    editor->clear();
    QTest::keyClicks(editor, text);
    QTest::keyClick(editor, end);
}

int rowOf(const GridModel &grid, int idColumn, const QString &id)
{
    for (int row = 1; row <= grid.rowCount(); ++row) {
        if (grid.cellText(row, idColumn) == id)
            return row;
    }
    return 0;
}

} // namespace

class TestSetupDialogs : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();
    void rateEdits_data();
    void rateEdits();
    void escapeKeepsTheRate();
    void typedKeyOpensTheBoxAndArrowsMove();
    void cancelWritesNothing();
    void rateOfADeletedDepartmentIsSkipped();
    void anotherCopysChangeIsReportedNotLost();
    void emptySectionsAreNotListed();
    void codesAreTrimmedAndSaved();
    void headingsAreNotEdited();
    void escapeThenOkKeepsTheValue();
    void hiddenFieldIsListedButNotSaved();
    void anotherCopyMeanwhile_data();
    void anotherCopyMeanwhile();

private:
    // Starts up on the workspace; the note about a new database file is not what is tested.
    bool connect()
    {
        const bool connected = loadSettings(m_workspace->context()).isEmpty() &&
                               connectMainDatabase(m_workspace->context()).isEmpty();
        m_workspace->prompter().clearMessages();
        return connected;
    }
    QVariant stored(const QString &sql, const QVariantList &values = {})
    {
        return OtherCopy(m_workspace->mainDatabase()).value(sql, values);
    }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestSetupDialogs::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    m_workspace->context().setNumberFormat(
        NumberFormat(QLocale(QLocale::English, QLocale::Australia)));
}

void TestSetupDialogs::cleanup()
{
    disconnectMainDatabase(m_workspace->context());
    m_workspace.reset();
}

void TestSetupDialogs::rateEdits_data()
{
    QTest::addColumn<QString>("typed");
    QTest::addColumn<QString>("shown");
    QTest::addColumn<double>("saved");
    QTest::addColumn<QString>("message"); // its title
    QTest::newRow("decimal") << u"1234.5"_s << u"1,234.50"_s << 1234.5 << QString();
    QTest::newRow("grouped") << u"1,100"_s << u"1,100.00"_s << 1100.0 << QString();
    QTest::newRow("zero") << u"0"_s << u"0.00"_s << 0.0 << QString();
    QTest::newRow("letters keep the rate") << u"abc"_s << u"65.00"_s << 65.0 << u"Invalid Rate"_s;
    QTest::newRow("empty clears it") << QString() << u"0.00"_s << 0.0 << QString();
}

void TestSetupDialogs::rateEdits()
{
    QFETCH(QString, typed);
    QFETCH(QString, shown);
    QFETCH(double, saved);
    QFETCH(QString, message);
    QVERIFY(connect());
    OtherCopy(m_workspace->mainDatabase()).exec(u"UPDATE Hours SET Value = 65 WHERE ID = 1"_s);
    HourlyRatesDialog dialog(m_workspace->context());
    dialog.show();
    GridModel &grid = dialog.rates().grid();
    QCOMPARE(grid.rowCount(), 2);
    QCOMPARE(grid.cellText(1, 2), u"Panel"_s);
    QCOMPARE(grid.cell(1, 3).back, QColor(0xD3, 0xED, 0xF7));

    clickCell(dialog.lstRates(), 1, 2); // the department: the rate is edited all the same
    QVERIFY(dialog.txtEdit()->isOpen());
    QCOMPARE(dialog.txtEdit()->text(), u"65.00"_s);
    typeInto(dialog.txtEdit(), typed, Qt::Key_Return);
    QVERIFY(!dialog.txtEdit()->isVisible());
    QCOMPARE(grid.cellText(1, 3), shown);

    dialog.butOK()->click();
    QVERIFY(!dialog.isVisible());
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 1"_s).toDouble(), saved);
    QCOMPARE(m_workspace->prompter().messages().value(0).title, message);
}

void TestSetupDialogs::escapeKeepsTheRate()
{
    QVERIFY(connect());
    // A rate nobody edits is kept exactly, though the list shows it rounded.
    OtherCopy(m_workspace->mainDatabase()).exec(u"UPDATE Hours SET Value = 65.125 WHERE ID = 1"_s);
    HourlyRatesDialog dialog(m_workspace->context());
    dialog.show();
    clickCell(dialog.lstRates(), 2, 3);
    typeInto(dialog.txtEdit(), u"99"_s, Qt::Key_Escape);
    QVERIFY(!dialog.txtEdit()->isOpen());
    QCOMPARE(dialog.rates().grid().cellText(2, 3), u"0.00"_s);
    dialog.butOK()->click();
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 2"_s).toDouble(), 0.0);
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 1"_s).toDouble(), 65.125);
}

void TestSetupDialogs::typedKeyOpensTheBoxAndArrowsMove()
{
    QVERIFY(connect());
    HourlyRatesDialog dialog(m_workspace->context());
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    GridModel &grid = dialog.rates().grid();
    grid.setSelectedRow(2);
    dialog.lstRates()->setFocus();
    QTest::keyClick(dialog.lstRates(), Qt::Key_7);
    QVERIFY(dialog.txtEdit()->isOpen());
    QCOMPARE(dialog.txtEdit()->text(), u"7"_s);
    QTest::keyClicks(dialog.txtEdit(), u"2.5"_s);
    QTest::keyClick(dialog.txtEdit(), Qt::Key_Up);
    QCOMPARE(grid.cellText(2, 3), u"72.50"_s);
    QCOMPARE(grid.selectedRow(), 1); // the arrow went on to the list

    // Leaving the box stores what it holds.
    clickCell(dialog.lstRates(), 1, 3);
    QTest::keyClicks(dialog.txtEdit(), u"55"_s);
    dialog.txtEdit()->commit();
    QCOMPARE(grid.cellText(1, 3), u"55.00"_s);
}

void TestSetupDialogs::cancelWritesNothing()
{
    QVERIFY(connect());
    {
        HourlyRatesDialog dialog(m_workspace->context());
        dialog.show();
        clickCell(dialog.lstRates(), 1, 3);
        typeInto(dialog.txtEdit(), u"80"_s, Qt::Key_Return);
        dialog.butCancel()->click();
    }
    {
        ProgramSetupDialog dialog(m_workspace->context());
        dialog.show();
        const int row = rowOf(dialog.setup().grid(ProgramSetup::Mapping), 1, u"13"_s);
        clickCell(dialog.lstA(), row, 4);
        typeInto(dialog.txtEdit(), u"9-9999"_s, Qt::Key_Return);
        dialog.butCancel()->click();
    }
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 1"_s).toDouble(), 0.0);
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 13"_s).toString(), u"4-1100"_s);
}

void TestSetupDialogs::rateOfADeletedDepartmentIsSkipped()
{
    QVERIFY(connect());
    HourlyRatesDialog dialog(m_workspace->context());
    dialog.show();
    clickCell(dialog.lstRates(), 1, 3);
    typeInto(dialog.txtEdit(), u"70"_s, Qt::Key_Down);
    QVERIFY(dialog.txtEdit()->isOpen() == false);
    clickCell(dialog.lstRates(), 2, 3);
    typeInto(dialog.txtEdit(), u"75"_s, Qt::Key_Return);
    QVERIFY(OtherCopy(m_workspace->mainDatabase()).exec(u"DELETE FROM Hours WHERE ID = 2"_s));

    dialog.butOK()->click();
    QVERIFY(!dialog.isVisible());
    QVERIFY(m_workspace->prompter().messages().isEmpty());
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 1"_s).toDouble(), 70.0);
    QCOMPARE(stored(u"SELECT COUNT(*) FROM Hours"_s).toInt(), 1);
}

void TestSetupDialogs::anotherCopysChangeIsReportedNotLost()
{
    QVERIFY(connect());
    HourlyRatesDialog dialog(m_workspace->context());
    dialog.show();
    clickCell(dialog.lstRates(), 1, 3);
    typeInto(dialog.txtEdit(), u"70"_s, Qt::Key_Return);
    clickCell(dialog.lstRates(), 2, 3);
    typeInto(dialog.txtEdit(), u"75"_s, Qt::Key_Return);
    // Meanwhile someone else sets the paint rate.
    QVERIFY(
        OtherCopy(m_workspace->mainDatabase()).exec(u"UPDATE Hours SET Value = 88 WHERE ID = 2"_s));

    dialog.butOK()->click();
    QVERIFY(dialog.isVisible()); // the window stays open
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    QVERIFY(m_workspace->prompter().messages().first().title.contains(u"Save Labour Hours"_s));
    // The row before the conflict stays saved; the other copy's rate is not overwritten.
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 1"_s).toDouble(), 70.0);
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 2"_s).toDouble(), 88.0);
}

void TestSetupDialogs::emptySectionsAreNotListed()
{
    QVERIFY(connect());
    ProgramSetupDialog dialog(m_workspace->context());
    dialog.show();
    QCOMPARE(dialog.windowTitle(), u"Program Setup"_s);
    for (const ProgramSetup::List list : {ProgramSetup::Mapping, ProgramSetup::Benchmarks}) {
        const GridModel &grid = dialog.setup().grid(list);
        QVERIFY(grid.rowCount() > 10);
        for (int row = 2; row <= grid.rowCount(); ++row) {
            QVERIFY2(
                !(dialog.setup().isHeading(list, row - 1) && dialog.setup().isHeading(list, row)),
                qPrintable(grid.cellText(row, 3)));
        }
        for (int row = 1; row <= grid.rowCount(); ++row) {
            if (!dialog.setup().isHeading(list, row))
                QCOMPARE(grid.cell(row, 4).back, QColor(0xD3, 0xED, 0xF7));
        }
    }
    // "Key performance indicators" and "Activity" have no account fields: the mapping list
    // starts with the first section that has.
    const GridModel &mapping = dialog.setup().grid(ProgramSetup::Mapping);
    QCOMPARE(mapping.cellText(1, 1), u"12"_s);
    QCOMPARE(mapping.cellText(2, 1), u"13"_s);
    QCOMPARE(dialog.setup().grid(ProgramSetup::Benchmarks).cellText(1, 1), u"9"_s);
}

void TestSetupDialogs::codesAreTrimmedAndSaved()
{
    QVERIFY(connect());
    ProgramSetupDialog dialog(m_workspace->context());
    dialog.show();
    const int mapping = rowOf(dialog.setup().grid(ProgramSetup::Mapping), 1, u"88"_s);
    const int benchmark = rowOf(dialog.setup().grid(ProgramSetup::Benchmarks), 1, u"1"_s);
    clickCell(dialog.lstA(), mapping, 3);
    typeInto(dialog.txtEdit(), u"  5-3200 + 5-3300+5-3400  "_s, Qt::Key_Return);
    clickCell(dialog.lstB(), benchmark, 4);
    typeInto(dialog.txtEdit(), u" >50,<40 "_s, Qt::Key_Return);
    QCOMPARE(dialog.setup().grid(ProgramSetup::Mapping).cellText(mapping, 4),
             u"5-3200 + 5-3300+5-3400"_s);
    dialog.butOK()->click();
    QVERIFY(!dialog.isVisible());
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 88"_s).toString(),
             u"5-3200 + 5-3300+5-3400"_s);
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 1"_s).toString(), u">50,<40"_s);
    // Every view reads the new values.
    RecordSet &fields = m_workspace->context().mainDatabase().fieldsRecordset();
    QVERIFY(!fields.moveFirst() && !fields.findId(1));
    QCOMPARE(fields.value(u"Data"_s).toString(), u">50,<40"_s);
}

void TestSetupDialogs::headingsAreNotEdited()
{
    QVERIFY(connect());
    ProgramSetupDialog dialog(m_workspace->context());
    dialog.show();
    clickCell(dialog.lstA(), 1, 4);
    QVERIFY(!dialog.txtEdit()->isOpen());
    dialog.setup().commitEdit(ProgramSetup::Mapping, 1, u"x"_s);
    QCOMPARE(dialog.setup().grid(ProgramSetup::Mapping).cellText(1, 4), QString());
}

void TestSetupDialogs::escapeThenOkKeepsTheValue()
{
    QVERIFY(connect());
    ProgramSetupDialog dialog(m_workspace->context());
    dialog.show();
    const int row = rowOf(dialog.setup().grid(ProgramSetup::Mapping), 1, u"13"_s);
    clickCell(dialog.lstA(), row, 4);
    QCOMPARE(dialog.txtEdit()->text(), u"4-1100"_s);
    typeInto(dialog.txtEdit(), u"4-9999"_s, Qt::Key_Escape);
    QCOMPARE(dialog.setup().grid(ProgramSetup::Mapping).cellText(row, 4), u"4-1100"_s);
    dialog.butOK()->click();
    QVERIFY(!dialog.isVisible());
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 13"_s).toString(), u"4-1100"_s);
}

void TestSetupDialogs::hiddenFieldIsListedButNotSaved()
{
    // Hide the Field before the program reads its Fields.
    QVERIFY(QFile::copy(QStringLiteral(VELTRIX_NEW_DB), m_workspace->mainDatabase()));
    QVERIFY(
        OtherCopy(m_workspace->mainDatabase()).exec(u"UPDATE Fields SET Hide = 1 WHERE ID = 14"_s));
    QVERIFY(connect());
    ProgramSetupDialog dialog(m_workspace->context());
    dialog.show();
    const int row = rowOf(dialog.setup().grid(ProgramSetup::Mapping), 1, u"14"_s);
    QVERIFY(row > 0);
    clickCell(dialog.lstA(), row, 4);
    typeInto(dialog.txtEdit(), u"5-1111"_s, Qt::Key_Return);
    QCOMPARE(dialog.setup().grid(ProgramSetup::Mapping).cellText(row, 4), u"5-1111"_s);
    dialog.butOK()->click();
    QVERIFY(!dialog.isVisible());
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 14"_s).toString(), u"5-1100"_s);
}

void TestSetupDialogs::anotherCopyMeanwhile_data()
{
    QTest::addColumn<QString>("otherCopy");
    QTest::addColumn<bool>("reported");
    QTest::addColumn<QString>("first");  // Field 13 afterwards; empty when deleted
    QTest::addColumn<QString>("second"); // Field 14 afterwards
    // A row another copy deleted is passed over; one it changed stops the save, reported,
    // with the rows before it saved and the other copy's value kept.
    QTest::newRow("deleted") << u"DELETE FROM Fields WHERE ID = 13"_s << false << QString()
                             << u"5-1101"_s;
    QTest::newRow("changed") << u"UPDATE Fields SET Data = '5-1199' WHERE ID = 14"_s << true
                             << u"4-1101"_s << u"5-1199"_s;
}

void TestSetupDialogs::anotherCopyMeanwhile()
{
    QFETCH(QString, otherCopy);
    QFETCH(bool, reported);
    QFETCH(QString, first);
    QFETCH(QString, second);
    QVERIFY(connect());
    ProgramSetupDialog dialog(m_workspace->context());
    dialog.show();
    const GridModel &grid = dialog.setup().grid(ProgramSetup::Mapping);
    clickCell(dialog.lstA(), rowOf(grid, 1, u"13"_s), 4);
    typeInto(dialog.txtEdit(), u"4-1101"_s, Qt::Key_Return);
    clickCell(dialog.lstA(), rowOf(grid, 1, u"14"_s), 4);
    typeInto(dialog.txtEdit(), u"5-1101"_s, Qt::Key_Return);
    QVERIFY(OtherCopy(m_workspace->mainDatabase()).exec(otherCopy));

    dialog.butOK()->click();
    QCOMPARE(dialog.isVisible(), reported);
    const auto &messages = m_workspace->prompter().messages();
    QCOMPARE(messages.size(), reported ? 1 : 0);
    if (reported)
        QVERIFY(messages.first().title.contains(u"Save Program Setup"_s));
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 13"_s).toString(), first);
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 14"_s).toString(), second);
}

QTEST_MAIN(TestSetupDialogs)
#include "tst_setupdialogs.moc"
