// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class NumberFormat;

// How a percentage KPI stands against its benchmark. The benchmark text holds the optimal
// ("<30": good at 30 or less, ">45": good at 45 or more) and, after a comma, the limit beyond
// which the figure is red rather than yellow ("<30,>40").
namespace KpiEvaluation {

enum Band : quint8 { Red = 0, Yellow = 1, Green = 2 };
enum OptimalType : quint8 { NoOptimal = 0, AtMost = 1, AtLeast = 2 };

struct Result
{
    double optimal = 0.0;
    double variant = 0.0; // 0 or more: the optimal is met; to one decimal
    quint8 band = Red;
    quint8 optimalType = NoOptimal;
};

// Outputs a step does not reach keep what the caller passed in: an actual of 0 or an empty
// benchmark changes nothing.
Result evaluateBenchmark(const QString &benchmark, double actual, const NumberFormat &numbers,
                         Result result = {});

// A Field's figure judged against its benchmark: a figure whose sign is opposite to the
// Field's usual one (a negative margin) is red whatever its magnitude would say.
Result evaluateField(qint64 fieldId, const QString &benchmark, double actual,
                     const NumberFormat &numbers);

// The benchmark cell: the optimal element followed by "%".
QString benchmarkCellText(const QString &benchmark);

} // namespace KpiEvaluation
