// Veltrix — KPI dashboard for small businesses.
#include "common/numberformat.h"

#include <QRandomGenerator>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {
const QLocale Australia(QLocale::English, QLocale::Australia);
const QLocale Germany(QLocale::German, QLocale::Germany);
} // namespace

class TestNumberFormat : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void formatMoney_data();
    void formatMoney();
    void toNumber_data();
    void toNumber();
    void readsBackWhatItWrites_data();
    void readsBackWhatItWrites();
    void bareServerLocaleMeansAustralia();
};

void TestNumberFormat::formatMoney_data()
{
    QTest::addColumn<QLocale>("locale");
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<bool>("withSymbol");
    QTest::addColumn<QString>("expected");

    QTest::newRow("AU grouped") << Australia << QVariant(1234.5) << true << u"$ 1,234.50"_s;
    QTest::newRow("AU without symbol") << Australia << QVariant(1234.5) << false << u"1,234.50"_s;
    QTest::newRow("AU zero") << Australia << QVariant(0) << true << u"$ -"_s;
    QTest::newRow("AU zero without symbol") << Australia << QVariant(0.0) << false << u"0.00"_s;
    QTest::newRow("AU zero as text") << Australia << QVariant(u"0"_s) << true << u"$ -"_s;
    // A minus sign even where the region writes accounting brackets.
    QTest::newRow("AU negative") << Australia << QVariant(-5) << true << u"$ -5.00"_s;
    QTest::newRow("AU millions") << Australia << QVariant(u"1234567.891"_s) << true
                                 << u"$ 1,234,567.89"_s;
    QTest::newRow("AU not a number") << Australia << QVariant(u"n/a"_s) << true << QString();
    QTest::newRow("AU empty text") << Australia << QVariant(QString()) << true << QString();
    QTest::newRow("AU nothing") << Australia << QVariant() << true << QString();
    QTest::newRow("DE grouped") << Germany << QVariant(1234.5) << true << u"$ 1.234,50"_s;
    QTest::newRow("DE negative") << Germany << QVariant(-5) << true << u"$ -5,00"_s;
    QTest::newRow("DE without symbol") << Germany << QVariant(-98765.4) << false << u"-98.765,40"_s;
    QTest::newRow("DE zero") << Germany << QVariant(u"0,00"_s) << true << u"$ -"_s;
}

void TestNumberFormat::formatMoney()
{
    QFETCH(QLocale, locale);
    QFETCH(QVariant, value);
    QFETCH(bool, withSymbol);
    QFETCH(QString, expected);
    QCOMPARE(NumberFormat(locale).formatMoney(value, withSymbol), expected);
}

void TestNumberFormat::toNumber_data()
{
    QTest::addColumn<QLocale>("locale");
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<double>("expected");

    // What formatMoney writes, and plain figures of the region, are read back by the next test.
    QTest::newRow("empty") << Australia << QVariant(QString()) << 0.0;
    QTest::newRow("nothing") << Australia << QVariant() << 0.0;
    QTest::newRow("words") << Australia << QVariant(u"twelve"_s) << 0.0;
    QTest::newRow("number") << Australia << QVariant(42.25) << 42.25;
    QTest::newRow("integer") << Australia << QVariant(qint64(-7)) << -7.0;
    QTest::newRow("spaces around") << Australia << QVariant(u"  12.5 "_s) << 12.5;
    QTest::newRow("money, sign first") << Australia << QVariant(u"-$5.00"_s) << -5.0;
    QTest::newRow("accounting brackets") << Australia << QVariant(u"($1,000.00)"_s) << -1000.0;
    QTest::newRow("trailing minus") << Australia << QVariant(u"5.00-"_s) << -5.0;
    QTest::newRow("exponent") << Australia << QVariant(u"1.5e3"_s) << 1500.0;
    QTest::newRow("two signs") << Australia << QVariant(u"-5-"_s) << 0.0;
    QTest::newRow("dash of zero money") << Australia << QVariant(u"$ -"_s) << 0.0;
    QTest::newRow("infinity") << Australia << QVariant(u"inf"_s) << 0.0;
    QTest::newRow("not a number") << Australia << QVariant(u"nan"_s) << 0.0;
    QTest::newRow("DE decimal comma") << Germany << QVariant(u"1234,5"_s) << 1234.5;
    QTest::newRow("DE figure from the data source") << Germany << QVariant(u"1234.5"_s) << 1234.5;
    QTest::newRow("DE euro") << Germany << QVariant(u"12,00 \u20AC"_s) << 12.0;
}

void TestNumberFormat::toNumber()
{
    QFETCH(QLocale, locale);
    QFETCH(QVariant, value);
    QFETCH(double, expected);
    QCOMPARE(NumberFormat(locale).toNumber(value), expected);
}

void TestNumberFormat::readsBackWhatItWrites_data()
{
    QTest::addColumn<QLocale>("locale");
    QTest::newRow("en_AU") << Australia;
    QTest::newRow("de_DE") << Germany;
    QTest::newRow("fr_FR") << QLocale(QLocale::French, QLocale::France);
    QTest::newRow("en_IN") << QLocale(QLocale::English, QLocale::India);
    QTest::newRow("de_CH") << QLocale(QLocale::German, QLocale::Switzerland);
}

void TestNumberFormat::readsBackWhatItWrites()
{
    QFETCH(QLocale, locale);
    const NumberFormat format(locale);
    QRandomGenerator random(11);
    for (int i = 0; i < 2000; ++i) {
        const double cents = double(qint64(random.bounded(2000000000)) - 1000000000);
        const double value = cents / 100.0;
        for (const bool withSymbol : {true, false}) {
            const QString text = format.formatMoney(value, withSymbol);
            QCOMPARE(format.toNumber(text), value);
        }
        const QString plain = locale.toString(value, 'f', 2);
        QCOMPARE(format.toNumber(plain), value);
    }
}

void TestNumberFormat::bareServerLocaleMeansAustralia()
{
    // The system locale cannot be changed inside a running process; what can be checked is
    // that the rule picks English (Australia) exactly for the C locale.
    const QLocale user = NumberFormat::userLocale();
    if (QLocale::system().language() == QLocale::C)
        QCOMPARE(user, Australia);
    else
        QCOMPARE(user, QLocale::system());
}

QTEST_GUILESS_MAIN(TestNumberFormat)
#include "tst_numberformat.moc"
