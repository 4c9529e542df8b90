// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

namespace ProduceVerb {

// produce --from YYYY-MM --to YYYY-MM --user NAME --password PW [--settings FILE]
//         [--compare years|periods --count N] [--format csv|json]
// Produces a range as the Produce command does and prints the figures of every line of the
// "All" tab the user may see, per period slot.
int produce(const QStringList &arguments);

} // namespace ProduceVerb
