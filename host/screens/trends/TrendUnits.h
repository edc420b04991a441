#pragma once

#include <optional>
#include <string>

#include "platform/healthkit/HKUnit.h"

namespace tavro {

/// The unit in which the diary holds trends of that type; nil for a type that does not exist.
Ref<HKUnit> unitOfTrend(std::int64_t type);
/// An amount of that type as the screens show it ("546 KCAL"); "--" when nothing was recorded.
std::string shownAmount(std::int64_t type, std::optional<double> amount);

}  // namespace tavro
