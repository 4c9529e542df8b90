// Veltrix — KPI dashboard for small businesses.
#include "comparisonranges.h"

using namespace Qt::StringLiterals;

namespace ComparisonRanges {

namespace {

QDate endOfMonth(const QDate &date)
{
    return QDate(date.year(), date.month(), 1).addMonths(1).addDays(-1);
}

} // namespace

QList<PeriodDataSet::Range> earlierRanges(const PeriodDataSet::Range &produced, Kind kind,
                                          int count)
{
    QList<PeriodDataSet::Range> ranges;
    const int months = (produced.end.year() - produced.start.year()) * 12 +
                       (produced.end.month() - produced.start.month()) + 1;
    PeriodDataSet::Range previous = produced;
    for (int i = 1; i <= std::min(count, PeriodDataSet::SlotCount - 1); ++i) {
        PeriodDataSet::Range range;
        if (kind == Kind::Years) {
            // Whole months back: a range ending on 28 February 2009 compares with one ending
            // on 29 February 2008, not a day short of it.
            range = {previous.start.addYears(-1), endOfMonth(previous.end.addYears(-1))};
        } else {
            range = {previous.start.addMonths(-months),
                     endOfMonth(previous.end.addMonths(-months))};
        }
        ranges << range;
        previous = range;
    }
    return ranges;
}

std::optional<Kind> kindFromText(const QString &text)
{
    if (text.compare(u"Years"_s, Qt::CaseInsensitive) == 0)
        return Kind::Years;
    if (text.compare(u"Periods"_s, Qt::CaseInsensitive) == 0)
        return Kind::Periods;
    return std::nullopt;
}

} // namespace ComparisonRanges
