// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "database/recordset.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestRecordSet : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void walksAndReadsByAnyCase();
    void findsIdForwardFromCurrent();
    void addsUpdatesAndDeletes();
    void changeByAnotherCopy_data();
    void changeByAnotherCopy();
    void readOnlyAndJoinedQueriesRefuseChanges();

private:
    QSqlDatabase first() { return m_workspace->context().mainDatabase().database(); }

    std::unique_ptr<TestWorkspace> m_workspace;
    std::unique_ptr<SqliteConnection> m_second; // another copy's
};

void TestRecordSet::init()
{
    m_second.reset();
    m_workspace = std::make_unique<TestWorkspace>();
    QVERIFY(m_workspace->configure());
    QVERIFY(m_workspace->connect());
    m_second = std::make_unique<SqliteConnection>();
    QCOMPARE(m_second->open(m_workspace->mainDatabase()), std::nullopt);
}

void TestRecordSet::walksAndReadsByAnyCase()
{
    RecordSet hours(first(), u"SELECT * FROM Hours ORDER BY ID"_s);
    QCOMPARE(hours.open(), std::nullopt);
    QCOMPARE(hours.recordCount(), 2);
    QVERIFY(!hours.bof());
    QCOMPARE(hours.value(u"department"_s).toString(), u"Panel"_s);
    QCOMPARE(hours.moveNext(), std::nullopt);
    QCOMPARE(hours.value(u"Department"_s).toString(), u"Paint"_s);
    QCOMPARE(hours.moveNext(), std::nullopt);
    QVERIFY(hours.eof());
    QVERIFY(!hours.value(u"Department"_s).isValid());
    QCOMPARE(hours.moveNext()->number, DbError::NoCurrentRecord);
    QVERIFY(!hours.value(u"NoSuchColumn"_s).isValid());

    RecordSet users(first(), u"SELECT * FROM Users"_s);
    QCOMPARE(users.open(), std::nullopt);
    QVERIFY(users.bof() && users.eof()); // empty: before the start and past the end at once
    QCOMPARE(users.moveFirst()->number, DbError::NoCurrentRecord);
    RecordSet closed;
    QVERIFY(!closed.isOpen());
    QCOMPARE(closed.moveFirst()->number, DbError::RecordsetClosed);
}

void TestRecordSet::findsIdForwardFromCurrent()
{
    RecordSet fields(first(), u"SELECT * FROM Fields WHERE Hide<>1 ORDER BY `Order`"_s);
    QCOMPARE(fields.open(), std::nullopt);
    QCOMPARE(fields.findId(79), std::nullopt);
    QCOMPARE(fields.value(u"ID"_s).toInt(), 79);
    QCOMPARE(fields.value(u"Label"_s).toString(), u"Total sales"_s);
    // Field 1 comes before 79 in this order: forward from here there is none.
    QCOMPARE(fields.findId(1), std::nullopt);
    QVERIFY(fields.eof());
    QCOMPARE(fields.moveFirst(), std::nullopt);
    QCOMPARE(fields.findId(1), std::nullopt);
    QCOMPARE(fields.value(u"ID"_s).toInt(), 1);
}

void TestRecordSet::addsUpdatesAndDeletes()
{
    RecordSet users(first(), u"SELECT * FROM Users"_s);
    QCOMPARE(users.open(), std::nullopt);
    QCOMPARE(users.addNew(), std::nullopt);
    QCOMPARE(users.setValue(u"username"_s, u"Bob"_s), std::nullopt);
    QCOMPARE(users.setValue(u"Password"_s, u"pw"_s), std::nullopt);
    QCOMPARE(users.update(), std::nullopt);
    const qint64 id = users.value(u"ID"_s).toLongLong();
    QVERIFY(id > 0);
    QCOMPARE(users.value(u"Fields"_s).toString(), u"#"_s); // the table's default came back

    RecordSet other(m_second->database(), u"SELECT * FROM Users"_s);
    QCOMPARE(other.open(), std::nullopt);
    QCOMPARE(other.recordCount(), 1);
    QCOMPARE(other.value(u"UserName"_s).toString(), u"Bob"_s);

    QCOMPARE(users.setValue(u"Password"_s, u"secret"_s), std::nullopt);
    QCOMPARE(users.update(), std::nullopt);
    QCOMPARE(other.requery(), std::nullopt);
    QCOMPARE(other.value(u"Password"_s).toString(), u"secret"_s);

    QCOMPARE(users.deleteCurrent(), std::nullopt);
    QCOMPARE(other.requery(), std::nullopt);
    QCOMPARE(other.recordCount(), 0);
}

void TestRecordSet::changeByAnotherCopy_data()
{
    QTest::addColumn<QString>("theirs");
    QTest::addColumn<bool>("conflict");
    QTest::addColumn<QString>("after");
    QTest::newRow("same column") << u"UPDATE Hours SET Value = 3 WHERE ID = 1"_s << true
                                 << u"Panel 3"_s;
    QTest::newRow("row deleted") << u"DELETE FROM Hours WHERE ID = 1"_s << true << QString();
    QTest::newRow("another column")
        << u"UPDATE Hours SET Department = 'Shop' WHERE ID = 1"_s << false << u"Shop 95.5"_s;
}

void TestRecordSet::changeByAnotherCopy()
{
    QFETCH(QString, theirs);
    QFETCH(bool, conflict);
    QFETCH(QString, after);
    RecordSet mine(first(), u"SELECT * FROM Hours"_s);
    QCOMPARE(mine.open(), std::nullopt);
    QCOMPARE(mine.findId(1), std::nullopt);
    QVERIFY(m_workspace->exec(theirs));

    QCOMPARE(mine.setValue(u"Value"_s, 95.5), std::nullopt);
    const std::optional<DbError> error = mine.update();
    QCOMPARE(error ? error->number : 0, conflict ? DbError::RowNotFound : 0);
    if (after.isEmpty())
        QCOMPARE(mine.deleteCurrent()->number, DbError::RowNotFound);
    // The other copy's change stands; a requery shows it.
    QCOMPARE(mine.requery(), std::nullopt);
    QCOMPARE(mine.findId(1), std::nullopt);
    const QString row = mine.eof() ? QString()
                                   : mine.value(u"Department"_s).toString() + u' ' +
                                         mine.value(u"Value"_s).toString();
    QCOMPARE(row, after);
}

void TestRecordSet::readOnlyAndJoinedQueriesRefuseChanges()
{
    RecordSet readOnly(first(), u"SELECT * FROM Hours"_s, RecordSet::Access::ReadOnly);
    QCOMPARE(readOnly.open(), std::nullopt);
    QVERIFY(readOnly.setValue(u"Value"_s, 1).has_value());

    RecordSet joined(first(), u"SELECT h.ID, h.Value, c.Value AS c FROM Hours h, Config c"_s);
    QCOMPARE(joined.open(), std::nullopt);
    QVERIFY(joined.setValue(u"Value"_s, 1).has_value());
}

QTEST_GUILESS_MAIN(TestRecordSet)
#include "tst_recordset.moc"
