// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QtGlobal>

// The sign each Field's figure has in a business that runs as it should, as the period data
// set reads it back: income, profits, margins and counts positive; costs negative (the
// accounting package keeps debits positive and account figures are read back negated). Costs
// are shown as magnitudes, so only a figure of the other sign — a loss, a negative margin, a
// cost account in credit — needs a minus sign and is judged poor.
namespace UsualSign {

enum Sign : qint8 { Unknown = 0, Positive = 1, Negative = -1 };

Sign of(qint64 fieldId);
// The figure's sign is opposite to the Field's usual one; zero and unknown Fields never are.
bool isUnusual(qint64 fieldId, double signedValue);
// The figure as it is shown: its magnitude while its sign is the usual one (or unknown), its
// magnitude with a minus sign when it is not.
double shown(qint64 fieldId, double signedValue);

} // namespace UsualSign
