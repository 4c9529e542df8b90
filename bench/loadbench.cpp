// Veltrix — KPI dashboard for small businesses.
// Loading date ranges from a large company file: 1,000,000 journal lines over ten years and
// 200 accounts. Times a one-year load and a four-year comparison through the program's own
// code, then the same SQL texts run directly through the SQLite C API (the floor no program
// can beat), and prints both and their ratio. Targets: ratio at most 1.15, one-year load
// under 60 ms.

#include "app/appcontext.h"
#include "app/contextwiring.h"
#include "app/mainconnector.h"
#include "app/settingsloader.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"
#include "engine/rangeloader.h"
#include "sources/companyfile.h"
#include "sources/companyfilewriter.h"
#include "sources/myobsource.h"

#include <QCoreApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QTemporaryDir>
#include <QTextStream>

#include <sqlite3.h>

#include <algorithm>

using namespace Qt::StringLiterals;

namespace {

const int JournalLines = qEnvironmentVariableIntValue("LOADBENCH_LINES") > 0
                             ? qEnvironmentVariableIntValue("LOADBENCH_LINES")
                             : 1000000;
constexpr int AccountCount = 200;
const QDate FirstDay(2016, 1, 1);
const QDate LastDay(2025, 12, 31);

quint64 nextRandom(quint64 &state)
{
    quint64 z = (state += 0x9E3779B97F4A7C15ull);
    z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
    z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
    return z ^ (z >> 31);
}

// The account codes the catalogue reads, in the order the loader asks for them.
QStringList catalogueCodes(MainDatabase &database)
{
    QStringList codes;
    RecordSet &fields = database.fieldsRecordset();
    for (fields.moveFirst(); !fields.eof(); fields.moveNext()) {
        if (fields.value(u"Type"_s).toInt() != 2)
            continue;
        const QStringList parts = fields.value(u"Data"_s).toString().split(u'+');
        for (const QString &part : parts)
            codes << part.trimmed();
    }
    return codes;
}

bool writeCompanyFile(const QString &path, const QStringList &codes)
{
    CompanyFileWriter writer;
    if (writer.create(path))
        return false;
    QStringList numbers = codes;
    numbers.removeDuplicates();
    for (int i = 0; numbers.size() < AccountCount; ++i)
        numbers << u"8-%1"_s.arg(1000 + i);
    QList<qint64> ids;
    for (const QString &number : std::as_const(numbers))
        ids << writer.addAccount(number, u"Account "_s + number);

    quint64 state = 42;
    const qint64 days = FirstDay.daysTo(LastDay) + 1;
    for (int i = 0; i < JournalLines; ++i) {
        const qint64 account = ids.at(int(nextRandom(state) % ids.size()));
        const QDate day = FirstDay.addDays(qint64(nextRandom(state) % days));
        const double amount = double(qint64(nextRandom(state) % 200000) - 100000) / 100.0;
        writer.addJournalLine(account, day, amount);
    }
    for (QDate day = FirstDay; day <= LastDay; day = day.addDays(1)) {
        for (int sale = 0; sale < 4; ++sale)
            writer.addSale(day, u"S"_s + day.toString(Qt::ISODate) + QString::number(sale));
    }
    return !writer.finish();
}

// The two account queries per code and the sales count, exactly as the source sends them,
// straight through SQLite.
double floorLoad(sqlite3 *db, const QStringList &codes, const QDate &from, const QDate &to)
{
    double checksum = 0.0;
    const QString fromText = MyobSource::sqlDate(from);
    const QString toText = MyobSource::sqlDate(to);
    for (const QString &code : codes) {
        sqlite3_stmt *statement = nullptr;
        const QByteArray account =
            (u"SELECT * FROM Accounts WHERE AccountNumber LIKE '"_s + code + u"'"_s).toUtf8();
        sqlite3_prepare_v2(db, account.constData(), -1, &statement, nullptr);
        qint64 id = -1;
        if (sqlite3_step(statement) == SQLITE_ROW)
            id = sqlite3_column_int64(statement, 0);
        sqlite3_finalize(statement);
        if (id < 0)
            continue;
        const QByteArray total =
            (u"SELECT SUM(TaxExclusiveAmount) As Total FROM JournalRecords WHERE AccountID='"_s +
             QString::number(id) + u"' AND TransactionDate BETWEEN '"_s + fromText + u"' AND '"_s +
             toText + u"'"_s)
                .toUtf8();
        sqlite3_prepare_v2(db, total.constData(), -1, &statement, nullptr);
        if (sqlite3_step(statement) == SQLITE_ROW)
            checksum += sqlite3_column_double(statement, 0);
        sqlite3_finalize(statement);
    }
    sqlite3_stmt *statement = nullptr;
    const QByteArray sales =
        (u"SELECT * FROM Sales WHERE Date BETWEEN '"_s + fromText + u"' AND '"_s + toText + u"'"_s)
            .toUtf8();
    sqlite3_prepare_v2(db, sales.constData(), -1, &statement, nullptr);
    int count = 0;
    while (sqlite3_step(statement) == SQLITE_ROW)
        ++count;
    sqlite3_finalize(statement);
    return checksum + count;
}

double median(QList<double> values)
{
    std::sort(values.begin(), values.end());
    return values.at(values.size() / 2);
}

} // namespace

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    const int rounds = argc > 1 ? QString::fromLocal8Bit(argv[1]).toInt() : 15;
    QTextStream out(stdout);

    QTemporaryDir root;
    const QString appFolder = root.filePath(u"app/"_s);
    QDir().mkpath(appFolder);
    QFile::copy(QStringLiteral(VELTRIX_NEW_DB), appFolder + u"new.db"_s);
    const QString companyFile = root.filePath(u"large.myo"_s);
    {
        SettingsStore store(root.filePath(u"settings.ini"_s));
        store.writeSetting(u"AccPackage"_s, u"MYOB"_s);
        store.writeSetting(u"AccFileDriver"_s, u"SQLite"_s);
        store.writeSetting(u"AccFilePath"_s, companyFile);
    }

    RecordingPrompter prompter;
    AppContext context(std::make_unique<SettingsStore>(root.filePath(u"settings.ini"_s)), prompter,
                       AppLocations::inFolder(appFolder));
    if (!loadSettings(context).isEmpty() || !connectMainDatabase(context).isEmpty()) {
        QTextStream(stderr) << "start-up failed" << Qt::endl;
        return 1;
    }
    const QStringList codes = catalogueCodes(context.mainDatabase());

    QElapsedTimer timer;
    timer.start();
    if (!writeCompanyFile(companyFile, codes)) {
        QTextStream(stderr) << "cannot write the company file" << Qt::endl;
        return 1;
    }
    out << "company file: " << JournalLines << " journal lines, " << AccountCount << " accounts, "
        << FirstDay.toString(Qt::ISODate) << " to " << LastDay.toString(Qt::ISODate)
        << ", built in " << timer.elapsed() << " ms\n";
    out << "account codes per load: " << codes.size() << "\n";

    context.setAccountingSource(std::make_unique<MyobSource>(context.settings(), prompter));
    context.accountingSource()->openDataFile();
    sqlite3 *floorDb = nullptr;
    sqlite3_open_v2(QFile::encodeName(companyFile).constData(), &floorDb, SQLITE_OPEN_READONLY,
                    nullptr);
    CompanyFile::registerMyobDate(floorDb);
    // The same page cache as the program's connection, so the floor is a fair one.
    sqlite3_exec(floorDb,
                 QByteArray("PRAGMA cache_size=-" + QByteArray::number(CompanyFile::PageCacheKiB))
                     .constData(),
                 nullptr, nullptr, nullptr);

    const QDate yearStart(2025, 1, 1);
    const QDate yearEnd(2025, 12, 31);
    PeriodDataSet &data = context.periodDataSet();
    const auto programYear = [&] {
        data.setCurrentSlot(0);
        ContextWiring::rangeLoader(context).loadDateRange(yearStart, yearEnd);
    };
    const auto programComparison = [&] {
        for (int slot = 1; slot <= 4; ++slot) {
            data.setCurrentSlot(quint8(slot));
            ContextWiring::rangeLoader(context).loadDateRange(yearStart.addYears(-slot),
                                                              yearEnd.addYears(-slot));
        }
    };
    double sink = 0.0;
    const auto floorYear = [&] { sink += floorLoad(floorDb, codes, yearStart, yearEnd); };
    const auto floorComparison = [&] {
        for (int slot = 1; slot <= 4; ++slot)
            sink += floorLoad(floorDb, codes, yearStart.addYears(-slot), yearEnd.addYears(-slot));
    };

    // Warm both paths once, then alternate so that neither gets the warmer cache.
    programYear();
    floorYear();
    QList<double> programYears, floorYears, programComparisons, floorComparisons;
    for (int round = 0; round < rounds; ++round) {
        for (auto [work, timings] :
             {std::pair{std::function<void()>(programYear), &programYears},
              std::pair{std::function<void()>(floorYear), &floorYears},
              std::pair{std::function<void()>(programComparison), &programComparisons},
              std::pair{std::function<void()>(floorComparison), &floorComparisons}}) {
            timer.restart();
            work();
            timings->append(double(timer.nsecsElapsed()) / 1e6);
        }
    }
    sqlite3_close(floorDb);

    const double year = median(programYears);
    const double yearFloor = median(floorYears);
    const double comparison = median(programComparisons);
    const double comparisonFloor = median(floorComparisons);
    out << "median of " << rounds << " rounds:\n";
    out << "  one-year load       program " << QString::number(year, 'f', 2) << " ms, floor "
        << QString::number(yearFloor, 'f', 2) << " ms, ratio "
        << QString::number(year / yearFloor, 'f', 3) << '\n';
    out << "  four-year comparison program " << QString::number(comparison, 'f', 2) << " ms, floor "
        << QString::number(comparisonFloor, 'f', 2) << " ms, ratio "
        << QString::number(comparison / comparisonFloor, 'f', 3) << '\n';
    out << "  targets: ratio <= 1.15 " << (year / yearFloor <= 1.15 ? "met" : "MISSED")
        << ", one-year load < 60 ms " << (year < 60.0 ? "met" : "MISSED") << '\n';
    out << "  (checksum " << sink << ", messages " << prompter.messages().size() << ")\n";
    for (const auto &message : prompter.messages())
        out << "  message: " << message.title << ": " << message.text << '\n';
    return 0;
}
