// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

namespace GifVerb {

// encode-gif IN OUT.gif [--transparent RRGGBB]
// Writes any picture Qt can read as the 8-bit GIF the graph snapshot uses.
int encodeGif(const QStringList &arguments);

} // namespace GifVerb
