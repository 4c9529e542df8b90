// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "engine/rangeselection.h"

#include <QDate>

class AppContext;

// Turns a choice of months into figures in slot 0: makes sure the accounting package can be
// reached (opening the configured data file when nothing is open), checks the range, loads it
// and remembers the choice for the next start. The windows rebuild their views afterwards.
class ProduceCommand
{
public:
    using Selection = RangeSelection::Selection;
    enum class Outcome { Produced, NoSource, InvalidRange, Failed };

    explicit ProduceCommand(AppContext &context);

    // The window remembers the range for its next start; a scripted run leaves the user's
    // settings alone unless asked.
    enum class Remember { Range, Nothing };
    Outcome produce(const Selection &selection, Remember remember = Remember::Range);

    // The first day of the first month and the last day of the last month.
    static QDate rangeStart(const Selection &selection);
    static QDate rangeEnd(const Selection &selection);

private:
    AppContext &m_context;
};
