#pragma once

#include "platform/accessibility/BundleLoader.h"

namespace tavro {

/// Makes activity summaries answer
/// `accessibilityDescriptionForPercentages:exercisingPercentage:standingPercentage:arePercentagesCapped:`
/// with the function `accessibilityDescriptionForPercentages` that the bundle exports. Without that
/// function nothing happens, and days have no ring description.
void letSummariesDescribeRings(const LoadedBundle& bundle);

}  // namespace tavro
