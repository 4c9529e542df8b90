// Veltrix — KPI dashboard for small businesses.
#include "grid/gridmodel.h"
#include "report/gridhtml.h"

#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

const QString Crlf = u"\r\n"_s;

// id | name | amount, two rows, the second hidden.
void fillSample(GridModel &grid)
{
    grid.addColumn(u"ID"_s, u"Id"_s, GridModel::AlignLeft, 0, true);
    grid.addColumn(u"name"_s, u"Name"_s, GridModel::AlignLeft, 100, true);
    grid.addColumn(u"amount"_s, u"Amount"_s, GridModel::AlignRight, 80, true);
    grid.setFont({u"Arial"_s, 8.25, false});
    for (int i = 0; i < 2; ++i)
        grid.addRow();
    grid.setCellText(1, 1, 7);
    grid.setCellText(1, 2, u"<b>Wages</b>"_s);
    grid.editCell(1, 2).alignment = GridModel::CellCentre;
    grid.editCell(1, 2).back = QColor(0xEE, 0xFF, 0xC0);
    grid.editCell(1, 2).font = GridModel::Font{u"Tahoma"_s, 8.1, true};
    grid.setCellText(1, 3, 1234.5);
    grid.editCell(1, 3).alignment = GridModel::CellRight;
    grid.editCell(1, 3).fore = QColor(0x0A, 0, 0);
    grid.setCellText(2, 2, u"Hidden"_s);
    grid.setRowVisible(2, false);
}

QString headerCell(const QString &align, const QString &text)
{
    return u"<td align='"_s + align +
           u"' style='background-color:#DADADA;color:#000000;font-family:Arial;font-size:11.25;"
           u"font-weight:bold;'>"_s +
           text + u"</td>"_s + Crlf;
}

} // namespace

class TestGridHtml : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void wholeTable();
    void everyColumnExcludedOrHidden();
    void unknownAlignmentRepeatsTheLastWord();
    void pageWithAndWithoutPicture();
};

void TestGridHtml::wholeTable()
{
    GridModel grid;
    fillSample(grid);
    const QString expected =
        u"<table width='100%' cellpadding='4' cellspacing='0'>"_s + Crlf + u"<tr>"_s + Crlf +
        headerCell(u"left"_s, u"Name"_s) + headerCell(u"right"_s, u"Amount"_s) + u"</tr>"_s + Crlf +
        u"<tr>"_s + Crlf +
        u"<td align='center' style='background-color:#EEFFC0;color:#000000;font-family:Tahoma;"
        u"font-size:10.1;font-weight:bold;'><b>Wages</b></td>"_s +
        Crlf +
        u"<td align='right' style='background-color:#FFFFFF;color:#0A0000;font-family:Arial;"
        u"font-size:10.25;font-weight:normal;'>1234.5</td>"_s +
        Crlf + u"</tr>"_s + Crlf + u"</table>"_s + Crlf;
    // "ID" goes out with "id", in any case; the hidden row is not written. Colours are written
    // from the cell's own and the grid's; sizes are two points up, 8.1 + 2 without the noise.
    QCOMPARE(GridHtml::gridToHtml(grid, u"id"_s), expected);

    // With no row shown, the header is still written.
    grid.setRowVisible(1, false);
    const QString html = GridHtml::gridToHtml(grid, u"id"_s);
    QCOMPARE(html.count(u"<tr>"_s), 1);
    QVERIFY(html.contains(headerCell(u"right"_s, u"Amount"_s)));
}

void TestGridHtml::everyColumnExcludedOrHidden()
{
    GridModel grid;
    fillSample(grid);
    grid.column(3).visible = false;
    QCOMPARE(GridHtml::gridToHtml(grid, u"id,NAME"_s),
             u"<table width='100%' cellpadding='4' cellspacing='0'>"_s + Crlf + u"<tr>"_s + Crlf +
                 u"</tr>"_s + Crlf + u"<tr>"_s + Crlf + u"</tr>"_s + Crlf + u"</table>"_s + Crlf);
}

void TestGridHtml::unknownAlignmentRepeatsTheLastWord()
{
    GridModel grid;
    fillSample(grid);
    grid.column(2).alignment = 3;
    grid.column(3).alignment = 3;
    QString html = GridHtml::gridToHtml(grid, u"id"_s);
    QVERIFY(html.contains(headerCell(QString(), u"Name"_s)));
    QVERIFY(html.contains(headerCell(QString(), u"Amount"_s)));

    grid.column(2).alignment = GridModel::AlignCentre;
    grid.editCell(1, 3).alignment = 7;
    html = GridHtml::gridToHtml(grid, u"id"_s);
    QVERIFY(html.contains(headerCell(u"center"_s, u"Amount"_s)));
    // The cell repeats the word of the cell before it in the row.
    QVERIFY(html.contains(u"<td align='center' style='background-color:#FFFFFF;color:#0A0000"_s));
}

void TestGridHtml::pageWithAndWithoutPicture()
{
    GridModel grid;
    fillSample(grid);
    QTemporaryDir folder;
    const QString picture = folder.filePath(u"tmp.bmp"_s);
    const QString start = u"<html>"_s + Crlf +
                          u"<body bgcolor='#ffffff' text='#000000' style='margin: 0px; "
                          u"font-family: arial'>"_s +
                          Crlf + GridHtml::gridToHtml(grid, u"id"_s);
    QCOMPARE(GridHtml::reportPage(grid, u"id"_s, picture), start + u"</body></html>"_s);
    QCOMPARE(GridHtml::reportPage(grid, u"id"_s, QString()), start + u"</body></html>"_s);

    QFile file(picture);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.close();
    QCOMPARE(GridHtml::reportPage(grid, u"id"_s, picture),
             start + u"<p align='left'><img src='"_s + picture + u"'></p></body></html>"_s);
}

QTEST_GUILESS_MAIN(TestGridHtml)
#include "tst_gridhtml.moc"
