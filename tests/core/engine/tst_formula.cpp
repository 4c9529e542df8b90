// Veltrix — KPI dashboard for small businesses.
#include "engine/formula.h"

#include <QTest>

#include <limits>

using namespace Qt::StringLiterals;

namespace {

Formula::Inputs sampleInputs()
{
    Formula::Inputs inputs;
    inputs.value = [](int id) {
        return id == 99 ? std::numeric_limits<double>::max() : double(id);
    };
    inputs.magnitude = [](int id) { return double(id) * 10.0; };
    inputs.sum = [](int first, int last) { return double(first + last); };
    inputs.hourlyRate = [](int id) { return id == 1 ? 98.0 : 0.0; };
    inputs.daySpan = 30;
    inputs.workingDays = 23;
    inputs.jobs = 0;
    return inputs;
}

enum Outcome { Value, NoValue, Refused };

} // namespace

class TestFormula : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void evaluates_data();
    void evaluates();
};

void TestFormula::evaluates_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("outcome");
    QTest::addColumn<double>("value");
    QTest::newRow("figure") << u"V[13]"_s << int(Value) << 13.0;
    QTest::newRow("magnitude") << u"A[13]"_s << int(Value) << 130.0;
    QTest::newRow("sum of a range") << u"S[72..78]"_s << int(Value) << 150.0;
    QTest::newRow("rate") << u"H[1]"_s << int(Value) << 98.0;
    QTest::newRow("day counts") << u"D + W"_s << int(Value) << 53.0;
    QTest::newRow("left to right") << u"V[8] - V[4] - V[2]"_s << int(Value) << 2.0;
    QTest::newRow("products first") << u"V[2] + V[3] * V[4]"_s << int(Value) << 14.0;
    QTest::newRow("brackets") << u"((A[1] + A[3]) / 100) / 2"_s << int(Value) << 0.2;
    QTest::newRow("unary minus") << u"(V[4] / V[2]) * -1"_s << int(Value) << -2.0;
    QTest::newRow("decimal number") << u"V[3] / 1.5"_s << int(Value) << 2.0;
    QTest::newRow("spaces anywhere") << u"  S[ 1 .. 2 ]+V[ 5 ] "_s << int(Value) << 8.0;

    // Fails instead of dividing by zero.
    QTest::newRow("by a figure of zero") << u"V[5] / V[0]"_s << int(NoValue) << 0.0;
    QTest::newRow("zero by zero") << u"V[0] / V[0]"_s << int(NoValue) << 0.0;
    QTest::newRow("by no jobs") << u"V[5] / J"_s << int(NoValue) << 0.0;
    QTest::newRow("nested") << u"J / (V[0] / 7)"_s << int(NoValue) << 0.0;
    QTest::newRow("by a missing rate") << u"V[13] / H[2]"_s << int(NoValue) << 0.0;
    QTest::newRow("failure carries through") << u"V[1] + V[5] / J"_s << int(NoValue) << 0.0;
    QTest::newRow("overflow") << u"V[99] * V[99]"_s << int(NoValue) << 0.0;

    QTest::newRow("empty") << QString() << int(Refused) << 0.0;
    QTest::newRow("unknown term") << u"X[1]"_s << int(Refused) << 0.0;
    QTest::newRow("no index") << u"V"_s << int(Refused) << 0.0;
    QTest::newRow("unclosed index") << u"V[1"_s << int(Refused) << 0.0;
    QTest::newRow("sum without range") << u"S[1]"_s << int(Refused) << 0.0;
    QTest::newRow("dangling operator") << u"V[1] +"_s << int(Refused) << 0.0;
    QTest::newRow("unclosed bracket") << u"(V[1] + V[2]"_s << int(Refused) << 0.0;
    QTest::newRow("trailing text") << u"V[1] V[2]"_s << int(Refused) << 0.0;
}

void TestFormula::evaluates()
{
    QFETCH(QString, text);
    QFETCH(int, outcome);
    QFETCH(double, value);
    QString problem;
    const std::optional<Formula> formula = Formula::parse(text, &problem);
    QCOMPARE(formula.has_value(), outcome != Refused);
    QCOMPARE(problem.isEmpty(), outcome != Refused);
    if (formula)
        QCOMPARE(formula->evaluate(sampleInputs()),
                 outcome == Value ? std::optional<double>(value) : std::nullopt);
}

QTEST_GUILESS_MAIN(TestFormula)
#include "tst_formula.moc"
