// Veltrix — KPI dashboard for small businesses.
#include "engine/formula.h"

#include <QTest>

#include <limits>

using namespace Qt::StringLiterals;

namespace {

Formula::Inputs sampleInputs()
{
    Formula::Inputs inputs;
    inputs.value = [](int id) { return id == 0 ? 0.0 : double(id); };
    inputs.magnitude = [](int id) { return double(id) * 10.0; };
    inputs.sum = [](int first, int last) { return double(first + last); };
    inputs.hourlyRate = [](int id) { return id == 1 ? 98.0 : 0.0; };
    inputs.daySpan = 30;
    inputs.workingDays = 23;
    inputs.jobs = 0;
    return inputs;
}

} // namespace

class TestFormula : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void evaluates_data();
    void evaluates();
    void failsInsteadOfDividingByZero_data();
    void failsInsteadOfDividingByZero();
    void refusesMalformedText_data();
    void refusesMalformedText();
};

void TestFormula::evaluates_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<double>("value");
    QTest::newRow("figure") << u"V[13]"_s << 13.0;
    QTest::newRow("magnitude") << u"A[13]"_s << 130.0;
    QTest::newRow("sum of a range") << u"S[72..78]"_s << 150.0;
    QTest::newRow("rate") << u"H[1]"_s << 98.0;
    QTest::newRow("day counts") << u"D + W"_s << 53.0;
    QTest::newRow("left to right") << u"V[8] - V[4] - V[2]"_s << 2.0;
    QTest::newRow("products first") << u"V[2] + V[3] * V[4]"_s << 14.0;
    QTest::newRow("brackets") << u"((A[1] + A[3]) / 100) / 2"_s << 0.2;
    QTest::newRow("unary minus") << u"(V[4] / V[2]) * -1"_s << -2.0;
    QTest::newRow("decimal number") << u"V[3] / 1.5"_s << 2.0;
    QTest::newRow("spaces anywhere") << u"  S[ 1 .. 2 ]+V[ 5 ] "_s << 8.0;
}

void TestFormula::evaluates()
{
    QFETCH(QString, text);
    QFETCH(double, value);
    QString problem;
    const std::optional<Formula> formula = Formula::parse(text, &problem);
    QVERIFY2(formula, qPrintable(problem));
    QCOMPARE(formula->evaluate(sampleInputs()), value);
}

void TestFormula::failsInsteadOfDividingByZero_data()
{
    QTest::addColumn<QString>("text");
    QTest::newRow("by a figure of zero") << u"V[5] / V[0]"_s;
    QTest::newRow("zero by zero") << u"V[0] / V[0]"_s;
    QTest::newRow("by no jobs") << u"V[5] / J"_s;
    QTest::newRow("nested") << u"J / (V[0] / 7)"_s;
    QTest::newRow("by a missing rate") << u"V[13] / H[2]"_s;
    QTest::newRow("failure carries through") << u"V[1] + V[5] / J"_s;
    QTest::newRow("overflow") << u"V[99] * V[99]"_s;
}

void TestFormula::failsInsteadOfDividingByZero()
{
    QFETCH(QString, text);
    auto inputs = sampleInputs();
    inputs.value = [](int id) {
        return id == 99 ? std::numeric_limits<double>::max() : double(id);
    };
    const std::optional<Formula> formula = Formula::parse(text);
    QVERIFY(formula);
    QCOMPARE(formula->evaluate(inputs), std::nullopt);
}

void TestFormula::refusesMalformedText_data()
{
    QTest::addColumn<QString>("text");
    QTest::newRow("empty") << QString();
    QTest::newRow("unknown term") << u"X[1]"_s;
    QTest::newRow("no index") << u"V"_s;
    QTest::newRow("unclosed index") << u"V[1"_s;
    QTest::newRow("sum without range") << u"S[1]"_s;
    QTest::newRow("dangling operator") << u"V[1] +"_s;
    QTest::newRow("unclosed bracket") << u"(V[1] + V[2]"_s;
    QTest::newRow("trailing text") << u"V[1] V[2]"_s;
}

void TestFormula::refusesMalformedText()
{
    QFETCH(QString, text);
    QString problem;
    QCOMPARE(Formula::parse(text, &problem).has_value(), false);
    QVERIFY(!problem.isEmpty());
}

QTEST_GUILESS_MAIN(TestFormula)
#include "tst_formula.moc"
