// Veltrix — KPI dashboard for small businesses.
#include "../setupedit.h"
#include "testworkspace.h"

#include "grid/gridoperations.h"
#include "setup/hourlyratesdialog.h"
#include "setup/programsetupdialog.h"

#include <QPushButton>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

// Clicks a cell as the user would, which asks the grid to edit its row.
void clickCell(GridView *view, int row, int column)
{
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, view->cellRect(row, column).center());
}

int rowOf(const GridModel &grid, const QString &id)
{
    return GridOperations::findGridRow(grid, 1, id);
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
    void unsavedEditsWriteNothing();
    void programSetupListsAndSavesCodes();
    void anotherCopyMeanwhile_data();
    void anotherCopyMeanwhile();

private:
    bool connect() { return m_workspace->connect(); }
    QVariant stored(const QString &sql) { return m_workspace->value(sql); }

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
    m_workspace->exec(u"UPDATE Hours SET Value = 65 WHERE ID = 1"_s);
    HourlyRatesDialog dialog(m_workspace->context());
    dialog.show();
    GridModel &grid = dialog.rates().grid();
    QCOMPARE(grid.rowCount(), 2);
    QCOMPARE(grid.cellText(1, 2), u"Panel"_s);
    QCOMPARE(grid.cell(1, 3).back, QColor(0xD3, 0xED, 0xF7));

    clickCell(dialog.lstRates(), 1, 2); // the department: the rate is edited all the same
    QVERIFY(dialog.txtEdit()->isOpen());
    QCOMPARE(dialog.txtEdit()->text(), u"65.00"_s);
    dialog.txtEdit()->clear();
    QTest::keyClicks(dialog.txtEdit(), typed);
    QTest::keyClick(dialog.txtEdit(), Qt::Key_Return);
    QVERIFY(!dialog.txtEdit()->isVisible());
    QCOMPARE(grid.cellText(1, 3), shown);

    dialog.butOK()->click();
    QVERIFY(!dialog.isVisible());
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 1"_s).toDouble(), saved);
    QCOMPARE(m_workspace->prompter().messages().value(0).title, message);
}

void TestSetupDialogs::unsavedEditsWriteNothing()
{
    QVERIFY(connect());
    // A rate nobody edits is kept exactly, though the list shows it rounded.
    m_workspace->exec(u"UPDATE Hours SET Value = 65.125 WHERE ID = 1"_s);
    {
        HourlyRatesDialog dialog(m_workspace->context());
        dialog.show();
        editCell(dialog.lstRates(), dialog.txtEdit(), 2, 3, u"99"_s, Qt::Key_Escape);
        QVERIFY(!dialog.txtEdit()->isOpen());
        QCOMPARE(dialog.rates().grid().cellText(2, 3), u"0.00"_s);
        dialog.butOK()->click();
    }
    {
        HourlyRatesDialog dialog(m_workspace->context());
        dialog.show();
        QVERIFY(QTest::qWaitForWindowExposed(&dialog));
        // A key typed on the list opens the box with it; an arrow closes it and moves on.
        GridModel &grid = dialog.rates().grid();
        grid.setSelectedRow(2);
        dialog.lstRates()->setFocus();
        QTest::keyClick(dialog.lstRates(), Qt::Key_7);
        QVERIFY(dialog.txtEdit()->isOpen());
        QCOMPARE(dialog.txtEdit()->text(), u"7"_s);
        QTest::keyClicks(dialog.txtEdit(), u"2.5"_s);
        QTest::keyClick(dialog.txtEdit(), Qt::Key_Up);
        QCOMPARE(grid.cellText(2, 3), u"72.50"_s);
        QCOMPARE(grid.selectedRow(), 1);
        // Leaving the box stores what it holds.
        clickCell(dialog.lstRates(), 1, 3);
        QTest::keyClicks(dialog.txtEdit(), u"80"_s);
        dialog.txtEdit()->commit();
        QCOMPARE(grid.cellText(1, 3), u"80.00"_s);
        dialog.butCancel()->click();
    }
    {
        ProgramSetupDialog dialog(m_workspace->context());
        dialog.show();
        const int row = rowOf(dialog.setup().grid(ProgramSetup::Mapping), u"13"_s);
        clickCell(dialog.lstA(), row, 4);
        QCOMPARE(dialog.txtEdit()->text(), u"4-1100"_s);
        QTest::keyClicks(dialog.txtEdit(), u"99"_s);
        QTest::keyClick(dialog.txtEdit(), Qt::Key_Escape);
        QCOMPARE(dialog.setup().grid(ProgramSetup::Mapping).cellText(row, 4), u"4-1100"_s);
        editCell(dialog.lstA(), dialog.txtEdit(), row, 4, u"9-9999"_s);
        dialog.butCancel()->click();
    }
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 1"_s).toDouble(), 65.125);
    QCOMPARE(stored(u"SELECT Value FROM Hours WHERE ID = 2"_s).toDouble(), 0.0);
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 13"_s).toString(), u"4-1100"_s);
}

void TestSetupDialogs::programSetupListsAndSavesCodes()
{
    // Field 14 is hidden before the program reads its Fields.
    QVERIFY(QFile::copy(QStringLiteral(VELTRIX_NEW_DB), m_workspace->mainDatabase()));
    QVERIFY(m_workspace->exec(u"UPDATE Fields SET Hide = 1 WHERE ID = 14"_s));
    QVERIFY(connect());
    ProgramSetupDialog dialog(m_workspace->context());
    dialog.show();
    QCOMPARE(dialog.windowTitle(), u"Program Setup"_s);
    // "Key performance indicators" and "Activity" have no account fields: the mapping list
    // starts with the first section that has.
    const GridModel &mapping = dialog.setup().grid(ProgramSetup::Mapping);
    QCOMPARE(mapping.cellText(1, 1), u"12"_s);
    QCOMPARE(mapping.cellText(2, 1), u"13"_s);
    QCOMPARE(mapping.cell(2, 4).back, QColor(0xD3, 0xED, 0xF7));
    QCOMPARE(dialog.setup().grid(ProgramSetup::Benchmarks).cellText(1, 1), u"9"_s);
    // A heading is not edited.
    clickCell(dialog.lstA(), 1, 4);
    QVERIFY(!dialog.txtEdit()->isOpen());
    dialog.setup().commitEdit(ProgramSetup::Mapping, 1, u"x"_s);
    QCOMPARE(mapping.cellText(1, 4), QString());

    // Codes are trimmed; the hidden Field is listed and edited but not saved.
    const int codes = rowOf(mapping, u"88"_s);
    const int hidden = rowOf(mapping, u"14"_s);
    QVERIFY(hidden > 0);
    editCell(dialog.lstA(), dialog.txtEdit(), codes, 3, u"  5-3200 + 5-3300+5-3400  "_s);
    editCell(dialog.lstB(), dialog.txtEdit(),
             rowOf(dialog.setup().grid(ProgramSetup::Benchmarks), u"1"_s), 4, u" >50,<40 "_s);
    editCell(dialog.lstA(), dialog.txtEdit(), hidden, 4, u"5-1111"_s);
    QCOMPARE(mapping.cellText(codes, 4), u"5-3200 + 5-3300+5-3400"_s);
    QCOMPARE(mapping.cellText(hidden, 4), u"5-1111"_s);
    dialog.butOK()->click();
    QVERIFY(!dialog.isVisible());
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 88"_s).toString(),
             u"5-3200 + 5-3300+5-3400"_s);
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 1"_s).toString(), u">50,<40"_s);
    QCOMPARE(stored(u"SELECT Data FROM Fields WHERE ID = 14"_s).toString(), u"5-1100"_s);
    // Every view reads the new values.
    RecordSet &fields = m_workspace->context().mainDatabase().fieldsRecordset();
    QVERIFY(!fields.moveFirst() && !fields.findId(1));
    QCOMPARE(fields.value(u"Data"_s).toString(), u">50,<40"_s);
}

void TestSetupDialogs::anotherCopyMeanwhile_data()
{
    QTest::addColumn<bool>("rates"); // else the account mapping
    QTest::addColumn<QString>("otherCopy");
    QTest::addColumn<QString>("reported"); // title of the one message; empty for none
    QTest::addColumn<QString>("first");    // the first row edited, afterwards; empty when deleted
    QTest::addColumn<QString>("second");
    // A row another copy deleted is passed over; one it changed stops the save, reported,
    // with the rows before it saved and the other copy's value kept.
    QTest::newRow("rate deleted") << true << u"DELETE FROM Hours WHERE ID = 2"_s << QString()
                                  << u"70"_s << QString();
    QTest::newRow("rate changed") << true << u"UPDATE Hours SET Value = 88 WHERE ID = 2"_s
                                  << u"Save Labour Hours"_s << u"70"_s << u"88"_s;
    QTest::newRow("mapping deleted")
        << false << u"DELETE FROM Fields WHERE ID = 13"_s << QString() << QString() << u"5-1101"_s;
    QTest::newRow("mapping changed")
        << false << u"UPDATE Fields SET Data = '5-1199' WHERE ID = 14"_s << u"Save Program Setup"_s
        << u"4-1101"_s << u"5-1199"_s;
}

void TestSetupDialogs::anotherCopyMeanwhile()
{
    QFETCH(bool, rates);
    QFETCH(QString, otherCopy);
    QFETCH(QString, reported);
    QFETCH(QString, first);
    QFETCH(QString, second);
    QVERIFY(connect());
    HourlyRatesDialog ratesDialog(m_workspace->context());
    ProgramSetupDialog setupDialog(m_workspace->context());
    QDialog &dialog = rates ? static_cast<QDialog &>(ratesDialog) : setupDialog;
    dialog.show();
    if (rates) {
        editCell(ratesDialog.lstRates(), ratesDialog.txtEdit(), 1, 3, u"70"_s);
        editCell(ratesDialog.lstRates(), ratesDialog.txtEdit(), 2, 3, u"75"_s);
    } else {
        const GridModel &grid = setupDialog.setup().grid(ProgramSetup::Mapping);
        editCell(setupDialog.lstA(), setupDialog.txtEdit(), rowOf(grid, u"13"_s), 4, u"4-1101"_s);
        editCell(setupDialog.lstA(), setupDialog.txtEdit(), rowOf(grid, u"14"_s), 4, u"5-1101"_s);
    }
    QVERIFY(m_workspace->exec(otherCopy));

    (rates ? ratesDialog.butOK() : setupDialog.butOK())->click();
    QCOMPARE(dialog.isVisible(), !reported.isEmpty());
    const auto &messages = m_workspace->prompter().messages();
    QCOMPARE(messages.size(), reported.isEmpty() ? 0 : 1);
    if (!reported.isEmpty())
        QVERIFY(messages.first().title.contains(reported));
    const QString sql = rates ? u"SELECT Value FROM Hours WHERE ID = %1"_s
                              : u"SELECT Data FROM Fields WHERE ID = %1"_s;
    QCOMPARE(stored(sql.arg(rates ? 1 : 13)).toString(), first);
    QCOMPARE(stored(sql.arg(rates ? 2 : 14)).toString(), second);
}

QTEST_MAIN(TestSetupDialogs)
#include "tst_setupdialogs.moc"
