// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QLocale>
#include <QString>
#include <QVariant>

// Money and numbers as the user's region writes them. Every text this class writes, it reads
// back: grouped digits, the region's negative forms and the dollar sign included.
class NumberFormat
{
public:
    // The user's locale; a bare C or POSIX locale (a server without regional settings)
    // stands for English (Australia).
    NumberFormat();
    explicit NumberFormat(const QLocale &locale)
        : m_locale(locale)
    {}

    static QLocale userLocale();
    const QLocale &locale() const { return m_locale; }

    // "$ 1,234.50", "$ -1,234.50"; zero is "$ -" ("0.00" without the symbol); not a number gives
    // empty text.
    QString formatMoney(const QVariant &value, bool withSymbol = true) const;
    // The value as a number, or 0 for anything that is not one (empty text included).
    double toNumber(const QVariant &value) const;
    // The value as a number, or nothing when it is not one.
    std::optional<double> parseNumber(const QVariant &value) const;

private:
    std::optional<double> parseText(QString text) const;

    QLocale m_locale;
};
