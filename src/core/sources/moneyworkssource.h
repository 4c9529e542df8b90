// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "accountingsource.h"
#include "moneyworkslink.h"

#include "common/settings.h"

#include <functional>
#include <memory>

class NumberFormat;
class Prompter;

// MoneyWorks figures: account movements and the period end are MoneyWorks expressions
// evaluated in the open document, the jobs count comes from an export of the range's debtor
// invoices.
class MoneyWorksSource final : public AccountingSource
{
public:
    using LinkFactory = std::function<std::unique_ptr<MoneyWorksLink>()>;

    MoneyWorksSource(const Settings &settings, Prompter &prompter, const NumberFormat &numbers,
                     LinkFactory makeLink);
    ~MoneyWorksSource() override;

    bool isReachable() override;
    std::optional<DbError> openDataFile() override;
    void disconnect() override;

    double accountMovement(const QString &accountCode, const QDate &from, const QDate &to) override;
    qint16 jobsCount(const QDate &from, const QDate &to) override;
    std::optional<QDate> currentPeriodEnd() override;

    // The texts sent to MoneyWorks, exactly as they are built.
    QString movementExpression(const QString &accountCode, const QDate &from,
                               const QDate &to) const;
    QString jobsSearch(const QDate &from, const QDate &to) const;
    QString jobsFile() const { return m_settings.jobsFile; }

    // The distinct references of an export's invoice lines, leaving out "EI" lines.
    static int countJobReferences(const QString &exportText);

private:
    MoneyWorksLink &link();

    const Settings &m_settings;
    Prompter &m_prompter;
    const NumberFormat &m_numbers;
    LinkFactory m_makeLink;
    std::unique_ptr<MoneyWorksLink> m_link;
};
