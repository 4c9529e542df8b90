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
    grid.editCell(1, 2).font = GridModel::Font{u"Tahoma"_s, 9, true};
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
    void colourToHtml_data();
    void colourToHtml();
    void isInList_data();
    void isInList();
    void fontSize_data();
    void fontSize();
    void wholeTable();
    void noVisibleRowsKeepsHeader();
    void everyColumnExcludedOrHidden();
    void unknownAlignmentRepeatsTheLastWord();
    void pageWithAndWithoutPicture();
};

void TestGridHtml::colourToHtml_data()
{
    QTest::addColumn<quint32>("colour");
    QTest::addColumn<QString>("html");
    QTest::newRow("EE FF C0") << quint32(0xC0FFEE) << u"#EEFFC0"_s;
    QTest::newRow("0A 00 00") << quint32(0x00000A) << u"#0A0000"_s;
    QTest::newRow("white") << quint32(0xFFFFFF) << u"#FFFFFF"_s;
}

void TestGridHtml::colourToHtml()
{
    QFETCH(quint32, colour);
    QFETCH(QString, html);
    QCOMPARE(GridHtml::colourToHtml(colour), html);
    const QColor asColour(int(colour & 0xFF), int((colour >> 8) & 0xFF), int(colour >> 16));
    QCOMPARE(GridHtml::colourToHtml(asColour), html);
}

void TestGridHtml::isInList_data()
{
    QTest::addColumn<QStringList>("list");
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("caseSensitive");
    QTest::addColumn<bool>("found");
    QTest::newRow("ID, insensitive") << QStringList{u"id"_s} << u"ID"_s << false << true;
    QTest::newRow("ID, sensitive") << QStringList{u"id"_s} << u"ID"_s << true << false;
    QTest::newRow("second") << QStringList{u"a"_s, u"b"_s} << u"b"_s << true << true;
    QTest::newRow("not trimmed") << QStringList{u"a"_s, u" b"_s} << u"b"_s << false << false;
    QTest::newRow("empty list") << QStringList{} << u"id"_s << false << false;
}

void TestGridHtml::isInList()
{
    QFETCH(QStringList, list);
    QFETCH(QString, text);
    QFETCH(bool, caseSensitive);
    QFETCH(bool, found);
    QCOMPARE(GridHtml::isInList(list, text, caseSensitive), found);
}

void TestGridHtml::fontSize_data()
{
    QTest::addColumn<double>("points");
    QTest::addColumn<QString>("text");
    QTest::newRow("8.25 + 2") << 10.25 << u"10.25"_s;
    QTest::newRow("9 + 3") << 12.0 << u"12"_s;
    QTest::newRow("8.1 + 2") << 8.1 + 2 << u"10.1"_s;
    QTest::newRow("7.5") << 7.5 << u"7.5"_s;
}

void TestGridHtml::fontSize()
{
    QFETCH(double, points);
    QFETCH(QString, text);
    QCOMPARE(GridHtml::fontSizeText(points), text);
}

void TestGridHtml::wholeTable()
{
    GridModel grid;
    fillSample(grid);
    const QString expected =
        u"<table width='100%' cellpadding='4' cellspacing='0'>"_s + Crlf + u"<tr>"_s + Crlf +
        headerCell(u"left"_s, u"Name"_s) + headerCell(u"right"_s, u"Amount"_s) + u"</tr>"_s + Crlf +
        u"<tr>"_s + Crlf +
        u"<td align='center' style='background-color:#EEFFC0;color:#000000;font-family:Tahoma;"
        u"font-size:11;font-weight:bold;'><b>Wages</b></td>"_s +
        Crlf +
        u"<td align='right' style='background-color:#FFFFFF;color:#0A0000;font-family:Arial;"
        u"font-size:10.25;font-weight:normal;'>1234.5</td>"_s +
        Crlf + u"</tr>"_s + Crlf + u"</table>"_s + Crlf;
    // "ID" goes out with "id"; the hidden row is not written.
    QCOMPARE(GridHtml::gridToHtml(grid, u"id"_s), expected);
}

void TestGridHtml::noVisibleRowsKeepsHeader()
{
    GridModel grid;
    fillSample(grid);
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
