// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QDate>
#include <QString>

#include <optional>

// A plausible panel-and-paint repair shop, written as a company file whose chart of accounts
// matches the account codes of the KPI catalogue. It grows a little every year, is busier in
// winter and before Christmas, quieter in January, and has one bad year when it lost its main
// insurer's work; wages are paid weekly and overheads monthly or quarterly. The same options
// always give the same file.
namespace DemoCompany {

struct Options
{
    QDate first = QDate(2020, 1, 1);
    QDate last = QDate(2026, 11, 30);
    int badYear = 2023;
    quint64 seed = 0x5EED2020;
};

// The hourly rates the shop charges; the demo workspace enters them in the Hours table so
// that hours sold come out right.
inline constexpr double PanelRate = 98.0;
inline constexpr double PaintRate = 104.0;

std::optional<QString> write(const QString &path, const Options &options = {});

} // namespace DemoCompany
