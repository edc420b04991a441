#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIControls.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// A row of the splits says its unit, its distance where one is shown, and its pace as a duration.
class CHWorkoutDetailSplitTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailSplitTableViewCellAccessibility";
  static constexpr Name target = "CHWorkoutDetailSplitTableViewCell";

  id accessibilityLabel() {
    return __AXStringForVariables(
        {accessibilityLabelOf(safeUIViewForKey(self, "_unitLabel")), shownDistance(),
         accessibilityAttributedStringForPaceContainingString(
             accessibilityLabelOf(safeUIViewForKey(self, "_paceLabel")))});
  }

 private:
  /// Whole splits keep an old distance in a label that is hidden.
  id shownDistance() {
    const auto label = typedRead<UILabel>(self, "_distanceLabel");
    return trySend<bool>(label, "_accessibilityViewIsVisible") ? trySend<id>(label, "text") : id();
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHWorkoutDetailSplitTableViewCell", "_unitLabel", "UILabel"),
    instanceVariable("CHWorkoutDetailSplitTableViewCell", "_distanceLabel", "UILabel"),
    instanceVariable("CHWorkoutDetailSplitTableViewCell", "_paceLabel", "UILabel"),
};

using Category = CHWorkoutDetailSplitTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityLabel>(
        "accessibilityLabel");

}  // namespace
}  // namespace tavro
