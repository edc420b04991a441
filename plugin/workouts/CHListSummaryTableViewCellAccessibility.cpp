#include "platform/accessibility/Collections.h"
#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// The summary of the workouts list hands out those of its figures that are shown.
class CHListSummaryTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHListSummaryTableViewCellAccessibility";
  static constexpr Name target = "CHListSummaryTableViewCell";

  id accessibilityElements() {
    const Ref<NSArray> figures = axArrayByIgnoringNilElements(
        {safeUIViewForKey(self, "_numberOfWorkoutsLabel"), safeUIViewForKey(self, "_durationLabel"),
         safeUIViewForKey(self, "_activeEnergyLabel"), safeUIViewForKey(self, "_distanceLabel"),
         safeUIViewForKey(self, "_paceLabel")});
    return ax_filteredArrayUsingBlock(figures, [](const id& figure) {
      return trySend<bool>(figure, "_accessibilityViewIsVisible");
    });
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
