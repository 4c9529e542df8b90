// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

namespace ReportVerb {

// report --from YYYY-MM --to YYYY-MM --user NAME --password PW [--settings FILE] [--tab N]
//        [--compare years|periods --count N] --out FILE.html|FILE.pdf
// Produces a range and writes the report the Print command shows for a tab: the HTML page
// (with the graph's picture beside it) or the printed pages as a PDF file. Needs no display.
int report(const QStringList &arguments);

} // namespace ReportVerb
