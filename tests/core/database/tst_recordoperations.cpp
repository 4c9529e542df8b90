// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "database/recordoperations.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestRecordOperations : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void openQuery();
    void findRecordById_data();
    void findRecordById();
    void deleteRecordById_data();
    void deleteRecordById();
    void valueExists_data();
    void valueExists();
    void loadList();
    void hasRecords();

private:
    RecordOperations operations()
    {
        return RecordOperations(m_workspace->context().mainDatabase(), m_workspace->prompter());
    }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestRecordOperations::init()
{
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    QVERIFY(m_workspace->connect());
}

void TestRecordOperations::openQuery()
{
    RecordOperations::Query all = operations().openQuery(u"Fields"_s, QString(), true);
    QCOMPARE(all.error, std::nullopt);
    QCOMPARE(all.records.recordCount(), 123);

    RecordOperations::Query headings =
        operations().openQuery(u"Fields"_s, u"Type=1 OR Type=3"_s, true);
    QCOMPARE(headings.error, std::nullopt);
    QVERIFY(headings.records.recordCount() > 10);
    QVERIFY(headings.records.recordCount() < 123);

    RecordOperations::Query unopened = operations().openQuery(u"Hours"_s, QString(), false);
    QVERIFY(!unopened.records.isOpen());

    // A query that cannot open says why and leaves no records.
    RecordOperations::Query broken = operations().openQuery(u"Nowhere"_s, QString(), true);
    QVERIFY(broken.error);
    QVERIFY(!broken.error->description.isEmpty());
    QVERIFY(!broken.records.isOpen());
}

void TestRecordOperations::findRecordById_data()
{
    QTest::addColumn<bool>("empty"); // Users, which has no rows, instead of Hours
    QTest::addColumn<qint64>("id");
    QTest::addColumn<bool>("found");
    QTest::newRow("first") << false << qint64(1) << true;
    QTest::newRow("missing") << false << qint64(3) << false;
    QTest::newRow("negative") << false << qint64(-1) << false;
    QTest::newRow("empty record set is reported") << true << qint64(1) << false;
}

void TestRecordOperations::findRecordById()
{
    QFETCH(bool, empty);
    QFETCH(qint64, id);
    QFETCH(bool, found);
    MainDatabase &database = m_workspace->context().mainDatabase();
    RecordSet &records = empty ? database.usersRecordset() : database.hoursRecordset();
    QCOMPARE(operations().findRecordById(records, id), found);
    if (found)
        QCOMPARE(records.value(u"ID"_s).toLongLong(), id);
    const QList<RecordingPrompter::Message> &messages = m_workspace->prompter().messages();
    QCOMPARE(messages.size(), empty ? 1 : 0);
    if (empty)
        QCOMPARE(messages.first().title, u"Find Record Error 3021"_s);
}

void TestRecordOperations::deleteRecordById_data()
{
    QTest::addColumn<Prompter::Answer>("answer");
    QTest::addColumn<qint64>("id");
    QTest::addColumn<bool>("deleted");
    QTest::newRow("yes") << Prompter::Answer::Yes << qint64(2) << true;
    QTest::newRow("no") << Prompter::Answer::No << qint64(2) << false;
    QTest::newRow("yes, but no such record") << Prompter::Answer::Yes << qint64(9) << false;
}

void TestRecordOperations::deleteRecordById()
{
    QFETCH(Prompter::Answer, answer);
    QFETCH(qint64, id);
    QFETCH(bool, deleted);
    RecordSet &hours = m_workspace->context().mainDatabase().hoursRecordset();
    m_workspace->prompter().scriptAnswer(answer);

    QCOMPARE(operations().deleteRecordById(hours, id), deleted);
    const RecordingPrompter::Message question = m_workspace->prompter().messages().first();
    QCOMPARE(question.text,
             u"Are you sure you want to delete the record with ID "_s + QString::number(id) + u'?');
    QCOMPARE(question.title, u"Delete Record"_s);
    QCOMPARE(question.icon, Prompter::Icon::Exclamation);
    QCOMPARE(question.buttons, Prompter::Buttons::YesNo);
    QCOMPARE(hours.recordCount(), deleted ? 1 : 2);
}

void TestRecordOperations::valueExists_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("asked");
    QTest::addColumn<bool>("exists");
    QTest::newRow("same") << u"Bob"_s << u"Bob"_s << true;
    QTest::newRow("other case") << u"Bob"_s << u"bob"_s << true;
    QTest::newRow("different") << u"Bob"_s << u"Rob"_s << false;
    QTest::newRow("apostrophe") << u"O'Brien"_s << u"o'brien"_s << true;
    QTest::newRow("percent is a character") << u"Bob"_s << u"B%"_s << false;
    QTest::newRow("underscore is a character") << u"Bob"_s << u"B_b"_s << false;
    QTest::newRow("stored backslash") << u"a\\b"_s << u"A\\B"_s << true;
    QTest::newRow("quote and semicolon") << u"Bob"_s << u"x'; DROP TABLE Users; --"_s << false;
}

void TestRecordOperations::valueExists()
{
    QFETCH(QString, stored);
    QFETCH(QString, asked);
    QFETCH(bool, exists);
    QVERIFY(
        m_workspace->exec(u"INSERT INTO Users (UserName, Password) VALUES (?, 'pw')"_s, {stored}));
    QCOMPARE(operations().valueExists(u"Users"_s, u"UserName"_s, asked), exists);
    QCOMPARE(operations().valueExists(u"Users"_s, u"UserName"_s, stored), true);
}

void TestRecordOperations::loadList()
{
    RecordOperations::ListContent list{{u"old"_s}, {u"99"_s}};
    operations().loadList(list, u"Hours"_s, u"Department"_s, QString(), true);
    QCOMPARE(list.items, (QStringList{u"Panel"_s, u"Paint"_s}));
    QCOMPARE(list.ids, (QStringList{u"1"_s, u"2"_s}));
    operations().loadList(list, u"Fields"_s, u"Label"_s, u"Type=1 AND Tab=1"_s, false);
    QCOMPARE(list.items.size(), 2);
    QCOMPARE(list.ids.size(), 2);

    // Nothing found keeps the old content; an empty list is said only when asked for.
    operations().loadList(list, u"Users"_s, u"UserName"_s, QString(), true);
    QCOMPARE(list.items.size(), 2);
    QCOMPARE(list.ids.size(), 2);
    QVERIFY(m_workspace->prompter().messages().isEmpty());
    RecordOperations::ListContent empty;
    operations().loadList(empty, u"Users"_s, u"UserName"_s, QString(), false);
    QVERIFY(m_workspace->prompter().messages().isEmpty());
    operations().loadList(empty, u"Users"_s, u"UserName"_s, QString(), true);
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    QCOMPARE(m_workspace->prompter().messages().first().text,
             u"Unable to retrieve data records from the table 'Users.UserName'"_s);
    QCOMPARE(m_workspace->prompter().messages().first().title, u"Load List Failed"_s);
}

void TestRecordOperations::hasRecords()
{
    MainDatabase &database = m_workspace->context().mainDatabase();
    QVERIFY(RecordOperations::hasRecords(database.hoursRecordset()));
    QVERIFY(!RecordOperations::hasRecords(database.usersRecordset()));
    QVERIFY(!RecordOperations::hasRecords(RecordSet()));
    database.hoursRecordset().moveLast();
    database.hoursRecordset().moveNext();
    QVERIFY(!RecordOperations::hasRecords(database.hoursRecordset()));
}

QTEST_GUILESS_MAIN(TestRecordOperations)
#include "tst_recordoperations.moc"
