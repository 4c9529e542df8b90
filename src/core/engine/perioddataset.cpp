// Veltrix — KPI dashboard for small businesses.
#include "perioddataset.h"

#include "rounding.h"

#include "app/numberformat.h"

#include <QLocale>

#include <cmath>

using namespace Qt::StringLiterals;

PeriodDataSet::PeriodDataSet(const NumberFormat &numberFormat)
    : m_numberFormat(numberFormat)
{}

void PeriodDataSet::setCurrentSlot(quint8 slot)
{
    Q_ASSERT(slot < SlotCount);
    m_current = slot < SlotCount ? slot : 0;
}

int PeriodDataSet::findFieldPos(const QStringList &ids, qint64 id)
{
    for (int i = 0; i < ids.size(); ++i) {
        bool ok = false;
        const double number = ids[i].trimmed().toDouble(&ok);
        if (ok && number == double(id))
            return i + 1;
    }
    return 0;
}

double PeriodDataSet::getFieldValue(qint64 id) const
{
    const Slot &slot = current();
    const int pos = findFieldPos(slot.fieldIds, id);
    if (pos == 0)
        return 0.0;
    const double value = readNumber(slot.fieldValues.value(pos - 1));
    const bool accountFigure = slot.fieldTypes.value(pos - 1).trimmed() == u"2"_s;
    return accountFigure ? -value : value;
}

double PeriodDataSet::getFieldAbs(qint64 id) const
{
    const Slot &slot = current();
    const int pos = findFieldPos(slot.fieldIds, id);
    return pos == 0 ? 0.0 : readNumber(slot.fieldAbs.value(pos - 1));
}

double PeriodDataSet::sumFieldValues(qint64 first, qint64 last) const
{
    double sum = 0.0;
    for (qint64 id = first; id <= last; ++id)
        sum += getFieldValue(id);
    return sum;
}

void PeriodDataSet::storeFieldValue(qint64 id, double value, int typeCode)
{
    Slot &slot = current();
    slot.fieldIds << QString::number(id);
    slot.fieldTypes << QString::number(typeCode);
    if (value == 0.0) {
        slot.fieldValues << QString();
        slot.fieldAbs << QString();
        return;
    }
    const double rounded = roundForStorage(value, typeCode);
    slot.fieldValues << numberText(rounded);
    slot.fieldAbs << numberText(std::fabs(rounded));
}

void PeriodDataSet::storeAccountFigure(qint64 id, double total, int fieldType)
{
    Slot &slot = current();
    slot.fieldIds << QString::number(id);
    slot.fieldAbs << numberText(std::fabs(total));
    slot.fieldValues << numberText(total);
    slot.fieldTypes << QString::number(fieldType);
}

double PeriodDataSet::roundForStorage(double value, int typeCode)
{
    double rounded = 0.0;
    switch (typeCode) {
    case Money:
    case ComputedMoney:
        rounded = Rounding::halfAwayFromZero(value, 2);
        break;
    case Ratio:
        rounded = Rounding::halfAwayFromZero(value * 100.0, 1);
        break;
    case AccountFigure:
        rounded = Rounding::halfAwayFromZero(value, 1);
        break;
    case Count:
        rounded = Rounding::halfToEven(value, 0);
        break;
    case OneDecimal:
        rounded = Rounding::halfToEven(value, 1);
        break;
    default:
        return 0.0;
    }
    // Never keep a negative zero: it would print as "-0".
    return rounded == 0.0 ? 0.0 : rounded;
}

QString PeriodDataSet::numberText(double value)
{
    if (value == 0.0)
        return u"0"_s;
    return QLocale::c().toString(value, 'g', QLocale::FloatingPointShortest);
}

QString PeriodDataSet::formatFieldValue(double value, int typeCode, bool storage) const
{
    const QLocale &locale = m_numberFormat.locale();
    if (storage) {
        switch (typeCode) {
        case Money:
        case ComputedMoney:
            return locale.toString(Rounding::halfAwayFromZero(value, 2), 'f', 2);
        case Ratio:
            return locale.toString(Rounding::halfAwayFromZero(value * 100.0, 1), 'f', 1);
        case AccountFigure:
            return locale.toString(Rounding::halfAwayFromZero(value, 1), 'f', 1);
        case Count:
            return locale.toString(Rounding::halfToEven(value, 0), 'f', 0);
        case OneDecimal:
            return locale.toString(Rounding::halfToEven(value, 1), 'f', 1);
        default:
            return {};
        }
    }
    switch (typeCode) {
    case 1:
        return {};
    case 3:
        return locale.toString(Rounding::halfToEven(value, 1), 'f', 1) + u'%';
    case 4:
        return locale.toString(Rounding::halfToEven(value, 0), 'f', 0);
    default:
        return m_numberFormat.formatMoney(value, true);
    }
}

double PeriodDataSet::readNumber(const QString &text) const
{
    // Figures are written in one region-independent form; anything else (a hand-edited cache)
    // is read the way the user's region writes numbers.
    bool ok = false;
    const double number = QLocale::c().toDouble(text.trimmed(), &ok);
    if (ok && std::isfinite(number))
        return number;
    return m_numberFormat.toNumber(text);
}
