// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "app/contextwiring.h"
#include "app/producecommand.h"
#include "engine/rangeloader.h"
#include "grid/gridoperations.h"
#include "setup/hourlyrates.h"
#include "setup/programsetup.h"
#include "sources/accountingsource.h"
#include "sources/companyfilewriter.h"

#include <QTest>

#include <sqlite3.h>

using namespace Qt::StringLiterals;

namespace {

// Another copy of the program on the same main.db, with its setup lists open: panel labour
// at $50 an hour, and its sales taken from an account that never moved.
class OtherCopy
{
public:
    explicit OtherCopy(const QString &sharedFolder)
    {
        m_ready = m_workspace.configure(u"MYOB"_s);
        m_workspace.store().writeSetting(u"DBPath"_s, sharedFolder);
        m_ready = m_ready && m_workspace.connect();
        m_rates.load();
        m_setup.load();
        m_rates.commitEdit(GridOperations::findGridRow(m_rates.grid(), 1, u"1"_s), u"50"_s);
        m_setup.commitEdit(
            ProgramSetup::Mapping,
            GridOperations::findGridRow(m_setup.grid(ProgramSetup::Mapping), 1, u"13"_s),
            u"9-9999"_s);
    }
    bool isReady() const { return m_ready; }
    sqlite3 *handle() { return m_workspace.context().mainDatabase().connection().handle(); }
    bool saveRate() { return m_rates.save(); }
    bool saveMapping() { return m_setup.save(); }

private:
    TestWorkspace m_workspace;
    HourlyRates m_rates{m_workspace.context().mainDatabase(), m_workspace.prompter(),
                        m_workspace.context().numberFormat()};
    ProgramSetup m_setup{m_workspace.context().mainDatabase(), m_workspace.prompter()};
    bool m_ready = false;
};

// Runs once, when the connection starts its first statement that reads the Fields.
int beforeFieldsAreRead(unsigned, void *action, void *, void *sql)
{
    auto &pending = *static_cast<std::function<void()> *>(action);
    if (pending && QByteArray(static_cast<const char *>(sql)).contains("FROM Fields"))
        std::exchange(pending, nullptr)();
    return 0;
}

} // namespace

using Selection = ProduceCommand::Selection;
using Outcome = ProduceCommand::Outcome;
Q_DECLARE_METATYPE(Selection)

class TestProduceCommand : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();
    void firstProduceOpensTheCompanyFile();
    void invalidRangeIsRefused_data();
    void invalidRangeIsRefused();
    void noSourceAndNoFile_data();
    void noSourceAndNoFile();
    void unreadableCompanyFileIsReported();
    void anotherCopysSetupReachesTheNextProduceWhole();

private:
    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestProduceCommand::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure(u"MYOB"_s));
    const QString ledger = m_workspace->path(u"ledger.myo"_s);
    CompanyFileWriter writer;
    QCOMPARE(writer.create(ledger), std::nullopt);
    const qint64 panel = writer.addAccount(u"4-1100"_s, u"Panel Labour"_s);
    writer.addJournalLine(panel, QDate(2008, 2, 29), -2900.0);
    writer.addJournalLine(panel, QDate(2008, 3, 1), -100.0);
    writer.addSale(QDate(2008, 2, 29), u"INV1"_s);
    QCOMPARE(writer.finish(), std::nullopt);
    m_workspace->store().writeSetting(u"AccFilePath"_s, ledger);
}

void TestProduceCommand::cleanup()
{
    m_workspace.reset();
}

void TestProduceCommand::firstProduceOpensTheCompanyFile()
{
    QVERIFY(m_workspace->connect());
    AppContext &context = m_workspace->context();
    QVERIFY(!context.accountingSource());
    QCOMPARE(ProduceCommand(context).produce({2, 2008, 2, 2008}), Outcome::Produced);
    QVERIFY(context.accountingSource()->isReachable());
    QCOMPARE(context.periodDataSet().getFieldValue(13), 2900.0);
    QCOMPARE(context.periodDataSet().getFieldValue(97), 1.0);
    QCOMPARE(context.periodDataSet().range(0).end, QDate(2008, 2, 29));

    SettingsStore &store = m_workspace->store();
    QCOMPARE(store.readSetting(u"M1"_s), u"1"_s);
    QCOMPARE(store.readSetting(u"M2"_s), u"1"_s);
    QCOMPARE(store.readSetting(u"Y1"_s), u"2008"_s);
    QCOMPARE(store.readSetting(u"Y2"_s), u"2008"_s);
    QVERIFY(!m_workspace->prompter().isBusy());
}

void TestProduceCommand::invalidRangeIsRefused_data()
{
    QTest::addColumn<Selection>("selection");
    QTest::addColumn<QDate>("end"); // null when refused
    QTest::newRow("March to February") << Selection{3, 2006, 2, 2006} << QDate();
    QTest::newRow("a later year first") << Selection{1, 2007, 12, 2006} << QDate();
    QTest::newRow("December") << Selection{12, 2006, 12, 2006} << QDate(2006, 12, 31);
    QTest::newRow("plain February") << Selection{1, 2007, 2, 2007} << QDate(2007, 2, 28);
}

void TestProduceCommand::invalidRangeIsRefused()
{
    QFETCH(Selection, selection);
    QFETCH(QDate, end);
    const bool valid = end.isValid();
    QVERIFY(m_workspace->connect());
    AppContext &context = m_workspace->context();
    context.periodDataSet().storeFieldValue(79, 5.0, 0); // the previous produce
    m_workspace->prompter().clearMessages();

    QCOMPARE(ProduceCommand(context).produce(selection),
             valid ? Outcome::Produced : Outcome::InvalidRange);
    // The range is recorded even when it is refused.
    QCOMPARE(context.periodDataSet().range(0).start,
             QDate(selection.firstYear, selection.firstMonth, 1));
    if (valid) {
        QCOMPARE(context.periodDataSet().range(0).end, end);
        return;
    }
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    const RecordingPrompter::Message &message = m_workspace->prompter().messages().first();
    QCOMPARE(message.title, u"Invalid Date Range"_s);
    QCOMPARE(message.text, u"The selected date range is invalid! Make sure the second date is "
                           u"the same or later than the first."_s);
    QCOMPARE(context.periodDataSet().getFieldValue(79), 5.0);
    QCOMPARE(m_workspace->store().readSetting(u"M1"_s), QString());
}

void TestProduceCommand::noSourceAndNoFile_data()
{
    QTest::addColumn<QString>("package");
    QTest::newRow("MYOB") << u"MYOB"_s;
    QTest::newRow("MoneyWorks") << u"MoneyWorks"_s;
}

void TestProduceCommand::noSourceAndNoFile()
{
    QFETCH(QString, package);
    m_workspace->store().writeSetting(u"AccPackage"_s, package);
    m_workspace->store().writeSetting(u"AccFilePath"_s, QString());
    QVERIFY(m_workspace->connect());
    QCOMPARE(ProduceCommand(m_workspace->context()).produce({1, 2008, 1, 2008}), Outcome::NoSource);
    const RecordingPrompter::Message &message = m_workspace->prompter().messages().last();
    QCOMPARE(message.title, u"Cannot Produce KPI's"_s);
    QCOMPARE(message.text,
             u"There is no running instance of "_s + package +
                 u" and your primary Account data file has not been specified!\r\n\r\n"
                 u"You can specify your primary Accounting file in the System "
                 u"Configuration."_s);
}

void TestProduceCommand::unreadableCompanyFileIsReported()
{
    QFile::remove(m_workspace->path(u"ledger.myo"_s));
    QVERIFY(m_workspace->connect());
    m_workspace->prompter().clearMessages();
    QCOMPARE(ProduceCommand(m_workspace->context()).produce({1, 2008, 1, 2008}), Outcome::Failed);
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    QVERIFY(m_workspace->prompter().messages().first().title.startsWith(u"Produce Error "_s));
    QVERIFY(!m_workspace->prompter().isBusy());
}

void TestProduceCommand::anotherCopysSetupReachesTheNextProduceWhole()
{
    QVERIFY(m_workspace->connect());
    AppContext &context = m_workspace->context();
    const auto produced = [&](int field) {
        return ProduceCommand(context).produce({2, 2008, 2, 2008}) == Outcome::Produced
                   ? context.periodDataSet().getFieldValue(field)
                   : -1.0;
    };
    QCOMPARE(produced(13), 2900.0);
    OtherCopy other(m_workspace->sharedFolder());
    QVERIFY(other.isReady());

    // The other copy saves the new rate and the new mapping just as this one begins to read
    // the Fields; a lock it cannot get fails its save quickly.
    sqlite3_busy_timeout(other.handle(), 50);
    std::function<void()> saveBoth = [&] {
        other.saveRate();
        other.saveMapping();
    };
    sqlite3 *handle = context.mainDatabase().connection().handle();
    sqlite3_trace_v2(handle, SQLITE_TRACE_STMT, beforeFieldsAreRead, &saveBoth);
    const double sales = produced(13);
    sqlite3_trace_v2(handle, 0, nullptr, nullptr);
    QVERIFY(!saveBoth); // the produce did read the Fields again
    // Both changes or neither: never the old rate with the new mapping.
    QCOMPARE(ContextWiring::rangeLoader(context).hourlyRate(1) == 50.0, sales == 0.0);

    // Saved in full, each reaches the next produce. Panel labour hours are the panel labour
    // sales over the panel rate.
    QVERIFY(other.saveRate());
    QCOMPARE(produced(62), 58.0);
    QVERIFY(other.saveMapping());
    QCOMPARE(produced(13), 0.0);
}

QTEST_GUILESS_MAIN(TestProduceCommand)
#include "tst_producecommand.moc"
