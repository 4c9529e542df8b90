// Veltrix — KPI dashboard for small businesses.
#include "perioddataset.h"

#include "common/rounding.h"

#include "common/numberformat.h"

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

namespace {

// Whether the text is an integer written the way QString::number writes one; such a text
// equals another number numerically only when it equals its text.
bool isCanonicalInteger(const QString &text)
{
    const qsizetype start = text.startsWith(u'-') ? 1 : 0;
    if (text.size() == start || (text.size() > start + 1 && text.at(start) == u'0'))
        return false;
    for (qsizetype i = start; i < text.size(); ++i) {
        if (!text.at(i).isDigit())
            return false;
    }
    return true;
}

} // namespace

int PeriodDataSet::findFieldPos(const QStringList &ids, qint64 id)
{
    const QString idText = QString::number(id);
    for (int i = 0; i < ids.size(); ++i) {
        const QString &text = ids[i];
        if (text == idText)
            return i + 1;
        if (isCanonicalInteger(text))
            continue;
        bool ok = false;
        const double number = text.trimmed().toDouble(&ok);
        if (ok && number == double(id))
            return i + 1;
    }
    return 0;
}

int PeriodDataSet::Slot::findFieldPos(qint64 id) const
{
    if (m_indexed > fieldIds.size() || m_numbers.size() > fieldIds.size()) {
        m_firstPosition.clear();
        m_numbers.clear();
        m_indexed = 0;
        m_irregular = false;
    }
    for (; m_indexed < fieldIds.size() && !m_irregular; ++m_indexed) {
        const QString &text = fieldIds.at(m_indexed);
        if (!isCanonicalInteger(text)) {
            m_irregular = true;
            break;
        }
        const qint64 entryId = text.toLongLong();
        if (!m_firstPosition.contains(entryId))
            m_firstPosition.insert(entryId, m_indexed + 1);
    }
    if (m_irregular)
        return PeriodDataSet::findFieldPos(fieldIds, id);
    return m_firstPosition.value(id, 0);
}

double PeriodDataSet::getFieldValue(qint64 id) const
{
    const Slot &slot = current();
    const int pos = slot.findFieldPos(id);
    if (pos == 0)
        return 0.0;
    const Slot::Numbers &numbers = numbersAt(slot, pos);
    return numbers.accountFigure ? -numbers.value : numbers.value;
}

const PeriodDataSet::Slot::Numbers &PeriodDataSet::numbersAt(const Slot &slot, int pos) const
{
    // The texts are read once; reading them again for every formula would cost more than
    // everything else a load does outside the accounting queries.
    while (slot.m_numbers.size() < pos) {
        const int i = int(slot.m_numbers.size());
        slot.m_numbers.append({readNumber(slot.fieldValues.value(i)),
                               readNumber(slot.fieldAbs.value(i)),
                               slot.fieldTypes.value(i).trimmed() == u"2"_s});
    }
    return slot.m_numbers.at(pos - 1);
}

double PeriodDataSet::getFieldAbs(qint64 id) const
{
    const Slot &slot = current();
    const int pos = slot.findFieldPos(id);
    return pos == 0 ? 0.0 : numbersAt(slot, pos).magnitude;
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
    const QString text = numberText(rounded);
    slot.fieldValues << text;
    slot.fieldAbs << (text.startsWith(u'-') ? text.sliced(1) : text);
}

void PeriodDataSet::storeAccountFigure(qint64 id, double total, int fieldType)
{
    Slot &slot = current();
    slot.fieldIds << QString::number(id);
    const QString text = numberText(total);
    slot.fieldAbs << (text.startsWith(u'-') ? text.sliced(1) : text);
    slot.fieldValues << text;
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
        // Cents rounded as stored amounts are, half away from zero in decimal: an average of
        // -5,895.235 is -5,895.24, not what its binary neighbour would round to.
        return m_numberFormat.formatMoney(Rounding::halfAwayFromZero(value, 2), true);
    }
}

double PeriodDataSet::readNumber(const QString &text) const
{
    // Figures are written in one region-independent form; anything else (a hand-edited cache)
    // is read the way the user's region writes numbers.
    if (text.isEmpty())
        return 0.0;
    bool ok = false;
    const double number = text.toDouble(&ok);
    if (ok && std::isfinite(number))
        return number;
    return m_numberFormat.toNumber(text);
}
