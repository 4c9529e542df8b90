// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

namespace DemoVerb {

// make-demo DIR [--use]: writes the demo workspace; with --use, also points this user's own
// settings at it when they name no accounting package yet.
int makeDemo(const QStringList &arguments);

} // namespace DemoVerb
