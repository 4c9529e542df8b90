// Veltrix — KPI dashboard for small businesses.
#pragma once

// Rounding of money and figures to a number of decimals. The decimal text of the value
// decides, not its binary neighbour: 1234.565 is stored in binary as 1234.56499999..., yet
// rounds to 1234.57 as a person reading it expects.
namespace Rounding {

double halfAwayFromZero(double value, int decimals);
double halfToEven(double value, int decimals);

} // namespace Rounding
