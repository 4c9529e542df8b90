// Veltrix — KPI dashboard for small businesses.
#include "contextwiring.h"

#include "appcontext.h"

namespace ContextWiring {

RangeLoader rangeLoader(AppContext &context)
{
    return RangeLoader(context.periodDataSet(), context.mainDatabase(), context.accountingSource(),
                       context.prompter(), context.numberFormat(), context.busyState());
}

TabViewBuilder tabViewBuilder(AppContext &context, GridModel &grid)
{
    return TabViewBuilder(context.periodDataSet(), context.mainDatabase(), context.prompter(),
                          context.numberFormat(), context.loginState(), grid);
}

LoginSession loginSession(AppContext &context)
{
    return LoginSession(context.mainDatabase(), context.prompter(), context.loginState());
}

} // namespace ContextWiring
