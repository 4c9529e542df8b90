// Veltrix — KPI dashboard for small businesses.
#include "numberformat.h"

#include <cmath>

using namespace Qt::StringLiterals;

namespace {

const auto Dollar = u"$"_s;

bool isNumericType(const QVariant &value)
{
    switch (value.typeId()) {
    case QMetaType::Int:
    case QMetaType::UInt:
    case QMetaType::Long:
    case QMetaType::ULong:
    case QMetaType::LongLong:
    case QMetaType::ULongLong:
    case QMetaType::Short:
    case QMetaType::UShort:
    case QMetaType::Double:
    case QMetaType::Float:
        return true;
    default:
        return false;
    }
}

// Removes one currency symbol from either end of the text.
QString withoutCurrencySymbol(QString text, const QString &localSymbol)
{
    for (const QString &symbol : {Dollar, localSymbol}) {
        if (symbol.isEmpty())
            continue;
        if (text.startsWith(symbol))
            return text.sliced(symbol.size()).trimmed();
        if (text.endsWith(symbol))
            return text.chopped(symbol.size()).trimmed();
    }
    return text;
}

} // namespace

NumberFormat::NumberFormat()
    : m_locale(userLocale())
{}

QLocale NumberFormat::userLocale()
{
    const QLocale system = QLocale::system();
    if (system.language() == QLocale::C)
        return QLocale(QLocale::English, QLocale::Australia);
    return system;
}

QString NumberFormat::formatMoney(const QVariant &value, bool withSymbol) const
{
    const std::optional<double> number = parseNumber(value);
    if (!number)
        return {};
    if (*number == 0.0)
        return withSymbol ? u"$ -"_s : u"0.00"_s;
    // The region's digits and grouping, but always a minus sign: a region's accounting
    // brackets are easily read as an ordinary amount, and a loss must not pass for a profit.
    QString text =
        m_locale.toCurrencyString(std::fabs(*number), Dollar, 2).remove(Dollar).trimmed();
    if (*number < 0)
        text.prepend(m_locale.negativeSign());
    return withSymbol ? u"$ "_s + text : text;
}

double NumberFormat::toNumber(const QVariant &value) const
{
    return parseNumber(value).value_or(0.0);
}

std::optional<double> NumberFormat::parseNumber(const QVariant &value) const
{
    if (!value.isValid() || value.isNull())
        return std::nullopt;
    if (isNumericType(value)) {
        const double number = value.toDouble();
        return std::isfinite(number) ? std::optional<double>(number) : std::nullopt;
    }
    if (value.typeId() == QMetaType::QString || value.typeId() == QMetaType::QByteArray)
        return parseText(value.toString());
    return std::nullopt;
}

std::optional<double> NumberFormat::parseText(QString text) const
{
    const QString localSymbol = m_locale.currencySymbol();
    text = withoutCurrencySymbol(text.trimmed(), localSymbol);
    if (text.isEmpty())
        return std::nullopt;

    bool negative = false;
    if (text.size() > 2 && text.startsWith(u'(') && text.endsWith(u')')) {
        negative = true;
        text = withoutCurrencySymbol(text.sliced(1, text.size() - 2).trimmed(), localSymbol);
    }
    const QString minus = m_locale.negativeSign();
    for (const QString &sign : {u"-"_s, minus}) {
        if (negative || text.size() <= sign.size())
            break;
        if (text.startsWith(sign)) {
            negative = true;
            text = withoutCurrencySymbol(text.sliced(sign.size()).trimmed(), localSymbol);
        } else if (text.endsWith(sign)) {
            negative = true;
            text = withoutCurrencySymbol(text.chopped(sign.size()).trimmed(), localSymbol);
        }
    }
    if (negative && (text.startsWith(u'-') || text.startsWith(minus) || text.startsWith(u'+')))
        return std::nullopt;

    bool ok = false;
    double number = m_locale.toDouble(text, &ok);
    if (!ok)
        number = QLocale::c().toDouble(text, &ok);
    if (!ok || !std::isfinite(number))
        return std::nullopt;
    return negative ? -number : number;
}
