// Veltrix — KPI dashboard for small businesses.
#include "clirun.h"

#include "cipher/passwordcipher.h"
#include "common/settings.h"
#include "database/sqliteconnection.h"

#include <QDir>
#include <QImage>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QRegularExpression>
#include <QSettings>
#include <QSqlQuery>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

// The range and account of a produce or report run.
QStringList asUser(const QString &from, const QString &to, const QString &user,
                   const QString &password)
{
    return {u"--from"_s, from, u"--to"_s, to, u"--user"_s, user, u"--password"_s, password};
}

} // namespace

class TestCli : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void passwordRoundTrip();
    void produceCsv();
    void produceRespectsTheUsersLines();
    void produceShowsALossAsALossWithComparisons();
    void produceIsHonestAboutItsFigures();
    void refuses_data();
    void refuses();
    void reportPrintsEveryBenchmark_data();
    void reportPrintsEveryBenchmark();
    void reportHtmlKeepsItsPicture();
    void encodeGif();

private:
    CliRun run(const QStringList &arguments) { return runCli(arguments, m_dir.path()); }
    CliRun report(const QStringList &extra)
    {
        return run(QStringList{u"report"_s, u"--settings"_s, demoSettings()} +
                   asUser(u"2025-07"_s, u"2026-06"_s, u"manager"_s, u"manager1"_s) + extra);
    }
    QStringList produce(const QStringList &extra)
    {
        const CliRun done = run(QStringList{u"produce"_s, u"--settings"_s, demoSettings()} + extra);
        if (done.exitCode != 0)
            qWarning().noquote() << done.err;
        return done.exitCode == 0 ? done.lines() : QStringList{u"exit %1"_s.arg(done.exitCode)};
    }
    QString demoFolder();
    QString demoSettings() { return demoFolder() + u"/settings.ini"_s; }

    QTemporaryDir m_dir;
    bool m_demoMade = false;
};

QString TestCli::demoFolder()
{
    const QString folder = m_dir.filePath(u"demo"_s);
    if (!m_demoMade)
        m_demoMade = run({u"make-demo"_s, folder}).exitCode == 0;
    return folder;
}

void TestCli::produceCsv()
{
    const QStringList lines =
        produce(asUser(u"2025-07"_s, u"2026-06"_s, u"manager"_s, u"manager1"_s));
    QCOMPARE(lines.first(),
             u"slot,id,tab,order,label,type,display,signed,abs,benchmark,variant,band"_s);
    QCOMPARE(lines.size(), 1 + 123);
    // Ordered as the "All" tab: by Order, headings included.
    QVERIFY(lines.at(1).startsWith(u"0,9,1,1010,Key performance indicators,1,"_s));
    QSet<QString> bands;
    for (const QString &line : lines.mid(1)) {
        const QStringList cells = line.split(u',');
        if (cells.at(5) == u"3"_s)
            bands << cells.last();
    }
    // The demo shows every colour somewhere.
    QCOMPARE(bands, (QSet<QString>{u"0"_s, u"1"_s, u"2"_s}));
    // Money with grouping is quoted.
    QVERIFY(lines.join(u'\n').contains(u",\"$ "_s));
}

void TestCli::produceRespectsTheUsersLines()
{
    const QStringList lines =
        produce(asUser(u"2025-07"_s, u"2025-07"_s, u"WORKSHOP"_s, u"panel1"_s));
    QSet<QString> tabsWithValues;
    for (const QString &line : lines.mid(1)) {
        const QStringList cells = line.split(u',');
        if (cells.at(5) != u"1"_s)
            tabsWithValues << cells.at(2);
    }
    QCOMPARE(tabsWithValues, (QSet<QString>{u"1"_s, u"2"_s, u"5"_s}));
}

void TestCli::produceShowsALossAsALossWithComparisons()
{
    const QStringList lines = produce(
        asUser(u"2021-01"_s, u"2021-01"_s, u"manager"_s, u"manager1"_s) +
        QStringList{u"--compare"_s, u"periods"_s, u"--count"_s, u"2"_s, u"--format"_s, u"json"_s});
    const QJsonArray rows = QJsonDocument::fromJson(lines.join(u'\n').toUtf8()).array();
    QCOMPARE(rows.size(), 3 * 123);
    QCOMPARE(rows.first().toObject().value(u"slot"_s).toString(), u"0"_s);
    QCOMPARE(rows.last().toObject().value(u"slot"_s).toString(), u"2"_s);
    QStringList netProfit; // of each slot: shown, signed and absolute
    for (const QJsonValue &value : rows) {
        const QJsonObject row = value.toObject();
        if (row.value(u"order"_s).toString() == u"6380"_s &&
            row.value(u"label"_s).toString() == u"Net profit"_s) {
            netProfit << row.value(u"display"_s).toString() + u" "_s +
                             row.value(u"signed"_s).toString() + u" "_s +
                             row.value(u"abs"_s).toString();
        }
    }
    QCOMPARE(netProfit.size(), 3);
    QCOMPARE(netProfit.first(), u"$ -22,480.57 -22480.57 22480.57"_s);
    // The periods before are other months, with figures of their own.
    QVERIFY(netProfit[1] != netProfit[0] && netProfit[2] != netProfit[1]);
}

void TestCli::produceIsHonestAboutItsFigures()
{
    // A copy of the demo whose company file has lost its journal.
    const QString folder = m_dir.filePath(u"broken"_s);
    QVERIFY(QDir().mkpath(folder));
    const QString companyFile = folder + u"/books.myo"_s;
    QVERIFY(QFile::copy(demoFolder() + u"/Harbour Panel & Paint.myo"_s, companyFile));
    {
        SqliteConnection connection;
        QVERIFY(!connection.open(companyFile));
        QVERIFY(QSqlQuery(connection.database()).exec(u"DROP TABLE JournalRecords"_s));
    }
    const QString settings = folder + u"/settings.ini"_s;
    QVERIFY(QFile::copy(demoSettings(), settings));
    QSettings(settings, QSettings::IniFormat)
        .setValue(u"SOFTWARE/Veltrix/AccFilePath"_s, companyFile);
    const QStringList arguments = QStringList{u"produce"_s, u"--settings"_s, settings} +
                                  asUser(u"2025-07"_s, u"2025-07"_s, u"manager"_s, u"manager1"_s);
    const CliRun broken = run(arguments);
    QCOMPARE(broken.exitCode, 3);
    QVERIFY2(broken.err.contains(u"could not be read completely"_s), qPrintable(broken.err));
    QCOMPARE(broken.out, QString());

    // The range is written to the user's settings only when asked; the password may come from
    // a file or the environment instead of the command line.
    QSettings(settings, QSettings::IniFormat)
        .setValue(u"SOFTWARE/Veltrix/AccFilePath"_s,
                  demoFolder() + u"/Harbour Panel & Paint.myo"_s);
    const auto contentOf = [&settings] {
        QFile file(settings);
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    };
    const QByteArray before = contentOf();
    const QString passwordFile = folder + u"/password"_s;
    QFile file(passwordFile);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write("manager1\n");
    file.close();
    QCOMPARE(run(arguments.mid(0, 9) << u"--password-file"_s << passwordFile).exitCode, 0);
    QCOMPARE(contentOf(), before);
    qputenv("VELTRIX_PASSWORD", "manager1");
    const CliRun remembered =
        run({u"produce"_s, u"--settings"_s, settings, u"--from"_s, u"2019-03"_s, u"--to"_s,
             u"2019-03"_s, u"--user"_s, u"manager"_s, u"--remember"_s});
    qunsetenv("VELTRIX_PASSWORD");
    QCOMPARE(remembered.exitCode, 0);
    QCOMPARE(QSettings(settings, QSettings::IniFormat).value(u"SOFTWARE/Veltrix/Y1"_s).toString(),
             u"2019"_s);
}

void TestCli::refuses_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QString>("message"); // part of what is written to standard error
    const QString usage = u"usage: veltrix-cli"_s;
    QTest::newRow("no verb") << QStringList() << 2 << usage;
    QTest::newRow("unknown verb") << QStringList{u"frobnicate"_s} << 2 << usage;
    QTest::newRow("missing argument") << QStringList{u"encrypt-password"_s} << 2 << usage;
    QTest::newRow("password typed in clear") << QStringList{u"decrypt-password"_s, u"in-clear"_s}
                                             << 1 << u"Failed decoding the text (Error 33)"_s;

    const QStringList produce{u"produce"_s, u"--settings"_s, demoSettings()};
    const QString notAMonth = u"in a year from 1950"_s;
    QTest::newRow("wrong password")
        << produce + asUser(u"2025-07"_s, u"2025-07"_s, u"manager"_s, u"nope"_s) << 2
        << u"Login failed! Ensure your username and password are correct!"_s;
    QTest::newRow("range backwards")
        << produce + asUser(u"2025-07"_s, u"2025-06"_s, u"sysop"_s, u"sysop"_s) << 2
        << u"The selected date range is invalid!"_s;
    QTest::newRow("year before the first")
        << produce + asUser(u"1949-12"_s, u"2025-06"_s, u"sysop"_s, u"sysop"_s) << 2 << notAMonth;
    QTest::newRow("month 13")
        << produce + asUser(u"2025-13"_s, u"2025-06"_s, u"sysop"_s, u"sysop"_s).mid(0, 6) << 2
        << notAMonth;
    QTest::newRow("unreadable password file")
        << produce + asUser(u"2025-07"_s, u"2025-07"_s, u"sysop"_s, QString()).mid(0, 6) +
               QStringList{u"--password-file"_s, u"/no/such/file"_s}
        << 2 << u"cannot read the password file /no/such/file"_s;

    const QStringList report = QStringList{u"report"_s, u"--settings"_s, demoSettings()} +
                               asUser(u"2025-07"_s, u"2026-06"_s, u"manager"_s, u"manager1"_s);
    const QString notAPage = u"--out names a .html or .pdf file"_s;
    QTest::newRow("report: tab 7")
        << report + QStringList{u"--tab"_s, u"7"_s, u"--out"_s, u"x.pdf"_s} << 2
        << u"--tab is a number from 0 to 6"_s;
    QTest::newRow("report: no out") << report << 2 << notAPage;
    QTest::newRow("report: compare decades")
        << report + QStringList{u"--compare"_s, u"decades"_s, u"--out"_s, u"x.pdf"_s} << 2
        << u"--compare is years or periods"_s;
    QTest::newRow("report: no settings")
        << report + QStringList{u"--settings"_s, u"/no/such/settings.ini"_s, u"--out"_s, u"x.pdf"_s}
        << 2 << u"there is no settings file at /no/such/settings.ini"_s;

    QTest::newRow("gif: bad colour")
        << QStringList{u"encode-gif"_s, u"a.png"_s, u"b.gif"_s, u"--transparent"_s, u"white"_s} << 2
        << u"RRGGBB"_s;
    QTest::newRow("gif: missing picture")
        << QStringList{u"encode-gif"_s, u"no-such.png"_s, u"b.gif"_s} << 1
        << u"cannot read no-such.png"_s;
}

void TestCli::refuses()
{
    QFETCH(QStringList, arguments);
    QFETCH(int, exitCode);
    QFETCH(QString, message);
    const CliRun refused = run(arguments);
    QCOMPARE(refused.exitCode, exitCode);
    QVERIFY2(refused.err.contains(message), qPrintable(refused.err));
    QCOMPARE(refused.out, QString());
}

namespace {

QString runTool(const QString &name, const QStringList &arguments)
{
    QProcess process;
    process.start(QStandardPaths::findExecutable(name), arguments);
    process.waitForFinished(60000);
    return QString::fromUtf8(process.readAllStandardOutput());
}

// The topmost row holding a pixel of about that colour, or -1.
int firstRowWith(const QImage &image, QRgb colour)
{
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            const QRgb p = image.pixel(x, y);
            if (std::abs(qRed(p) - qRed(colour)) < 8 && std::abs(qGreen(p) - qGreen(colour)) < 8 &&
                std::abs(qBlue(p) - qBlue(colour)) < 8)
                return y;
        }
    }
    return -1;
}

} // namespace

void TestCli::reportPrintsEveryBenchmark_data()
{
    QTest::addColumn<QString>("tab");
    QTest::addColumn<int>("benchmarks"); // percentage rows of the tab
    QTest::addColumn<QString>("title");
    QTest::newRow("Summary") << u"1"_s << 7 << u"Summary: 1/7/25 to 30/6/26"_s;
    QTest::newRow("Paint, every benchmark an at-most one")
        << u"4"_s << 8 << u"Paint: 1/7/25 to 30/6/26"_s;
    QTest::newRow("all tabs, on three pages") << u"0"_s << 33 << u"All: 1/7/25 to 30/6/26"_s;
}

void TestCli::reportPrintsEveryBenchmark()
{
    QFETCH(QString, tab);
    QFETCH(int, benchmarks);
    QFETCH(QString, title);
    if (QStandardPaths::findExecutable(u"pdftoppm"_s).isEmpty())
        QFAIL("pdftotext and pdftoppm (poppler-utils) are needed; scripts/install-deps installs "
              "them");
    const QString pdf = m_dir.filePath(u"tab%1.pdf"_s.arg(tab));
    const CliRun done = report({u"--tab"_s, tab, u"--out"_s, pdf});
    QVERIFY2(done.exitCode == 0, qPrintable(done.err));
    const QString text = runTool(u"pdftotext"_s, {u"-layout"_s, pdf, u"-"_s});
    if (tab == u"1"_s) {
        // The text engine may set "fi" as one ligature glyph.
        for (const QString &part : {u"Panel labour gross pro"_s, u"KEY PERFORMANCE INDICATORS"_s,
                                    u"48.2%"_s, u"Page 1 of 1"_s})
            QVERIFY2(text.contains(part), qPrintable(part));
        // The graph stands below the grid.
        const QString prefix = m_dir.filePath(u"summary-page"_s);
        runTool(u"pdftoppm"_s, {u"-png"_s, u"-r"_s, u"60"_s, u"-f"_s, u"1"_s, u"-l"_s, u"1"_s,
                                u"-singlefile"_s, pdf, prefix});
        const QImage page(prefix + u".png"_s);
        const int heading = firstRowWith(page, qRgb(0xDD, 0x68, 0x00)); // the grid's headings
        const int bar = firstRowWith(page, qRgb(192, 255, 64));         // a green bar, reduced
        QVERIFY(heading >= 0);
        QVERIFY(bar > heading);
    }
    static const QRegularExpression benchmark(u"[<>][0-9.]+%"_s);
    QCOMPARE(text.count(benchmark), benchmarks);
    // Every page names the tab and the range and repeats the column headings.
    const int pages = int(text.count(u'\f'));
    QVERIFY(pages >= 1);
    QCOMPARE(text.count(title), pages);
    QCOMPARE(text.count(u"Optimal %"_s), pages);
}

void TestCli::reportHtmlKeepsItsPicture()
{
    const QString html = m_dir.filePath(u"compare.html"_s);
    const CliRun done =
        report({u"--compare"_s, u"years"_s, u"--count"_s, u"2"_s, u"--out"_s, html});
    QVERIFY2(done.exitCode == 0, qPrintable(done.err));
    const auto read = [](const QString &path) {
        QFile file(path);
        return file.open(QIODevice::ReadOnly) ? QString::fromUtf8(file.readAll()) : QString();
    };
    const QString page = read(html);
    const QString picture = m_dir.filePath(u"compare.bmp"_s);
    QVERIFY(page.startsWith(u"<html>\r\n<body bgcolor='#ffffff'"_s));
    for (const QString &part : {u"Jul 23 - Jun 24"_s, u"Jul 25 - Jun 26"_s, u">Average</td>"_s,
                                u"<img src='"_s + picture + u"'>"_s})
        QVERIFY2(page.contains(part), qPrintable(part));
    QVERIFY(!QImage(picture).isNull());

    const QString grid = m_dir.filePath(u"labour.html"_s);
    QCOMPARE(report({u"--tab"_s, u"2"_s, u"--out"_s, grid}).exitCode, 0);
    QVERIFY(read(grid).contains(u"</table>"_s));
    QVERIFY(!read(grid).contains(u"<img"_s));
}

void TestCli::encodeGif()
{
    QImage picture(40, 12, QImage::Format_RGB32);
    picture.fill(Qt::white);
    const QString png = m_dir.filePath(u"picture.png"_s);
    const QString gif = m_dir.filePath(u"picture.gif"_s);
    QVERIFY(picture.save(png));
    const CliRun done = run({u"encode-gif"_s, png, gif, u"--transparent"_s, u"FFFFFF"_s});
    QVERIFY2(done.exitCode == 0, qPrintable(done.err));
    QFile file(gif);
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QByteArray bytes = file.readAll();
    QVERIFY(bytes.startsWith("GIF89a"));
    QCOMPARE(quint8(bytes[787]), 124); // white is the transparent entry
    const QImage decoded = QImage(gif).convertToFormat(QImage::Format_ARGB32);
    QCOMPARE(decoded.size(), picture.size());
    QCOMPARE(qAlpha(decoded.pixel(0, 0)), 0);
}

void TestCli::passwordRoundTrip()
{
    const QString password = u"O'Brien caf\u00e9 7"_s;
    const CliRun encrypted = run({u"encrypt-password"_s, password});
    QCOMPARE(encrypted.exitCode, 0);
    const QString stored = encrypted.out.trimmed();
    QVERIFY(!stored.isEmpty());
    QVERIFY(stored != password);
    // What the tool writes and what the program stores both read back.
    for (const QString &value :
         {stored, PasswordCipher().encryptText(password, Settings::PasswordKey)}) {
        const CliRun decrypted = run({u"decrypt-password"_s, value});
        QCOMPARE(decrypted.exitCode, 0);
        QCOMPARE(decrypted.out, password + u'\n');
    }
}

QTEST_GUILESS_MAIN(TestCli)
#include "tst_cli.moc"
