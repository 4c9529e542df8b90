// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QDateTime>

#include <optional>

// Today's date and time: the system's, or a fixed moment so that rules that depend on the
// date can be tested.
class Clock
{
public:
    Clock() = default;
    static Clock fixedAt(const QDateTime &moment)
    {
        Clock clock;
        clock.m_fixed = moment;
        return clock;
    }

    QDateTime now() const { return m_fixed.value_or(QDateTime::currentDateTime()); }
    QDate today() const { return now().date(); }

private:
    std::optional<QDateTime> m_fixed;
};
