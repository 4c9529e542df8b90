// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "engine/rangeloader.h"
#include "users/loginsession.h"
#include "views/tabviewbuilder.h"

class AppContext;
class GridModel;

// The core's workers over one run's state, for the windows and verbs that hold the context;
// the workers themselves know only the pieces they use.
namespace ContextWiring {

// Loads into the context's period data set from its accounting source as it is now.
RangeLoader rangeLoader(AppContext &context);
TabViewBuilder tabViewBuilder(AppContext &context, GridModel &grid);
LoginSession loginSession(AppContext &context);

} // namespace ContextWiring
