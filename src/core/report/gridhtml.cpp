// Veltrix — KPI dashboard for small businesses.
#include "gridhtml.h"

#include "common/fileoperations.h"
#include "grid/gridmodel.h"

#include <cmath>

using namespace Qt::StringLiterals;

namespace GridHtml {

namespace {

const QString Crlf = u"\r\n"_s;
constexpr int NoPrefix = 0x800;

quint32 toBgr(const QColor &colour)
{
    return quint32(colour.red()) | quint32(colour.green()) << 8 | quint32(colour.blue()) << 16;
}

// Column alignment codes: 0 left, 1 right, 2 centre; any other repeats the last word.
void columnWord(int code, QString &word)
{
    switch (code) {
    case GridModel::AlignLeft:
        word = u"left"_s;
        break;
    case GridModel::AlignRight:
        word = u"right"_s;
        break;
    case GridModel::AlignCentre:
        word = u"center"_s;
        break;
    default:
        break;
    }
}

// Cell alignment flags carry the no-prefix bit: 0x800 left, 0x801 centre, 0x802 right.
void cellWord(int flags, QString &word)
{
    switch (flags) {
    case NoPrefix:
        word = u"left"_s;
        break;
    case NoPrefix | 1:
        word = u"center"_s;
        break;
    case NoPrefix | 2:
        word = u"right"_s;
        break;
    default:
        break;
    }
}

QList<int> printedColumns(const GridModel &grid, const QString &exclusions)
{
    const QStringList excluded = exclusions.split(u',');
    QList<int> columns;
    for (int c = 1; c <= grid.columnCount(); ++c) {
        const GridModel::Column &column = grid.column(c);
        if (column.visible && !isInList(excluded, column.key, false))
            columns << c;
    }
    return columns;
}

} // namespace

QString colourToHtml(quint32 colour)
{
    QString digits = QString::number(colour, 16).toUpper();
    if (digits.size() < 6)
        digits = digits.rightJustified(6, u'0');
    return u"#"_s + digits.mid(4) + digits.mid(2, 2) + digits.mid(0, 2);
}

QString colourToHtml(const QColor &colour)
{
    return colourToHtml(toBgr(colour));
}

bool isInList(const QStringList &list, const QString &text, bool caseSensitive)
{
    for (const QString &element : list) {
        if (caseSensitive ? element == text : element.toLower() == text.toLower())
            return true;
    }
    return false;
}

QString fontSizeText(double points)
{
    // Sizes come in hundredths at most; rounding keeps 8.1 + 2 from printing as 10.0999...
    const double rounded = std::round(points * 100.0) / 100.0;
    return QString::number(rounded, 'g', QLocale::FloatingPointShortest);
}

QString gridToHtml(const GridModel &grid, const QString &exclusions)
{
    const QList<int> columns = printedColumns(grid, exclusions);
    const GridModel::Font &gridFont = grid.font();
    QString html = u"<table width='100%' cellpadding='4' cellspacing='0'>"_s + Crlf;
    html += u"<tr>"_s + Crlf;
    QString word;
    for (const int c : columns) {
        const GridModel::Column &column = grid.column(c);
        columnWord(column.alignment, word);
        html += u"<td align='"_s + word + u"' style='"_s + u"background-color:#DADADA;"_s +
                u"color:"_s + colourToHtml(grid.foreground()) + u";"_s + u"font-family:"_s +
                gridFont.family + u";"_s + u"font-size:"_s + fontSizeText(gridFont.pointSize + 3) +
                u";"_s + u"font-weight:bold;"_s + u"'>"_s + column.header + u"</td>"_s + Crlf;
    }
    html += u"</tr>"_s + Crlf;

    for (int r = 1; r <= grid.rowCount(); ++r) {
        if (!grid.isRowVisible(r))
            continue;
        html += u"<tr>"_s + Crlf;
        for (const int c : columns) {
            const GridModel::Cell &cell = grid.cell(r, c);
            const GridModel::Font &font = cell.font ? *cell.font : gridFont;
            cellWord(NoPrefix | cell.alignment, word);
            html += u"<td align='"_s + word + u"' style='"_s + u"background-color:"_s +
                    colourToHtml(cell.back.value_or(grid.background())) + u";"_s + u"color:"_s +
                    colourToHtml(cell.fore.value_or(grid.foreground())) + u";"_s +
                    u"font-family:"_s + font.family + u";"_s + u"font-size:"_s +
                    fontSizeText(font.pointSize + 2) + u";"_s +
                    (font.bold ? u"font-weight:bold;"_s : u"font-weight:normal;"_s) + u"'>"_s +
                    grid.cellText(r, c) + u"</td>"_s + Crlf;
        }
        html += u"</tr>"_s + Crlf;
    }
    html += u"</table>"_s + Crlf;
    return html;
}

QString reportTitle(const QDate &start, const QDate &end, const QLocale &locale, const QDate &today)
{
    const QString range = locale.toString(start, QLocale::ShortFormat) + u" to "_s +
                          locale.toString(end, QLocale::ShortFormat);
    // Figures of a range that has not ended yet stop at today; the reader must not take them
    // for the whole range.
    if (!today.isValid() || !end.isValid() || end <= today)
        return range;
    return range + u" (to date: "_s + QLocale::c().toString(today, u"d MMM yyyy"_s) + u")"_s;
}

QString reportPage(const GridModel &grid, const QString &exclusions, const QString &picturePath)
{
    QString page = u"<html>"_s + Crlf;
    page +=
        u"<body bgcolor='#ffffff' text='#000000' style='margin: 0px; font-family: arial'>"_s + Crlf;
    page += gridToHtml(grid, exclusions);
    if (!picturePath.isEmpty() && FileOperations::fileExists(picturePath))
        page += u"<p align='left'><img src='"_s + picturePath + u"'></p>"_s;
    page += u"</body></html>"_s;
    return page;
}

} // namespace GridHtml
