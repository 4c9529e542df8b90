// Veltrix — KPI dashboard for small businesses.
#include "common/numberformat.h"
#include "engine/cachefile.h"

#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

class TestCacheFile : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void roundTrip();
    void unwritableTargetFails();
    void survivesACrashWhileWriting();
};

void TestCacheFile::roundTrip()
{
    QTemporaryDir dir;
    const NumberFormat numbers(QLocale(QLocale::English, QLocale::Australia));
    PeriodDataSet data(numbers);
    data.storeAccountFigure(72, -15000.25, 2);
    data.storeFieldValue(79, 15000.25, 0);
    data.storeFieldValue(104, 0.0, 1);
    const QString path = dir.filePath(u"data.db"_s);
    QVERIFY(CacheFile::write(path, data.slot(0)));

    QFile file(path);
    QVERIFY(file.open(QIODevice::ReadOnly));
    QCOMPARE(
        file.readAll(),
        QByteArray("72\t-15000.25\t15000.25\t2\r\n79\t15000.25\t15000.25\t0\r\n104\t\t\t1\r\n"));

    PeriodDataSet::Slot back;
    QCOMPARE(CacheFile::read(path, back), std::nullopt);
    QCOMPARE(back.fieldIds, data.slot(0).fieldIds);
    QCOMPARE(back.fieldValues, data.slot(0).fieldValues);
    QCOMPARE(back.fieldAbs, data.slot(0).fieldAbs);
    QCOMPARE(back.fieldTypes, data.slot(0).fieldTypes);
}

void TestCacheFile::unwritableTargetFails()
{
    QTemporaryDir dir;
    const NumberFormat numbers(QLocale(QLocale::English, QLocale::Australia));
    PeriodDataSet data(numbers);
    data.storeFieldValue(1, 1.0, 0);
    QVERIFY(!CacheFile::write(dir.filePath(u"missing-folder/data.db"_s), data.slot(0)));
}

void TestCacheFile::survivesACrashWhileWriting()
{
    // A writer rewrites a large cache over and over and is killed at some moment of it. The
    // file must then hold one whole cache, never a cut one.
    QTemporaryDir dir;
    const QString path = dir.filePath(u"data.db"_s);
    for (int attempt = 0; attempt < 3; ++attempt) {
        QProcess writer;
        writer.start(QStringLiteral(VELTRIX_TEST_HELPER), {u"write-cache"_s, path});
        QVERIFY(writer.waitForReadyRead(20000));
        QTest::qWait(150 + attempt * 70);
        writer.kill();
        QVERIFY(writer.waitForFinished(20000));

        PeriodDataSet::Slot slot;
        QCOMPARE(CacheFile::read(path, slot), std::nullopt);
        QCOMPARE(slot.size(), 20000);
        const QString value = slot.fieldValues.first();
        QVERIFY(value == u"111.11"_s || value == u"-2222.2"_s);
        QCOMPARE(slot.fieldValues.count(value), 20000);
    }
}

QTEST_GUILESS_MAIN(TestCacheFile)
#include "tst_cachefile.moc"
