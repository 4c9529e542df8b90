// Veltrix — KPI dashboard for small businesses.
// Filling and evaluating the "All" tab: every Field of the catalogue (123 rows) from a period
// loaded from the demo shop. Target: under 5 ms.

#include "demosession.h"

#include "app/contextwiring.h"
#include "grid/gridmodel.h"
#include "views/tabviewbuilder.h"

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QTextStream>

#include <algorithm>

using namespace Qt::StringLiterals;

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    const int rounds = argc > 1 ? QString::fromLocal8Bit(argv[1]).toInt() : 200;
    QTextStream out(stdout);

    DemoSession demo;
    if (!demo.open())
        return 1;
    AppContext &context = demo.context();

    GridModel grid;
    TabViewBuilder::addMainColumns(grid);
    TabViewBuilder builder = ContextWiring::tabViewBuilder(context, grid);
    builder.buildTabView(0, 0); // warm

    QList<double> timings;
    QElapsedTimer timer;
    for (int round = 0; round < rounds; ++round) {
        timer.start();
        builder.buildTabView(0, 0);
        timings << double(timer.nsecsElapsed()) / 1e6;
    }
    std::sort(timings.begin(), timings.end());
    const double median = timings.at(timings.size() / 2);
    out << "fill and evaluate the All tab: " << grid.rowCount() << " rows, " << rounds
        << " rounds\n";
    out << "  min    " << QString::number(timings.first(), 'f', 3) << " ms\n";
    out << "  median " << QString::number(median, 'f', 3) << " ms\n";
    out << "  max    " << QString::number(timings.last(), 'f', 3) << " ms\n";
    out << "  target 5 ms: " << (median < 5.0 ? "met" : "MISSED") << '\n';
    return 0;
}
