// Veltrix — KPI dashboard for small businesses.
#include "reportrenderer.h"

#include <QAbstractTextDocumentLayout>
#include <QFileInfo>
#include <QFontMetricsF>
#include <QLocale>
#include <QPagedPaintDevice>
#include <QPainter>
#include <QRegularExpression>
#include <QTextBlock>
#include <QTextCursor>
#include <QTextDocument>
#include <QTextFrame>
#include <QTextTable>
#include <QUrl>

using namespace Qt::StringLiterals;

namespace {

// Browsers lay a page out at 96 units to the inch.
constexpr double CssDpi = 96.0;
constexpr double HeaderPointSize = 8.0;

void clearTableBackgrounds(QTextFrame *frame)
{
    for (QTextFrame *child : frame->childFrames()) {
        if (auto *table = qobject_cast<QTextTable *>(child)) {
            for (int r = 0; r < table->rows(); ++r) {
                for (int c = 0; c < table->columns(); ++c) {
                    QTextTableCell cell = table->cellAt(r, c);
                    QTextTableCellFormat format = cell.format().toTableCellFormat();
                    format.clearBackground();
                    cell.setFormat(format);
                }
            }
        }
        clearTableBackgrounds(child);
    }
}

// Without background printing, a browser prints the text on white paper.
void clearBackgrounds(QTextDocument &document)
{
    clearTableBackgrounds(document.rootFrame());
    QTextCursor cursor(&document);
    for (QTextBlock block = document.begin(); block.isValid(); block = block.next()) {
        QTextBlockFormat blockFormat = block.blockFormat();
        if (blockFormat.hasProperty(QTextFormat::BackgroundBrush)) {
            blockFormat.clearBackground();
            cursor.setPosition(block.position());
            cursor.setBlockFormat(blockFormat);
        }
        for (auto it = block.begin(); !it.atEnd(); ++it) {
            const QTextFragment fragment = it.fragment();
            QTextCharFormat format = fragment.charFormat();
            if (!format.hasProperty(QTextFormat::BackgroundBrush))
                continue;
            format.clearBackground();
            cursor.setPosition(fragment.position());
            cursor.setPosition(fragment.position() + fragment.length(), QTextCursor::KeepAnchor);
            cursor.setCharFormat(format);
        }
    }
}

// The widest line a cell's text needs, in the document's units, padding included.
double cellTextWidth(const QTextTable *table, const QTextTableCell &cell)
{
    double widest = 0.0;
    for (QTextBlock block = cell.firstCursorPosition().block();
         block.isValid() && block.position() <= cell.lastCursorPosition().position();
         block = block.next()) {
        double width = 0.0;
        for (auto it = block.begin(); !it.atEnd(); ++it) {
            const QTextFragment fragment = it.fragment();
            width += QFontMetricsF(fragment.charFormat().font()).horizontalAdvance(fragment.text());
        }
        widest = std::max(widest, width);
    }
    const QTextTableFormat format = table->format();
    return widest + 2 * format.cellPadding() + 2 * format.border() + 2;
}

// A browser sizes the columns of an automatic table to their contents and gives what is left
// to the column whose text is longest; the text engine would share the width out evenly and
// leave a short column (the row number) as wide as the labels. The header row is repeated at
// the top of every page, as a printed table's headings are.
void layOutTables(QTextFrame *frame)
{
    for (QTextFrame *child : frame->childFrames()) {
        if (auto *table = qobject_cast<QTextTable *>(child)) {
            QList<double> widths(table->columns(), 0.0);
            for (int r = 0; r < table->rows(); ++r) {
                for (int c = 0; c < table->columns(); ++c)
                    widths[c] = std::max(widths[c], cellTextWidth(table, table->cellAt(r, c)));
            }
            const auto widest = std::max_element(widths.cbegin(), widths.cend());
            QList<QTextLength> constraints;
            for (auto it = widths.cbegin(); it != widths.cend(); ++it) {
                constraints << (it == widest ? QTextLength(QTextLength::VariableLength, 0)
                                             : QTextLength(QTextLength::FixedLength, *it));
            }
            QTextTableFormat format = table->format();
            format.setColumnWidthConstraints(constraints);
            format.setHeaderRowCount(std::min(1, table->rows()));
            table->setFormat(format);
        }
        layOutTables(child);
    }
}

void drawBand(QPainter &painter, const QRectF &band, const ReportRenderer::Margins &texts)
{
    painter.drawText(band, Qt::AlignLeft | Qt::AlignVCenter, texts.left);
    painter.drawText(band, Qt::AlignHCenter | Qt::AlignVCenter, texts.centre);
    painter.drawText(band, Qt::AlignRight | Qt::AlignVCenter, texts.right);
}

} // namespace

ReportRenderer::ReportRenderer(const QString &html, const QString &baseFolder)
    : m_html(html)
    , m_baseFolder(baseFolder)
{}

ReportRenderer::~ReportRenderer() = default;

QString ReportRenderer::printableHtml(const QString &html)
{
    // A size without a unit counts as pixels in a browser; the text engine would drop it.
    static const QRegularExpression unitless(u"(font-size:\\s*[0-9]+(?:\\.[0-9]+)?)\\s*;"_s);
    // A browser reads "<" as the start of a tag only before a letter, "/", "!" or "?"; a
    // benchmark such as "<45%" is text to it. The text engine would swallow it as a tag.
    static const QRegularExpression bareLessThan(u"<(?![A-Za-z/!?])"_s);
    QString printable = html;
    printable.replace(unitless, u"\\1px;"_s);
    printable.replace(bareLessThan, u"&lt;"_s);
    return printable;
}

void ReportRenderer::showPicturesAtTheirSize(QTextDocument &document, double maxWidth)
{
    constexpr double ScreenDotsPerMeter = 96.0 / 0.0254;
    QTextCursor cursor(&document);
    for (QTextBlock block = document.begin(); block.isValid(); block = block.next()) {
        for (auto it = block.begin(); !it.atEnd(); ++it) {
            const QTextFragment fragment = it.fragment();
            QTextImageFormat format = fragment.charFormat().toImageFormat();
            if (!format.isValid() || format.hasProperty(QTextFormat::ImageWidth))
                continue;
            const QUrl url = document.baseUrl().resolved(QUrl(format.name()));
            const QImage picture(url.isLocalFile() ? url.toLocalFile() : format.name());
            if (picture.isNull())
                continue;
            double density = std::max(1.0, picture.dotsPerMeterX() / ScreenDotsPerMeter);
            if (maxWidth > 0.0)
                density = std::max(density, picture.width() / maxWidth);
            if (density <= 1.05)
                continue;
            format.setWidth(picture.width() / density);
            format.setHeight(picture.height() / density);
            cursor.setPosition(fragment.position());
            cursor.setPosition(fragment.position() + fragment.length(), QTextCursor::KeepAnchor);
            cursor.setCharFormat(format);
        }
    }
}

ReportRenderer::Margins ReportRenderer::expandCodes(const QString &text, int page, int pages,
                                                    const QDate &today, const QLocale &locale,
                                                    const QString &windowTitle)
{
    QStringList parts{QString()};
    for (qsizetype i = 0; i < text.size(); ++i) {
        const QChar ch = text.at(i);
        if (ch != u'&' || i + 1 == text.size()) {
            parts.last() += ch;
            continue;
        }
        const QChar code = text.at(++i);
        switch (code.unicode()) {
        case 'b':
            parts << QString();
            break;
        case 'd':
            parts.last() += locale.toString(today, QLocale::ShortFormat);
            break;
        case 'D':
            parts.last() += locale.toString(today, QLocale::LongFormat);
            break;
        case 'p':
            parts.last() += QString::number(page);
            break;
        case 'P':
            parts.last() += QString::number(pages);
            break;
        case 'w':
            parts.last() += windowTitle;
            break;
        case '&':
            parts.last() += u'&';
            break;
        default:
            parts.last() += ch;
            parts.last() += code;
            break;
        }
    }
    if (parts.size() == 1)
        return {parts.at(0), {}, {}};
    if (parts.size() == 2)
        return {parts.at(0), {}, parts.at(1)};
    return {parts.at(0), parts.at(1), parts.mid(2).join(QString())};
}

int ReportRenderer::print(QPagedPaintDevice &device, const PrintOptions &options,
                          const QDate &today) const
{
    device.setPageMargins(QMarginsF(0, 0, 0, 0), QPageLayout::Inch);
    const double dpiX = device.logicalDpiX();
    const double dpiY = device.logicalDpiY();
    const double pageWidth = device.width();
    const double pageHeight = device.height();
    const QRectF body(options.marginLeftInches * dpiX, options.marginTopInches * dpiY,
                      pageWidth - (options.marginLeftInches + options.marginRightInches) * dpiX,
                      pageHeight - (options.marginTopInches + options.marginBottomInches) * dpiY);
    if (body.width() <= 0 || body.height() <= 0)
        return 0;

    QTextDocument document;
    document.setDocumentMargin(0);
    document.setBaseUrl(QUrl::fromLocalFile(m_baseFolder + u'/'));
    document.setHtml(printableHtml(m_html));
    layOutTables(document.rootFrame());
    if (!options.printBackground)
        clearBackgrounds(document);

    // Lay the page out at browser size, then scale it onto the device; a page wider than the
    // paper is shrunk to fit rather than cut off.
    const double bodyWidthCss = body.width() / dpiX * CssDpi;
    showPicturesAtTheirSize(document, bodyWidthCss);
    document.setTextWidth(bodyWidthCss);
    double layoutWidth = bodyWidthCss;
    if (options.shrinkToFit && document.idealWidth() > bodyWidthCss) {
        layoutWidth = document.idealWidth();
        document.setTextWidth(layoutWidth);
    }
    const double scale = bodyWidthCss / layoutWidth;
    const double pageHeightCss = body.height() / dpiY * CssDpi / scale;
    document.setPageSize(QSizeF(layoutWidth, pageHeightCss));
    const int pages = std::max(1, document.pageCount());

    QPainter painter;
    if (!painter.begin(&device))
        return 0;
    QFont bandFont(u"Sans Serif"_s);
    bandFont.setPointSizeF(HeaderPointSize);
    for (int page = 0; page < pages; ++page) {
        if (page > 0)
            device.newPage();
        painter.save();
        painter.translate(body.topLeft());
        painter.scale(dpiX / CssDpi * scale, dpiY / CssDpi * scale);
        const QRectF visible(0, page * pageHeightCss, layoutWidth, pageHeightCss);
        painter.translate(0, -visible.top());
        painter.setClipRect(visible);
        QAbstractTextDocumentLayout::PaintContext context;
        context.clip = visible;
        document.documentLayout()->draw(&painter, context);
        painter.restore();

        painter.save();
        painter.setFont(QFont(bandFont, &device));
        painter.setPen(Qt::black);
        const QRectF headerBand(body.left(), 0, body.width(), body.top());
        const QRectF footerBand(body.left(), body.bottom(), body.width(),
                                pageHeight - body.bottom());
        drawBand(painter, headerBand,
                 expandCodes(options.header, page + 1, pages, today, options.locale,
                             options.windowTitle));
        drawBand(painter, footerBand,
                 expandCodes(options.footer, page + 1, pages, today, options.locale,
                             options.windowTitle));
        painter.restore();
    }
    painter.end();
    return pages;
}
