// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "report/pagesetup.h"
#include "report/printwindow.h"

#include <QCheckBox>
#include <QLineEdit>
#include <QProcess>
#include <QPushButton>
#include <QStandardPaths>
#include <QTest>
#include <QTextBrowser>

using namespace Qt::StringLiterals;

namespace {

const QString PageText = u"<html>\r\n<body bgcolor='#ffffff'>\r\n<table width='100%'>\r\n"
                         u"<tr>\r\n<td style='font-size:11;'>Panel labour <b>gross</b></td>\r\n"
                         u"<td align='right'>48.2%</td>\r\n</tr>\r\n</table>\r\n</body></html>"_s;

QStringList pageSetupValues(SettingsStore &store)
{
    QStringList values;
    for (const QString &name : PageSetupSession::valueNames())
        values << store.readSetting(name, PageSetupSession::Key, u"<absent>"_s);
    return values;
}

} // namespace

class TestPrintWindow : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void commandsApplyTheBoxes_data();
    void commandsApplyTheBoxes();
    void showsSetsUpAndPrintsThePage();

private:
    QString writePage()
    {
        const QString path = m_workspace->path(u"tmp.html"_s);
        QFile file(path);
        if (file.open(QIODevice::WriteOnly))
            file.write(PageText.toUtf8());
        return path;
    }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestPrintWindow::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    m_workspace->context().setNumberFormat(
        NumberFormat(QLocale(QLocale::English, QLocale::Australia)));
}

void TestPrintWindow::commandsApplyTheBoxes_data()
{
    QTest::addColumn<QString>("command");
    QTest::addColumn<bool>("formatting");
    QTest::addColumn<bool>("date");
    QTest::addColumn<bool>("pages");
    QTest::addColumn<QString>("header");
    QTest::addColumn<QStringList>("expected"); // background, header, footer
    QTest::newRow("print, all cleared") << u"print"_s << false << false << false << u"Title"_s
                                        << QStringList{u"no"_s, u"Title"_s, QString()};
    QTest::newRow("preview, changed header")
        << u"preview"_s << true << true << false << u"Changed title"_s
        << QStringList{u"yes"_s, u"Changed title&b&d"_s, QString()};
    QTest::newRow("page setup, all ticked")
        << u"setup"_s << true << true << true << u"Title"_s
        << QStringList{u"yes"_s, u"Title&b&d"_s, u"&bPage &p of &P"_s};
}

void TestPrintWindow::commandsApplyTheBoxes()
{
    QFETCH(QString, command);
    QFETCH(bool, formatting);
    QFETCH(bool, date);
    QFETCH(bool, pages);
    QFETCH(QString, header);
    QFETCH(QStringList, expected);
    // The window uses its own page set-up and gives the user's back, an absent value absent,
    // when it closes.
    SettingsStore &store = m_workspace->store();
    store.writeSetting(u"margin_top"_s, u"0.75"_s, PageSetupSession::Key);
    store.writeSetting(u"footer"_s, u"&u&b&d"_s, PageSetupSession::Key);
    const QStringList before = pageSetupValues(store);
    PrintWindow window(m_workspace->context(), nullptr);
    window.showPage(writePage(), u"Title"_s);
    QCOMPARE(store.readSetting(u"margin_top"_s, PageSetupSession::Key), u"0.5"_s);
    QStringList seen;
    const auto answer = [&](QPrinter &, QWidget *) {
        const QString key = PageSetupSession::Key;
        seen = {store.readSetting(u"Print_Background"_s, key), store.readSetting(u"header"_s, key),
                store.readSetting(u"footer"_s, key)};
        return false;
    };
    window.setPrintQuestion(answer);
    window.setPreviewQuestion(answer);
    window.setPageSetupQuestion(answer);
    window.chkFormatting()->setChecked(formatting);
    window.chkDate()->setChecked(date);
    window.chkPages()->setChecked(pages);
    window.txtHeader()->setText(header);
    if (command == u"print"_s)
        window.print();
    else if (command == u"preview"_s)
        window.printPreview();
    else
        window.pageSetup();
    QCOMPARE(seen, expected);
    window.reject();
    QCOMPARE(pageSetupValues(store), before);
}

void TestPrintWindow::showsSetsUpAndPrintsThePage()
{
    const QString pdftotext = QStandardPaths::findExecutable(u"pdftotext"_s);
    if (pdftotext.isEmpty())
        QFAIL("pdftotext (poppler-utils) is needed; scripts/install-deps installs it");
    const QString pdf = m_workspace->path(u"printed.pdf"_s);
    PrintWindow window(m_workspace->context(), nullptr);
    window.showPage(writePage(), u"1/7/25 to 30/6/26"_s);
    QCOMPARE(window.windowTitle(), u"Page Preview"_s);
    QCOMPARE(window.txtHeader()->text(), u"1/7/25 to 30/6/26"_s);
    // The mark-up in the cell is rendered, not shown as text.
    QVERIFY(window.ieFrame()->toPlainText().contains(u"Panel labour gross"_s));
    QMarginsF margins;
    window.setPageSetupQuestion([&](QPrinter &printer, QWidget *) {
        margins = printer.pageLayout().margins(QPageLayout::Inch);
        printer.setPageMargins(QMarginsF(1.0, 0.25, 1.5, 0.5), QPageLayout::Inch);
        return true;
    });
    window.pageSetup();
    // The dialog opened on the report's margins (bottom: the browser's 0.75 inch).
    QCOMPARE(margins, QMarginsF(0.4, 0.5, 0.4, 0.75));
    const PrintOptions options = PrintOptions::fromStore(m_workspace->store());
    QCOMPARE(QMarginsF(options.marginLeftInches, options.marginTopInches, options.marginRightInches,
                       options.marginBottomInches),
             QMarginsF(1.0, 0.25, 1.5, 0.5));
    window.setPrintQuestion([&](QPrinter &printer, QWidget *) {
        printer.setOutputFormat(QPrinter::PdfFormat);
        printer.setOutputFileName(pdf);
        return true;
    });
    window.print();
    QProcess text;
    text.start(pdftotext, {u"-layout"_s, pdf, u"-"_s});
    QVERIFY(text.waitForFinished(60000));
    const QString printed = QString::fromUtf8(text.readAllStandardOutput());
    QVERIFY2(printed.contains(u"1/7/25 to 30/6/26"_s), qPrintable(printed));
    QVERIFY(printed.contains(QLocale(QLocale::English, QLocale::Australia)
                                 .toString(QDate::currentDate(), QLocale::ShortFormat)));
    QVERIFY(printed.contains(u"Page 1 of 1"_s));
    QVERIFY(printed.contains(u"48.2%"_s));
}

QTEST_MAIN(TestPrintWindow)
#include "tst_printwindow.moc"
