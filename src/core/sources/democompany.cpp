// Veltrix — KPI dashboard for small businesses.
#include "democompany.h"

#include "companyfilewriter.h"

#include <QHash>

#include <cmath>

using namespace Qt::StringLiterals;

namespace DemoCompany {

namespace {

// A small generator of our own, so the demo is the same on every platform and library.
class Random
{
public:
    explicit Random(quint64 seed)
        : m_state(seed)
    {}

    quint64 next()
    {
        quint64 z = (m_state += 0x9E3779B97F4A7C15ull);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
        return z ^ (z >> 31);
    }
    // Uniform in [0, 1).
    double uniform() { return double(next() >> 11) * (1.0 / 9007199254740992.0); }
    double between(double low, double high) { return low + (high - low) * uniform(); }
    bool chance(double probability) { return uniform() < probability; }
    // Roughly normal around 1 with the given spread, never below 0.2.
    double around(double spread)
    {
        const double sum = uniform() + uniform() + uniform() + uniform() - 2.0;
        return std::max(0.2, 1.0 + sum * spread * 1.7);
    }

private:
    quint64 m_state;
};

double cents(double amount)
{
    return std::round(amount * 100.0) / 100.0;
}

struct Account
{
    const char *number;
    const char *name;
};

constexpr Account ChartOfAccounts[] = {
    {"1-1100", "Cheque Account"},
    {"1-1200", "Trade Debtors"},
    {"2-1100", "Trade Creditors"},
    {"2-1400", "Wages Payable"},
    {"4-1100", "Panel Labour"},
    {"4-1200", "Paint Labour"},
    {"4-1300", "Paint & Materials Charged"},
    {"4-1400", "Parts Sales"},
    {"4-1500", "Sublet Repairs"},
    {"4-1600", "Towing & Storage"},
    {"4-1700", "Other Workshop Income"},
    {"4-1900", "Discounts Allowed"},
    {"5-1100", "Panel Wages"},
    {"5-1200", "Paint Wages"},
    {"5-1300", "Panel Consumables"},
    {"5-1400", "Parts Purchases"},
    {"5-2100", "Paint Purchases"},
    {"5-2200", "Paint Sundries"},
    {"5-2300", "Spray Booth Running Costs"},
    {"5-3100", "Sublet Costs"},
    {"5-3200", "Towing Costs"},
    {"5-3300", "Freight Inwards"},
    {"5-3900", "Stock Adjustments"},
    {"5-4100", "Warranty & Rework"},
    {"5-4200", "Courtesy Cars"},
    {"6-1000", "Office Wages"},
    {"6-1100", "Superannuation"},
    {"6-1200", "Workers Compensation"},
    {"6-2000", "Rent"},
    {"6-3000", "Electricity & Gas"},
    {"6-4000", "Insurance"},
    {"6-5000", "Advertising"},
    {"6-6000", "Motor Vehicles"},
    {"6-7000", "Phone & Internet"},
    {"6-8000", "Accounting Fees"},
    {"6-9000", "Sundry Expenses"},
};

class Shop
{
public:
    Shop(CompanyFileWriter &writer, const Options &options)
        : m_writer(writer)
        , m_options(options)
        , m_random(options.seed)
    {
        for (const Account &account : ChartOfAccounts) {
            m_ids.insert(QLatin1StringView(account.number),
                         writer.addAccount(QLatin1StringView(account.number),
                                           QLatin1StringView(account.name)));
        }
    }

    void run()
    {
        for (QDate day = m_options.first; day <= m_options.last; day = day.addDays(1)) {
            if (day.dayOfWeek() <= 5)
                workingDay(day);
            if (day.dayOfWeek() == 5)
                payday(day);
            if (day.day() == 1)
                monthStart(day);
            if (day.addDays(1).day() == 1)
                monthEnd(day);
        }
    }

private:
    // How busy the shop is on a day, 1.0 being an ordinary day of the first year.
    double activity(const QDate &day) const
    {
        static constexpr double Season[] = {0.80, 0.92, 1.0, 0.98, 1.04, 1.14,
                                            1.18, 1.12, 1.0, 0.97, 1.0,  1.08};
        const double years = m_options.first.daysTo(day) / 365.25;
        double level = std::pow(1.06, years) * Season[day.month() - 1];
        if (day.year() == m_options.badYear)
            level *= 0.74;
        return level;
    }
    int panelBeaters(const QDate &day) const
    {
        return day.year() < 2022 ? 4 : (day.year() < 2025 ? 5 : 6);
    }
    int painters(const QDate &day) const { return day.year() < 2024 ? 2 : 3; }
    double wageInflation(const QDate &day) const
    {
        return std::pow(1.03, day.year() - m_options.first.year());
    }

    void post(const char *account, const QDate &day, double amount, const QString &memo)
    {
        m_writer.addJournalLine(m_ids.value(QLatin1StringView(account)), day, cents(amount), memo);
    }
    // A purchase on account: the expense is debited, the creditor credited.
    void purchase(const char *account, const QDate &day, double amount, const QString &memo)
    {
        const double value = cents(amount);
        if (value == 0.0)
            return;
        post(account, day, value, memo);
        post("2-1100", day, -value, memo);
    }

    void workingDay(const QDate &day)
    {
        const double expected = 3.1 * activity(day);
        int jobs = int(std::floor(expected + m_random.between(-1.5, 1.5) + 0.5));
        jobs = std::max(0, jobs);
        for (int job = 0; job < jobs; ++job)
            invoice(day);
    }

    void invoice(const QDate &day)
    {
        const QString number = u"RO%1"_s.arg(++m_invoiceNumber, 6, 10, QLatin1Char('0'));
        const double severity = m_random.around(0.45);
        const double panelHours = std::round(9.8 * severity * m_random.around(0.25) * 10) / 10;
        const double paintHours = std::round(5.4 * severity * m_random.around(0.25) * 10) / 10;
        const double panel = panelHours * PanelRate;
        const double paint = paintHours * PaintRate;
        const double materials = paintHours * 38.0 * m_random.around(0.08);
        const double parts = 1300.0 * severity * m_random.around(0.5);
        const double sublet = m_random.chance(0.2) ? 360.0 * m_random.around(0.5) : 0.0;
        const double towing = m_random.chance(0.15) ? 230.0 * m_random.around(0.3) : 0.0;
        const double other = m_random.chance(0.05) ? 85.0 * m_random.around(0.4) : 0.0;
        const double gross = panel + paint + materials + parts + sublet + towing + other;
        const double discount = m_random.chance(0.1) ? gross * m_random.between(0.01, 0.04) : 0.0;

        struct Line
        {
            const char *account;
            double amount;
        };
        const Line lines[] = {{"4-1100", panel}, {"4-1200", paint},  {"4-1300", materials},
                              {"4-1400", parts}, {"4-1500", sublet}, {"4-1600", towing},
                              {"4-1700", other}};
        double debtor = 0.0;
        for (const Line &line : lines) {
            if (cents(line.amount) == 0.0)
                continue;
            post(line.account, day, -line.amount, number);
            debtor += cents(line.amount);
        }
        if (cents(discount) != 0.0) {
            post("4-1900", day, discount, number);
            debtor -= cents(discount);
        }
        post("1-1200", day, debtor, number);
        m_writer.addSale(day, number);

        // What the job cost outside the workshop's wages.
        const double partsMargin = m_random.between(0.70, 0.80);
        purchase("5-1400", day, parts * partsMargin, number);
        if (sublet > 0)
            purchase("5-3100", day, sublet * m_random.between(0.8, 0.9), number);
        if (towing > 0 && m_random.chance(0.6))
            purchase("5-3200", day, towing * m_random.between(0.55, 0.75), number);

        m_panelHours += panelHours;
        m_paintHours += paintHours;
    }

    void payday(const QDate &day)
    {
        const double inflation = wageInflation(day);
        const double panelWages =
            panelBeaters(day) * 38.0 * 41.0 * inflation * m_random.around(0.03);
        const double paintWages = painters(day) * 38.0 * 43.5 * inflation * m_random.around(0.03);
        const double officeWages = 3 * 38.0 * 40.0 * inflation;
        const double superannuation = (panelWages + paintWages + officeWages) * 0.11;
        const struct
        {
            const char *account;
            double amount;
        } pays[] = {{"5-1100", panelWages},
                    {"5-1200", paintWages},
                    {"6-1000", officeWages},
                    {"6-1100", superannuation}};
        for (const auto &pay : pays) {
            post(pay.account, day, pay.amount, u"Pay run"_s);
            post("1-1100", day, -pay.amount, u"Pay run"_s);
        }

        // Workshop materials are bought weekly, in step with the work done.
        purchase("5-1300", day, m_panelHours * m_random.between(5.0, 7.5), u"Panel consumables"_s);
        purchase("5-2100", day, m_paintHours * 18.0 * m_random.around(0.12), u"Paint order"_s);
        purchase("5-2200", day, m_paintHours * m_random.between(5.0, 9.5), u"Paint sundries"_s);
        purchase("5-3300", day, 55.0 + m_panelHours * 1.4 * m_random.around(0.2), u"Freight"_s);
        m_panelHours = 0.0;
        m_paintHours = 0.0;
    }

    void monthStart(const QDate &day)
    {
        const double inflation = wageInflation(day);
        purchase("6-2000", day, 14500.0 * (day.year() >= 2024 ? 1.12 : 1.0), u"Rent"_s);
        purchase("6-4000", day, 2600.0 * inflation, u"Insurance"_s);
        purchase("6-7000", day, 310.0, u"Phone & internet"_s);
        purchase("6-6000", day, 1150.0 * m_random.around(0.2), u"Vehicles"_s);
        purchase("6-5000", day, 2400.0 * m_random.around(0.5), u"Advertising"_s);
        purchase("5-4200", day, 650.0 * m_random.around(0.3), u"Courtesy cars"_s);
    }

    void monthEnd(const QDate &day)
    {
        purchase("5-2300", day, 1900.0 * m_random.around(0.25) * activity(day), u"Booth gas"_s);
        purchase("6-9000", day, 540.0 * m_random.around(0.4), u"Sundries"_s);
        if (m_random.chance(0.35))
            purchase("5-4100", day, 900.0 * m_random.around(0.6), u"Rework"_s);
        if (day.month() % 3 == 0) {
            purchase("6-3000", day, 3900.0 * m_random.around(0.15), u"Power and gas"_s);
            purchase("6-8000", day, 2100.0, u"Accountant"_s);
            purchase("6-1200", day, 3300.0 * wageInflation(day), u"Workers compensation"_s);
            // Stocktake: the count differs from the books, either way.
            const double adjustment = m_random.between(-1400.0, 900.0);
            post("5-3900", day, adjustment, u"Stocktake"_s);
            post("1-1100", day, -adjustment, u"Stocktake"_s);
        }
    }

    CompanyFileWriter &m_writer;
    const Options &m_options;
    Random m_random;
    QHash<QString, qint64> m_ids;
    int m_invoiceNumber = 0;
    double m_panelHours = 0.0;
    double m_paintHours = 0.0;
};

} // namespace

std::optional<QString> write(const QString &path, const Options &options)
{
    CompanyFileWriter writer;
    if (auto problem = writer.create(path))
        return problem;
    Shop(writer, options).run();
    return writer.finish();
}

} // namespace DemoCompany
