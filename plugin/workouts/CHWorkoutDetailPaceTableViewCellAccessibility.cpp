#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/healthkit/HKTypes.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// The pace cell says its title and, as its value, its pace as a duration.
class CHWorkoutDetailPaceTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailPaceTableViewCellAccessibility";
  static constexpr Name target = "CHWorkoutDetailPaceTableViewCell";

  void configureWithWorkout(const id& workout, const id& activity, const id& dataCalculator) {
    super.send<void>(workout, activity, dataCalculator);
    // Cycling shows a speed, which needs no annotation.
    if (trySend<HKWorkoutActivityType>(workout, "workoutActivityType") !=
        HKWorkoutActivityType::cycling) {
      trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
    }
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    const id pace = accessibilityAttributedStringForPaceContainingString(
        accessibilityLabelOf(safeUIViewForKey(self, "_valueLabel")));
    trySend<void>(
        self, "setAccessibilityLabel:", accessibilityLabelOf(safeValueForKey(self, "_titleLabel")));
    trySend<void>(self, "setAccessibilityValue:", pace);
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHWorkoutDetailPaceTableViewCell", "_titleLabel", "UILabel"),
    instanceVariable("CHWorkoutDetailPaceTableViewCell", "_valueLabel", "UILabel"),
    instanceMethod("CHWorkoutDetailPaceTableViewCell",
                   "configureWithWorkout:workoutActivity:dataCalculator:", "v", "@", "@", "@"),
};

using Category = CHWorkoutDetailPaceTableViewCellAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::configureWithWorkout>(
                                    "configureWithWorkout:workoutActivity:dataCalculator:")
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
