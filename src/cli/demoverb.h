// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QStringList>

namespace DemoVerb {

// make-demo DIR [--use]: writes the demo workspace; with --use, also points this user's own
// settings at it when they name no accounting package yet.
int makeDemo(const QStringList &arguments);
// use-demo DIR [myob|moneyworks]: points this user's own settings at the demo workspace,
// reading the shop through the company file (MYOB) or through veltrix-mw-sim (MoneyWorks).
int useDemo(const QStringList &arguments);

} // namespace DemoVerb
