// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QDate>
#include <QString>

#include <optional>

// The accounting package the figures come from, as the range loader and the produce command
// see it. Reading figures never fails its caller: a failure is reported to the user by the
// source itself and the figure counts as 0.
class AccountingSource
{
public:
    virtual ~AccountingSource() = default;

    // Whether figures can be read now without opening the configured data file first.
    virtual bool isReachable() = 0;
    // Opens the configured data file (or document), replacing what was open.
    virtual std::optional<DbError> openDataFile() = 0;
    // Lets go of the package: closes the data file's connection or releases the running
    // application. Safe to call when nothing is open.
    virtual void disconnect() = 0;

    // The movement of one account over the inclusive range.
    virtual double accountMovement(const QString &accountCode, const QDate &from,
                                   const QDate &to) = 0;
    // The number of jobs (repair orders) done in the range.
    virtual qint16 jobsCount(const QDate &from, const QDate &to) = 0;
    // The last day the data file's current accounting period allows, for packages that limit
    // ranges that way: nothing when the package has no such limit, an invalid date when the
    // limit could not be read.
    virtual std::optional<QDate> currentPeriodEnd() { return std::nullopt; }
};
