// Veltrix — KPI dashboard for small businesses.
#include "kpievaluation.h"

#include "common/numberformat.h"
#include "common/rounding.h"
#include "engine/usualsign.h"

using namespace Qt::StringLiterals;

namespace KpiEvaluation {

namespace {

double elementNumber(QString element, QChar marker, const NumberFormat &numbers)
{
    return numbers.toNumber(element.remove(marker));
}

double oneDecimal(double value)
{
    return Rounding::halfAwayFromZero(value, 1);
}

} // namespace

Result evaluateBenchmark(const QString &benchmark, double actual, const NumberFormat &numbers,
                         Result result)
{
    const QStringList elements = benchmark.split(u',');
    if (actual == 0.0 || benchmark.isEmpty())
        return result;

    const QString &first = elements.first();
    if (first.contains(u'<')) {
        result.optimal = elementNumber(first, u'<', numbers);
        result.variant = oneDecimal(result.optimal - actual);
        result.optimalType = AtMost;
    } else if (first.contains(u'>')) {
        result.optimal = elementNumber(first, u'>', numbers);
        result.variant = oneDecimal(actual - result.optimal);
        result.optimalType = AtLeast;
    }
    const double firstVariant = result.variant;

    double variant = firstVariant;
    if (firstVariant < 0 && elements.size() > 1) {
        const QString &second = elements.at(1);
        if (second.contains(u'<'))
            variant = oneDecimal(actual - elementNumber(second, u'<', numbers));
        else if (second.contains(u'>'))
            variant = oneDecimal(elementNumber(second, u'>', numbers) - actual);
    }
    result.band = firstVariant >= 0 ? Green : (variant >= 0 ? Yellow : Red);
    result.variant = firstVariant;
    return result;
}

Result evaluateField(qint64 fieldId, const QString &benchmark, double actual,
                     const NumberFormat &numbers)
{
    Result result = evaluateBenchmark(benchmark, actual, numbers);
    if (UsualSign::isUnusual(fieldId, actual))
        result.band = Red;
    return result;
}

QString benchmarkCellText(const QString &benchmark)
{
    if (benchmark.isEmpty())
        return benchmark;
    return benchmark.split(u',').first() + u'%';
}

} // namespace KpiEvaluation
