// Veltrix — KPI dashboard for small businesses.
#include "cipher/passwordcipher.h"
#include "common/settings.h"

#include "database/sqliteconnection.h"
#include "sources/companyfile.h"

#include <QCryptographicHash>
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

struct Run
{
    int exitCode = -1;
    QString out;
    QString err;
};

// Keeps the tool's per-user files (settings, data folder) inside the test.
QTemporaryDir &home()
{
    static QTemporaryDir dir;
    return dir;
}

Run runCli(const QStringList &arguments)
{
    QProcess process;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(u"XDG_CONFIG_HOME"_s, home().filePath(u"config"_s));
    environment.insert(u"XDG_DATA_HOME"_s, home().filePath(u"data"_s));
    process.setProcessEnvironment(environment);
    process.start(QStringLiteral(VELTRIX_CLI), arguments);
    Run run;
    if (!process.waitForFinished(120000))
        return run;
    run.exitCode = process.exitCode();
    run.out = QString::fromUtf8(process.readAllStandardOutput());
    run.err = QString::fromUtf8(process.readAllStandardError());
    return run;
}

} // namespace

class TestCli : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void passwordRoundTrip_data();
    void passwordRoundTrip();
    void decryptsWhatTheProgramStores();
    void undecipherableValueFails();
    void badUsage_data();
    void badUsage();
    void demoIsTheSameEveryTime();
    void produceCsv();
    void produceJsonWithComparison();
    void produceRespectsTheUsersLines();
    void produceShowsALossAsALoss();
    void produceIsHonestAboutItsFigures();
    void produceRefuses_data();
    void produceRefuses();
    void reportPdfShowsTitleGridAndGraph();
    void reportPrintsEveryBenchmark_data();
    void reportPrintsEveryBenchmark();
    void reportHtmlKeepsItsPicture();
    void reportRefuses_data();
    void reportRefuses();
    void encodeGif();
    void encodeGifRefuses_data();
    void encodeGifRefuses();

private:
    Run report(const QStringList &extra)
    {
        return runCli(QStringList{u"report"_s, u"--settings"_s, demoFolder() + u"/settings.ini"_s,
                                  u"--from"_s, u"2025-07"_s, u"--to"_s, u"2026-06"_s, u"--user"_s,
                                  u"manager"_s, u"--password"_s, u"manager1"_s} +
                      extra);
    }

    QString demoFolder();
    QStringList produce(const QStringList &extra, int expectedExit = 0);

    QTemporaryDir m_dir;
    bool m_demoMade = false;
};

QString TestCli::demoFolder()
{
    const QString folder = m_dir.filePath(u"demo"_s);
    if (!m_demoMade) {
        const Run run = runCli({u"make-demo"_s, folder});
        m_demoMade = run.exitCode == 0;
    }
    return folder;
}

QStringList TestCli::produce(const QStringList &extra, int expectedExit)
{
    const Run run = runCli(
        QStringList{u"produce"_s, u"--settings"_s, demoFolder() + u"/settings.ini"_s} + extra);
    if (run.exitCode != expectedExit)
        qWarning().noquote() << run.err;
    return run.exitCode == expectedExit ? run.out.split(u'\n', Qt::SkipEmptyParts)
                                        : QStringList{u"exit %1"_s.arg(run.exitCode)};
}

namespace {

QByteArray journalDigest(const QString &companyFile)
{
    SqliteConnection connection;
    if (CompanyFile::open(connection, companyFile))
        return {};
    QSqlQuery query(connection.database());
    query.exec(
        u"SELECT a.AccountNumber, j.TransactionDate, j.TaxExclusiveAmount, j.Memo "
        u"FROM JournalRecords j JOIN Accounts a USING (AccountID) ORDER BY j.JournalRecordID"_s);
    QCryptographicHash hash(QCryptographicHash::Sha256);
    int rows = 0;
    while (query.next()) {
        for (int i = 0; i < 4; ++i)
            hash.addData(query.value(i).toString().toUtf8() + '\t');
        ++rows;
    }
    return rows > 10000 ? hash.result().toHex() : QByteArray();
}

} // namespace

void TestCli::demoIsTheSameEveryTime()
{
    const QString again = m_dir.filePath(u"demo-again"_s);
    QCOMPARE(runCli({u"make-demo"_s, again}).exitCode, 0);
    const QString name = u"/Harbour Panel & Paint.myo"_s;
    const QByteArray first = journalDigest(demoFolder() + name);
    QVERIFY(!first.isEmpty());
    QCOMPARE(journalDigest(again + name), first);
}

void TestCli::produceCsv()
{
    const QStringList lines = produce({u"--from"_s, u"2025-07"_s, u"--to"_s, u"2026-06"_s,
                                       u"--user"_s, u"manager"_s, u"--password"_s, u"manager1"_s});
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

void TestCli::produceJsonWithComparison()
{
    const QStringList lines =
        produce({u"--from"_s, u"2025-01"_s, u"--to"_s, u"2025-03"_s, u"--user"_s, u"manager"_s,
                 u"--password"_s, u"manager1"_s, u"--compare"_s, u"periods"_s, u"--count"_s, u"2"_s,
                 u"--format"_s, u"json"_s});
    const QJsonArray rows = QJsonDocument::fromJson(lines.join(u'\n').toUtf8()).array();
    QCOMPARE(rows.size(), 3 * 123);
    QCOMPARE(rows.first().toObject().value(u"slot"_s).toString(), u"0"_s);
    QCOMPARE(rows.last().toObject().value(u"slot"_s).toString(), u"2"_s);
    double totalSales[3] = {};
    for (const QJsonValue &value : rows) {
        const QJsonObject row = value.toObject();
        if (row.value(u"id"_s).toString() == u"79"_s)
            totalSales[row.value(u"slot"_s).toString().toInt()] =
                row.value(u"signed"_s).toString().toDouble();
    }
    QVERIFY(totalSales[0] > 100000.0);
    QVERIFY(totalSales[1] > 100000.0);
    QVERIFY(totalSales[0] != totalSales[1]);
}

void TestCli::produceRespectsTheUsersLines()
{
    const QStringList lines = produce({u"--from"_s, u"2025-07"_s, u"--to"_s, u"2025-07"_s,
                                       u"--user"_s, u"WORKSHOP"_s, u"--password"_s, u"panel1"_s});
    QSet<QString> tabsWithValues;
    for (const QString &line : lines.mid(1)) {
        const QStringList cells = line.split(u',');
        if (cells.at(5) != u"1"_s)
            tabsWithValues << cells.at(2);
    }
    QCOMPARE(tabsWithValues, (QSet<QString>{u"1"_s, u"2"_s, u"5"_s}));
}

void TestCli::produceShowsALossAsALoss()
{
    const QStringList lines = produce({u"--from"_s, u"2021-01"_s, u"--to"_s, u"2021-01"_s,
                                       u"--user"_s, u"manager"_s, u"--password"_s, u"manager1"_s});
    const QString netProfit = lines.filter(u",6380,Net profit,5,"_s).value(0);
    QVERIFY2(netProfit.contains(u",\"$ -22,480.57\",-22480.57,22480.57,"_s), qPrintable(netProfit));
}

void TestCli::produceRefuses_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<QString>("message");
    QTest::newRow("wrong password")
        << QStringList{u"--from"_s, u"2025-07"_s, u"--to"_s,       u"2025-07"_s,
                       u"--user"_s, u"manager"_s, u"--password"_s, u"nope"_s}
        << u"Login failed! Ensure your username and password are correct!"_s;
    QTest::newRow("range backwards")
        << QStringList{u"--from"_s, u"2025-07"_s, u"--to"_s,       u"2025-06"_s,
                       u"--user"_s, u"sysop"_s,   u"--password"_s, u"sysop"_s}
        << u"The selected date range is invalid!"_s;
    QTest::newRow("year before the first")
        << QStringList{u"--from"_s, u"1949-12"_s, u"--to"_s,       u"2025-06"_s,
                       u"--user"_s, u"sysop"_s,   u"--password"_s, u"sysop"_s}
        << u"in a year from 1950"_s;
    QTest::newRow("negative year")
        << QStringList{u"--from"_s, u"-0001-01"_s, u"--to"_s,       u"2025-06"_s,
                       u"--user"_s, u"sysop"_s,    u"--password"_s, u"sysop"_s}
        << u"in a year from 1950"_s;
    QTest::newRow("month 13") << QStringList{u"--from"_s,  u"2025-13"_s, u"--to"_s,
                                             u"2025-06"_s, u"--user"_s,  u"sysop"_s}
                              << u"in a year from 1950"_s;
    QTest::newRow("unreadable password file")
        << QStringList{u"--from"_s,          u"2025-07"_s,      u"--to"_s,
                       u"2025-07"_s,         u"--user"_s,       u"sysop"_s,
                       u"--password-file"_s, u"/no/such/file"_s}
        << u"cannot read the password file /no/such/file"_s;
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
    QVERIFY(QFile::copy(demoFolder() + u"/settings.ini"_s, settings));
    QSettings(settings, QSettings::IniFormat)
        .setValue(u"SOFTWARE/Veltrix/AccFilePath"_s, companyFile);
    const QStringList arguments{u"produce"_s, u"--settings"_s, settings,     u"--from"_s,
                                u"2025-07"_s, u"--to"_s,       u"2025-07"_s, u"--user"_s,
                                u"manager"_s, u"--password"_s, u"manager1"_s};
    const Run broken = runCli(arguments);
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
    QStringList fromFile = arguments.mid(0, 9);
    fromFile << u"--password-file"_s << passwordFile;
    QCOMPARE(runCli(fromFile).exitCode, 0);
    QCOMPARE(contentOf(), before);
    qputenv("VELTRIX_PASSWORD", "manager1");
    const Run remembered =
        runCli({u"produce"_s, u"--settings"_s, settings, u"--from"_s, u"2019-03"_s, u"--to"_s,
                u"2019-03"_s, u"--user"_s, u"manager"_s, u"--remember"_s});
    qunsetenv("VELTRIX_PASSWORD");
    QCOMPARE(remembered.exitCode, 0);
    QCOMPARE(QSettings(settings, QSettings::IniFormat).value(u"SOFTWARE/Veltrix/Y1"_s).toString(),
             u"2019"_s);
}

void TestCli::produceRefuses()
{
    QFETCH(QStringList, arguments);
    QFETCH(QString, message);
    const Run run = runCli(
        QStringList{u"produce"_s, u"--settings"_s, demoFolder() + u"/settings.ini"_s} + arguments);
    QCOMPARE(run.exitCode, 2);
    QVERIFY2(run.err.contains(message), qPrintable(run.err));
    QCOMPARE(run.out, QString());
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

void TestCli::reportPdfShowsTitleGridAndGraph()
{
    if (QStandardPaths::findExecutable(u"pdftoppm"_s).isEmpty())
        QFAIL("pdftotext and pdftoppm (poppler-utils) are needed; scripts/install-deps installs "
              "them");
    const QString pdf = m_dir.filePath(u"summary.pdf"_s);
    const Run run = report({u"--out"_s, pdf});
    QVERIFY2(run.exitCode == 0, qPrintable(run.err));

    const QString text = runTool(u"pdftotext"_s, {u"-layout"_s, pdf, u"-"_s});
    QVERIFY2(text.contains(u"1/7/25 to 30/6/26"_s), qPrintable(text));
    // The text engine may set "fi" as one ligature glyph.
    QVERIFY(text.contains(u"Panel labour gross pro"_s));
    QVERIFY(text.contains(u"KEY PERFORMANCE INDICATORS"_s));
    QVERIFY(text.contains(u"48.2%"_s));
    QVERIFY(text.contains(u"Page 1 of 1"_s));

    const QString prefix = m_dir.filePath(u"summary-page"_s);
    runTool(u"pdftoppm"_s, {u"-png"_s, u"-r"_s, u"60"_s, u"-f"_s, u"1"_s, u"-l"_s, u"1"_s,
                            u"-singlefile"_s, pdf, prefix});
    const QImage page(prefix + u".png"_s);
    QVERIFY(!page.isNull());
    const int heading = firstRowWith(page, qRgb(0xDD, 0x68, 0x00)); // the grid's headings
    const int bar = firstRowWith(page, qRgb(192, 255, 64));         // a green bar, reduced
    QVERIFY(heading >= 0);
    QVERIFY(bar >= 0);
    QVERIFY(bar > heading); // the graph stands below the grid
}

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
    const QString pdf = m_dir.filePath(u"tab%1.pdf"_s.arg(tab));
    const Run run = report({u"--tab"_s, tab, u"--out"_s, pdf});
    QVERIFY2(run.exitCode == 0, qPrintable(run.err));
    const QString text = runTool(u"pdftotext"_s, {u"-layout"_s, pdf, u"-"_s});
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
    const Run run = report({u"--compare"_s, u"years"_s, u"--count"_s, u"2"_s, u"--out"_s, html});
    QVERIFY2(run.exitCode == 0, qPrintable(run.err));
    QFile file(html);
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QString page = QString::fromUtf8(file.readAll());
    const QString picture = m_dir.filePath(u"compare.bmp"_s);
    QVERIFY(page.startsWith(u"<html>\r\n<body bgcolor='#ffffff'"_s));
    QVERIFY(page.contains(u"Jul 23 - Jun 24"_s));
    QVERIFY(page.contains(u"Jul 25 - Jun 26"_s));
    QVERIFY(page.contains(u">Average</td>"_s));
    QVERIFY(page.contains(u"<img src='"_s + picture + u"'>"_s));
    QVERIFY(!QImage(picture).isNull());

    const QString grid = m_dir.filePath(u"labour.html"_s);
    QCOMPARE(report({u"--tab"_s, u"2"_s, u"--out"_s, grid}).exitCode, 0);
    QFile labour(grid);
    QVERIFY(labour.open(QIODevice::ReadOnly));
    QVERIFY(!labour.readAll().contains("<img"));
}

void TestCli::reportRefuses_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<QString>("message");
    QTest::newRow("tab") << QStringList{u"--tab"_s, u"7"_s, u"--out"_s, u"x.pdf"_s}
                         << u"--tab is a number from 0 to 6"_s;
    QTest::newRow("no out") << QStringList{} << u"--out names a .html or .pdf file"_s;
    QTest::newRow("text out") << QStringList{u"--out"_s, u"x.txt"_s}
                              << u"--out names a .html or .pdf file"_s;
    QTest::newRow("compare") << QStringList{u"--compare"_s, u"decades"_s, u"--out"_s, u"x.pdf"_s}
                             << u"--compare is years or periods"_s;
    QTest::newRow("settings") << QStringList{u"--settings"_s, u"/no/such/settings.ini"_s,
                                             u"--out"_s, u"x.pdf"_s}
                              << u"there is no settings file at /no/such/settings.ini"_s;
}

void TestCli::reportRefuses()
{
    QFETCH(QStringList, arguments);
    QFETCH(QString, message);
    const Run run = report(arguments);
    QCOMPARE(run.exitCode, 2);
    QVERIFY2(run.err.contains(message), qPrintable(run.err));
}

void TestCli::encodeGif()
{
    QImage picture(40, 12, QImage::Format_RGB32);
    picture.fill(Qt::white);
    for (int x = 10; x < 30; ++x) {
        for (int y = 2; y < 10; ++y)
            picture.setPixel(x, y, qRgb(200, 60, 20));
    }
    const QString png = m_dir.filePath(u"picture.png"_s);
    const QString gif = m_dir.filePath(u"picture.gif"_s);
    QVERIFY(picture.save(png));
    const Run run = runCli({u"encode-gif"_s, png, gif, u"--transparent"_s, u"FFFFFF"_s});
    QVERIFY2(run.exitCode == 0, qPrintable(run.err));
    QFile file(gif);
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QByteArray bytes = file.readAll();
    QVERIFY(bytes.startsWith("GIF89a"));
    QCOMPARE(quint8(bytes[787]), 124); // white is the transparent entry
    const QImage decoded = QImage(gif).convertToFormat(QImage::Format_ARGB32);
    QCOMPARE(decoded.size(), picture.size());
    QCOMPARE(qAlpha(decoded.pixel(0, 0)), 0);
    QCOMPARE(decoded.pixel(15, 5), qRgb(192, 64, 0));
}

void TestCli::encodeGifRefuses_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QString>("message");
    QTest::newRow("one file") << QStringList{u"a.png"_s} << 2 << u"usage"_s;
    QTest::newRow("bad colour") << QStringList{u"a.png"_s, u"b.gif"_s, u"--transparent"_s,
                                               u"white"_s}
                                << 2 << u"RRGGBB"_s;
    QTest::newRow("missing picture")
        << QStringList{u"no-such.png"_s, u"b.gif"_s} << 1 << u"cannot read no-such.png"_s;
}

void TestCli::encodeGifRefuses()
{
    QFETCH(QStringList, arguments);
    QFETCH(int, exitCode);
    QFETCH(QString, message);
    const Run run = runCli(QStringList{u"encode-gif"_s} + arguments);
    QCOMPARE(run.exitCode, exitCode);
    QVERIFY2(run.err.contains(message), qPrintable(run.err));
}

void TestCli::passwordRoundTrip_data()
{
    QTest::addColumn<QString>("password");
    QTest::newRow("plain") << u"Sp@nner 7"_s;
    QTest::newRow("quote and accent") << u"O'Brien caf\u00e9"_s;
}

void TestCli::passwordRoundTrip()
{
    QFETCH(QString, password);
    const Run encrypted = runCli({u"encrypt-password"_s, password});
    QCOMPARE(encrypted.exitCode, 0);
    const QString stored = encrypted.out.trimmed();
    QVERIFY(!stored.isEmpty());
    QVERIFY(stored != password);

    const Run decrypted = runCli({u"decrypt-password"_s, stored});
    QCOMPARE(decrypted.exitCode, 0);
    QCOMPARE(decrypted.out, password + u'\n');
}

void TestCli::decryptsWhatTheProgramStores()
{
    const QString stored = PasswordCipher().encryptText(u"garage"_s, Settings::PasswordKey);
    const Run run = runCli({u"decrypt-password"_s, stored});
    QCOMPARE(run.exitCode, 0);
    QCOMPARE(run.out.trimmed(), u"garage"_s);
}

void TestCli::undecipherableValueFails()
{
    const Run run = runCli({u"decrypt-password"_s, u"typed-in-clear"_s});
    QCOMPARE(run.exitCode, 1);
    QCOMPARE(run.out, QString());
    QCOMPARE(run.err.trimmed(), u"Failed decoding the text (Error 33)"_s);
}

void TestCli::badUsage_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::newRow("no verb") << QStringList();
    QTest::newRow("unknown verb") << QStringList{u"frobnicate"_s};
    QTest::newRow("missing argument") << QStringList{u"encrypt-password"_s};
    QTest::newRow("extra argument") << QStringList{u"decrypt-password"_s, u"a"_s, u"b"_s};
}

void TestCli::badUsage()
{
    QFETCH(QStringList, arguments);
    const Run run = runCli(arguments);
    QCOMPARE(run.exitCode, 2);
    QVERIFY(run.err.contains(u"usage: veltrix-cli"_s));
}

QTEST_GUILESS_MAIN(TestCli)
#include "tst_cli.moc"
