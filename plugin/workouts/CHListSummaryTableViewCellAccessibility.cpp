#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// In reading order.
constexpr Name kContainers[] = {"_numberOfWorkoutsLabel", "_durationLabel", "_activeEnergyLabel",
                                "_distanceLabel", "_paceLabel"};

/// The summary of the workouts list hands out those of its figures that are shown.
class CHListSummaryTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHListSummaryTableViewCellAccessibility";
  static constexpr Name target = "CHListSummaryTableViewCell";

  id accessibilityElements() {
    std::vector<id> visible;
    for (const Name key : kContainers) {
      const Ref<UIView> container = safeUIViewForKey(self, key);
      if (trySend<bool>(container, "_accessibilityViewIsVisible")) {
        visible.emplace_back(container);
      }
    }
    return arrayWithObjects(std::move(visible));
  }
};

constexpr HostCheck kHostContract[] = {
    kindOfClass("_CHWorkoutSummaryTabbedLabelContainer", "UIView"),
    instanceVariable("CHListSummaryTableViewCell", "_numberOfWorkoutsLabel",
                     "_CHWorkoutSummaryTabbedLabelContainer"),
    instanceVariable("CHListSummaryTableViewCell", "_activeEnergyLabel",
                     "_CHWorkoutSummaryTabbedLabelContainer"),
    instanceVariable("CHListSummaryTableViewCell", "_durationLabel",
                     "_CHWorkoutSummaryTabbedLabelContainer"),
    instanceVariable("CHListSummaryTableViewCell", "_distanceLabel",
                     "_CHWorkoutSummaryTabbedLabelContainer"),
    instanceVariable("CHListSummaryTableViewCell", "_paceLabel",
                     "_CHWorkoutSummaryTabbedLabelContainer"),
};

using Category = CHListSummaryTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
