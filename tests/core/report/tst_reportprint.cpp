// Veltrix — KPI dashboard for small businesses.
#include "report/pagesetup.h"
#include "report/reportrenderer.h"

#include <QImage>
#include <QPdfWriter>
#include <QProcess>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QTest>
#include <QTextDocument>
#include <QUrl>

using namespace Qt::StringLiterals;

namespace {

QString tool(const QString &name)
{
    return QStandardPaths::findExecutable(name);
}

QString pdfText(const QString &pdf)
{
    QProcess process;
    process.start(tool(u"pdftotext"_s), {u"-layout"_s, pdf, u"-"_s});
    process.waitForFinished(60000);
    return QString::fromUtf8(process.readAllStandardOutput());
}

QImage pdfPage(const QString &pdf, int page, const QString &folder)
{
    QProcess process;
    const QString prefix = folder + u"/page"_s;
    process.start(tool(u"pdftoppm"_s),
                  {u"-png"_s, u"-r"_s, u"50"_s, u"-f"_s, QString::number(page), u"-l"_s,
                   QString::number(page), u"-singlefile"_s, pdf, prefix});
    process.waitForFinished(60000);
    return QImage(prefix + u".png"_s);
}

bool hasColour(const QImage &image, QRgb colour, int tolerance = 6)
{
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            const QRgb p = image.pixel(x, y);
            if (std::abs(qRed(p) - qRed(colour)) <= tolerance &&
                std::abs(qGreen(p) - qGreen(colour)) <= tolerance &&
                std::abs(qBlue(p) - qBlue(colour)) <= tolerance)
                return true;
        }
    }
    return false;
}

QString tablePage(int rows, const QString &picture = {})
{
    QString html = u"<html>\r\n<body bgcolor='#ffffff'>\r\n<table width='100%' cellpadding='4' "
                   u"cellspacing='0'>\r\n"_s;
    for (int r = 1; r <= rows; ++r) {
        html += u"<tr>\r\n<td style='background-color:#A2E11B;font-size:12;'>Line %1</td>"
                u"<td align='right'>%2</td>\r\n</tr>\r\n"_s.arg(r)
                    .arg(r * 100);
    }
    html += u"</table>\r\n"_s;
    if (!picture.isEmpty())
        html += u"<p align='left'><img src='"_s + picture + u"'></p>"_s;
    return html + u"</body></html>"_s;
}

} // namespace

class TestReportPrint : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void expandCodes_data();
    void expandCodes();
    void printableHtml_data();
    void printableHtml();
    void picturesKeepTheirSize_data();
    void picturesKeepTheirSize();
    void backgroundsAndPicture();

private:
    QTemporaryDir m_folder;
};

void TestReportPrint::initTestCase()
{
    if (tool(u"pdftotext"_s).isEmpty() || tool(u"pdftoppm"_s).isEmpty())
        QFAIL("pdftotext and pdftoppm (poppler-utils) are needed; scripts/install-deps installs "
              "them");
}

void TestReportPrint::expandCodes_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("parts");
    QTest::newRow("title and date")
        << u"Jul to Jun&b&d"_s << QStringList{u"Jul to Jun"_s, QString(), u"6/12/26"_s};
    QTest::newRow("page numbers") << u"&bPage &p of &P"_s
                                  << QStringList{QString(), QString(), u"Page 2 of 3"_s};
    QTest::newRow("three parts") << u"a&bb&bc"_s << QStringList{u"a"_s, u"b"_s, u"c"_s};
    QTest::newRow("ampersands") << u"R&&D &x&"_s << QStringList{u"R&D &x&"_s, QString(), {}};
    QTest::newRow("empty") << QString() << QStringList{QString(), QString(), QString()};
    QTest::newRow("window title") << u"&w"_s << QStringList{u"Page Preview"_s, {}, {}};
}

void TestReportPrint::expandCodes()
{
    QFETCH(QString, text);
    QFETCH(QStringList, parts);
    const ReportRenderer::Margins margins = ReportRenderer::expandCodes(
        text, 2, 3, QDate(2026, 12, 6), QLocale(QLocale::English, QLocale::Australia),
        u"Page Preview"_s);
    QCOMPARE((QStringList{margins.left, margins.centre, margins.right}), parts);
}

void TestReportPrint::printableHtml_data()
{
    QTest::addColumn<QString>("html");
    QTest::addColumn<QString>("printable");
    QTest::addColumn<QString>("shown");
    QTest::newRow("unitless size in pixels")
        << u"<td style='font-size:10.25;font-weight:bold;'>7</td>"_s
        << u"<td style='font-size:10.25px;font-weight:bold;'>7</td>"_s << u"7"_s;
    QTest::newRow("size with unit kept")
        << u"<p style='font-size:12pt;'>x</p>"_s << u"<p style='font-size:12pt;'>x</p>"_s << u"x"_s;
    QTest::newRow("at-most benchmark is text")
        << u"<p>&lt;9% <45%</p>"_s << u"<p>&lt;9% &lt;45%</p>"_s << u"<9% <45%"_s;
    QTest::newRow("both markers") << u"<p><0.5,>1</p>"_s << u"<p>&lt;0.5,>1</p>"_s << u"<0.5,>1"_s;
    QTest::newRow("tags and comments stay mark-up")
        << u"<p>a</p><!-- b --><br/>"_s << u"<p>a</p><!-- b --><br/>"_s << u"a"_s;
}

void TestReportPrint::printableHtml()
{
    QFETCH(QString, html);
    QFETCH(QString, printable);
    QFETCH(QString, shown);
    QCOMPARE(ReportRenderer::printableHtml(html), printable);
    QTextDocument document;
    document.setHtml(ReportRenderer::printableHtml(html));
    QCOMPARE(document.toPlainText().trimmed(), shown.trimmed());
}

void TestReportPrint::picturesKeepTheirSize_data()
{
    QTest::addColumn<double>("ratio");     // of the screen the picture was grabbed from
    QTest::addColumn<double>("pageWidth"); // 0: no limit
    QTest::addColumn<double>("shownWidth");
    QTest::newRow("ordinary screen") << 1.0 << 0.0 << 400.0;
    QTest::newRow("twice as dense") << 2.0 << 0.0 << 200.0;
    QTest::newRow("one and a half") << 1.5 << 0.0 << 400.0 / 1.5;
    QTest::newRow("dense and still too wide") << 1.25 << 300.0 << 300.0;
}

void TestReportPrint::picturesKeepTheirSize()
{
    QFETCH(double, ratio);
    QFETCH(double, pageWidth);
    QFETCH(double, shownWidth);
    QImage picture(400, 100, QImage::Format_RGB32);
    picture.fill(Qt::blue);
    picture.setDotsPerMeterX(int(std::lround(96.0 / 0.0254 * ratio)));
    picture.setDotsPerMeterY(picture.dotsPerMeterX());
    const QString bmp = m_folder.filePath(u"tmp.bmp"_s);
    QVERIFY(picture.save(bmp, "BMP"));
    QTextDocument document;
    document.setDocumentMargin(0);
    document.setBaseUrl(QUrl::fromLocalFile(m_folder.path() + u'/'));
    document.setHtml(u"<p><img src='"_s + bmp + u"'></p>"_s);
    ReportRenderer::showPicturesAtTheirSize(document, pageWidth);
    document.setTextWidth(1000);
    QCOMPARE(std::round(document.idealWidth()), std::round(shownWidth));
}

void TestReportPrint::backgroundsAndPicture()
{
    // A picture three pages wide: the page is shrunk so that all of it shows.
    QImage picture(2400, 200, QImage::Format_RGB32);
    picture.fill(qRgb(0, 0, 255));
    for (int x = 2200; x < 2400; ++x) {
        for (int y = 0; y < 200; ++y)
            picture.setPixel(x, y, qRgb(255, 0, 0));
    }
    const QString bmp = m_folder.filePath(u"tmp.bmp"_s);
    QVERIFY(picture.save(bmp, "BMP"));
    for (const bool background : {true, false}) {
        const QString pdf = m_folder.filePath(u"background.pdf"_s);
        PrintOptions options;
        options.printBackground = background;
        {
            QPdfWriter writer(pdf);
            QCOMPARE(ReportRenderer(tablePage(5, bmp), m_folder.path()).print(writer, options), 1);
        }
        const QImage page = pdfPage(pdf, 1, m_folder.path());
        QVERIFY(!page.isNull());
        QCOMPARE(hasColour(page, qRgb(0xA2, 0xE1, 0x1B)), background);
        QVERIFY(pdfText(pdf).contains(u"Line 5"_s));
        QVERIFY(hasColour(page, qRgb(0, 0, 255), 30));
        QVERIFY(hasColour(page, qRgb(255, 0, 0), 30)); // the right-hand end made it onto the page
    }
}

QTEST_MAIN(TestReportPrint)
#include "tst_reportprint.moc"
