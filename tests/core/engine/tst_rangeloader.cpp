// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/contextwiring.h"
#include "app/shutdown.h"
#include "engine/formulatable.h"
#include "engine/rangeloader.h"
#include "sources/companyfilewriter.h"
#include "sources/myobsource.h"

#include <QSqlError>
#include <QSqlQuery>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

// The hand-made ledger: every account-mapped Field reads its own account X<id>, moved once
// in July 2025 by the amount below (credits negative), with 23 sales in the month.
const QList<QPair<int, double>> Movements = {
    {13, -12000.4}, {14, 5000.25},   {17, 812.6},   {21, -8000.8},   {22, 3500.35}, {25, 1210.45},
    {26, 402.15},   {35, -15000.55}, {36, 11020.3}, {43, -3000.3},   {45, 1610.7},  {49, 455.45},
    {72, -12000.4}, {73, -8000.8},   {74, -3000.3}, {75, -15000.55}, {76, -900.9},  {77, -400.4},
    {78, -100.1},   {81, 5000.25},   {82, 3500.35}, {83, 812.6},     {84, 11020.3}, {85, 1610.7},
    {86, 455.45},   {87, 700.7},     {88, 350.35},  {99, -120.5},    {101, 4200.2}, {102, 3900.25},
    {117, 300.3},   {118, 250.25},   {119, 180.18}, {120, 300.3}};

const QDate July1(2025, 7, 1);
const QDate July31(2025, 7, 31);

class PeriodLimitedSource : public AccountingSource
{
public:
    explicit PeriodLimitedSource(QDate periodEnd)
        : m_periodEnd(periodEnd)
    {}
    bool isReachable() override { return true; }
    std::optional<DbError> openDataFile() override { return std::nullopt; }
    void disconnect() override {}
    double accountMovement(const QString &, const QDate &, const QDate &) override
    {
        if (++queries == 1 && duringFirstQuery)
            duringFirstQuery();
        return -10.0;
    }
    qint16 jobsCount(const QDate &, const QDate &) override { return 4; }
    std::optional<QDate> currentPeriodEnd() override { return m_periodEnd; }
    int queries = 0;
    std::function<void()> duringFirstQuery;

private:
    QDate m_periodEnd;
};

} // namespace

class TestRangeLoader : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();
    void everyFieldOfJuly();
    void nothingToDivideBy();
    void fieldData_data();
    void fieldData();
    void workingDays_data();
    void workingDays();
    void periodLimit_data();
    void periodLimit();
    void hourlyRates();
    void halfLoadIsNeverCached();

private:
    AppContext &context() { return m_workspace->context(); }
    void execute(const QString &sql)
    {
        QSqlQuery query(context().mainDatabase().database());
        QVERIFY2(query.exec(sql), qPrintable(query.lastError().text()));
    }
    void load(const QDate &from, const QDate &to)
    {
        context().mainDatabase().requeryFields();
        context().periodDataSet().setCurrentSlot(0);
        ContextWiring::rangeLoader(context()).loadDateRange(from, to);
    }
    QString storedValue(int id) const
    {
        const PeriodDataSet::Slot &slot = m_workspace->context().periodDataSet().current();
        const int pos = PeriodDataSet::findFieldPos(slot.fieldIds, id);
        return pos > 0 ? slot.fieldValues.at(pos - 1) : u"<absent>"_s;
    }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestRangeLoader::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure(u"MYOB"_s));
    const QString ledger = m_workspace->path(u"ledger.myo"_s);
    CompanyFileWriter writer;
    QCOMPARE(writer.create(ledger), std::nullopt);
    for (const auto &[id, amount] : Movements) {
        const qint64 account = writer.addAccount(u"X%1"_s.arg(id), u"Field %1"_s.arg(id));
        writer.addJournalLine(account, July1.addDays(id % 28), amount);
        writer.addJournalLine(account, July1.addDays(-1), 1000000.0); // outside the range
    }
    writer.addAccount(u"BAD"_s, u"Never moved"_s);
    for (int i = 0; i < 23; ++i)
        writer.addSale(July1.addDays(i), u"S%1"_s.arg(i));
    writer.addSale(July31.addDays(1), u"AUGUST"_s);
    QCOMPARE(writer.finish(), std::nullopt);
    m_workspace->store().writeSetting(u"AccFilePath"_s, ledger);

    QVERIFY(m_workspace->connect());
    execute(u"UPDATE Fields SET Data = 'X' || ID WHERE Type = 2"_s);
    execute(u"UPDATE Hours SET Value = 98 WHERE ID = 1"_s);
    execute(u"UPDATE Hours SET Value = 104 WHERE ID = 2"_s);
    context().mainDatabase().hoursRecordset().requery();
    context().setAccountingSource(
        std::make_unique<MyobSource>(context().settings(), m_workspace->prompter()));
    QCOMPARE(context().accountingSource()->openDataFile(), std::nullopt);
    m_workspace->prompter().clearMessages();
}

void TestRangeLoader::cleanup()
{
    m_workspace.reset();
}

void TestRangeLoader::everyFieldOfJuly()
{
    load(July1, July31);
    // Worked out independently of this program from the ledger above: D = 30, W = 23,
    // J = 23, panel rate 98, paint rate 104. In the order the steps run.
    const QList<QPair<int, double>> derived = {
        {79, 39153.2}, {104, 12.8},    {105, 8.9},     {89, -23810.68}, {90, 15342.52},
        {92, 39.2},    {106, 60.8},    {107, 10.7},    {108, 10.0},     {103, -8100.45},
        {109, 20.7},   {110, 7242.07}, {111, 18.5},    {112, 314.87},   {15, 7000.15},
        {16, 58.3},    {18, 6187.55},  {19, 51.6},     {23, 4500.45},   {24, 56.3},
        {27, 2887.85}, {28, 36.1},     {30, 20001.2},  {31, 11500.6},   {32, 57.3},
        {33, 9075.4},  {34, 43.9},     {37, 3980.25},  {38, 26.5},      {39, 652.2},
        {40, -479.14}, {41, 39.5},     {42, 38.3},     {93, 173.05},    {46, 53.7},
        {47, 4.1},     {50, 15.2},     {51, 1.2},      {53, -2066.15},  {54, 68.9},
        {55, 5.3},     {115, 10.0},    {116, 0.8},     {96, 23.0},      {97, 23.0},
        {94, 1.0},     {124, 1702.31}, {56, 5.0},      {57, 869.62},    {58, -369.59},
        {59, 500.03},  {60, 57.5},     {125, -352.19}, {126, 314.87},   {62, 122.5},
        {63, 76.9},    {64, 199.4},    {65, 5.3},      {66, 3.3},       {67, 8.7},
        {127, 42.63},  {68, -15.74},   {69, -5.23},    {98, -20.97},    {70, -6.63},
        {113, -3.91},  {1, 58.3},      {2, 56.3},      {3, 51.6},       {4, 36.1},
        {5, 26.5},     {6, 39.5},      {7, 23.0},      {8, 1702.31},    {11, 39.2}};
    QStringList expected;
    QStringList actual;
    const PeriodDataSet &data = context().periodDataSet();
    for (const auto &[field, value] : derived) {
        const QString shown = QString::number(value, 'g', QLocale::FloatingPointShortest);
        expected << u"%1: %2 %2"_s.arg(field).arg(shown);
        actual << u"%1: %2 %3"_s.arg(field).arg(
            storedValue(field),
            QString::number(data.getFieldValue(field), 'g', QLocale::FloatingPointShortest));
    }
    QCOMPARE(actual, expected);
    QVERIFY(m_workspace->prompter().messages().isEmpty());
    QVERIFY(!m_workspace->prompter().isBusy());

    // Account figures are stored unrounded, come first in Field order, and keep their Type as
    // the code.
    QCOMPARE(storedValue(13), u"-12000.4"_s);
    QCOMPARE(data.getFieldValue(13), 12000.4);
    QCOMPARE(data.getFieldAbs(13), 12000.4);
    QCOMPARE(storedValue(119), u"180.18"_s);
    QCOMPARE(data.getFieldValue(119), -180.18);
    const PeriodDataSet::Slot &slot = data.current();
    const int firstDerived = PeriodDataSet::findFieldPos(slot.fieldIds, 79);
    for (int i = 0; i < firstDerived - 1; ++i)
        QCOMPARE(slot.fieldTypes.at(i), u"2"_s);
    QCOMPARE(firstDerived, Movements.size() + 1);
}

void TestRangeLoader::nothingToDivideBy()
{
    // No movements and no sales: J = 0 and total sales 0.
    load(QDate(2030, 7, 1), QDate(2030, 7, 31));
    QCOMPARE(FormulaTable::steps().size(), 75);
    const QList<int> absent = {8,   16,  19,  24,  28,  38,  39,  40,  41,  42,  46,
                               47,  50,  51,  54,  55,  57,  58,  60,  65,  66,  67,
                               68,  69,  70,  92,  93,  98,  104, 105, 106, 107, 108,
                               109, 111, 113, 115, 116, 124, 125, 126, 127};
    for (const FormulaTable::Step &step : FormulaTable::steps()) {
        const QString stored = storedValue(step.field);
        if (absent.contains(step.field))
            QVERIFY2(stored == u"<absent>"_s, qPrintable(u"Field %1"_s.arg(step.field)));
        else if (step.field == 96)
            QCOMPARE(stored, u"23"_s); // working days of July 2030
        else
            QVERIFY2(stored.isEmpty(), qPrintable(u"Field %1: %2"_s.arg(step.field).arg(stored)));
    }
    // Account figures of 0 are written as 0.
    QCOMPARE(storedValue(13), u"0"_s);
    QCOMPARE(context().periodDataSet().current().fieldAbs.first(), u"0"_s);
}

void TestRangeLoader::fieldData_data()
{
    QTest::addColumn<QStringList>("changes"); // SQL run before the load
    QTest::addColumn<QStringList>("stored");  // "id=stored text" afterwards
    QTest::addColumn<int>("messages");        // one per failing account code
    // Every formula that reads a hidden Field reads 0: 15 = V[13] + V[14].
    QTest::newRow("hidden field is not loaded")
        << QStringList{u"UPDATE Fields SET Hide = 1 WHERE ID = 13"_s}
        << QStringList{u"13=<absent>"_s, u"15=-5000.25"_s, u"16=<absent>"_s} << 0;
    QTest::newRow("codes around plus are trimmed and summed")
        << QStringList{u"UPDATE Fields SET Data = ' X13 +  X72+X999 ' WHERE ID = 13"_s}
        << QStringList{u"13=-24000.8"_s} << 0;
    QTest::newRow("a failing code is reported once per code and the load goes on")
        << QStringList{u"UPDATE Fields SET Data = 'X14+B''AD' WHERE ID = 14"_s,
                       u"UPDATE Fields SET Data = 'B''AD' WHERE ID = 17"_s}
        << QStringList{u"14=5000.25"_s, u"17=0"_s, u"79=39153.2"_s, u"11=39.2"_s} << 2;
}

void TestRangeLoader::fieldData()
{
    QFETCH(QStringList, changes);
    QFETCH(QStringList, stored);
    QFETCH(int, messages);
    for (const QString &sql : changes)
        execute(sql);
    load(July1, July31);
    for (const QString &entry : stored)
        QCOMPARE(storedValue(entry.section(u'=', 0, 0).toInt()), entry.section(u'=', 1));
    QCOMPARE(m_workspace->prompter().messages().size(), messages);
    for (const RecordingPrompter::Message &message : m_workspace->prompter().messages())
        QVERIFY(message.title.startsWith(u"GetMYOBValue for Account B'AD Error "_s));
}

void TestRangeLoader::workingDays_data()
{
    QTest::addColumn<QDate>("from");
    QTest::addColumn<QDate>("to");
    QTest::addColumn<int>("working");
    QTest::newRow("one Saturday") << QDate(2025, 7, 5) << QDate(2025, 7, 5) << 0;
    QTest::newRow("one Monday") << QDate(2025, 7, 7) << QDate(2025, 7, 7) << 1;
    QTest::newRow("a full week") << QDate(2025, 7, 7) << QDate(2025, 7, 13) << 5;
    QTest::newRow("leap February") << QDate(2008, 2, 1) << QDate(2008, 2, 29) << 21;
    QTest::newRow("end before start") << July31 << July1 << 0;
}

void TestRangeLoader::workingDays()
{
    QFETCH(QDate, from);
    QFETCH(QDate, to);
    QFETCH(int, working);
    QCOMPARE(RangeLoader::workingDays(from, to), working);
}

void TestRangeLoader::periodLimit_data()
{
    QTest::addColumn<QDate>("periodEnd");
    QTest::addColumn<bool>("beyond");
    QTest::newRow("ends with the period") << July31 << false;
    QTest::newRow("period ends later") << QDate(2026, 6, 30) << false;
    QTest::newRow("period ended before") << QDate(2025, 6, 30) << true;
    QTest::newRow("period end unreadable") << QDate() << true;
}

void TestRangeLoader::periodLimit()
{
    QFETCH(QDate, periodEnd);
    QFETCH(bool, beyond);
    auto source = std::make_unique<PeriodLimitedSource>(periodEnd);
    PeriodLimitedSource *fake = source.get();
    context().setAccountingSource(std::move(source));
    context().setNumberFormat(NumberFormat(QLocale(QLocale::English, QLocale::Australia)));
    load(July1, July31);

    const QList<RecordingPrompter::Message> &messages = m_workspace->prompter().messages();
    QCOMPARE(messages.size(), beyond ? 1 : 0);
    QCOMPARE(fake->queries > 0, !beyond);
    // The jobs count is read either way.
    QCOMPARE(storedValue(97), u"4"_s);
    if (beyond) {
        QCOMPARE(messages.first().title, u"Data Out Of Range"_s);
        QCOMPARE(messages.first().icon, Prompter::Icon::Exclamation);
        QVERIFY(messages.first().text.endsWith(periodEnd.isValid()
                                                   ? u"MoneyWorks file which ends 30/6/25!"_s
                                                   : u"file, whose end could not be read!"_s));
        QCOMPARE(storedValue(13), u"<absent>"_s);
    }
}

void TestRangeLoader::hourlyRates()
{
    // The rates set (98 and 104) are read in the July table; a rate not set or not there is 0.
    execute(u"UPDATE Hours SET Value = NULL WHERE ID = 2"_s);
    context().mainDatabase().hoursRecordset().requery();
    RangeLoader loader = ContextWiring::rangeLoader(context());
    QCOMPARE(loader.hourlyRate(2), 0.0);
    QCOMPARE(loader.hourlyRate(3), 0.0);
}

void TestRangeLoader::halfLoadIsNeverCached()
{
    auto source = std::make_unique<PeriodLimitedSource>(July31);
    bool busy = false;
    // Shut down from inside the load, as a network request acted on there once did.
    source->duringFirstQuery = [&] {
        busy = context().isBusy();
        shutDown(context());
    };
    context().setAccountingSource(std::move(source));
    load(July1, July31);
    QVERIFY(busy);
    QVERIFY(!context().isBusy());
    QVERIFY(!QFileInfo::exists(context().settings().cacheFile));
    QVERIFY(!context().periodDataSet().isFilling(0));
}

QTEST_GUILESS_MAIN(TestRangeLoader)
#include "tst_rangeloader.moc"
