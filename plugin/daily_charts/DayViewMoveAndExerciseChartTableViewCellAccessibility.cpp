#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/ChartElements.h"

namespace tavro {
namespace {

/// The cell of the move or exercise chart reads its title, its chart, then its auxiliary label.
class DayViewMoveAndExerciseChartTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "DayViewMoveAndExerciseChartTableViewCellAccessibility";
  static constexpr Name target = "TavroApp.DayViewMoveAndExerciseChartTableViewCell";

  id accessibilityElements() {
    const id labelPair = safeValueForKey(self, "labelPair");
    annotateLabelPair(labelPair);
    return axArrayByIgnoringNilElements(
        {labelPair, safeValueForKey(self, "chartView"), safeValueForKey(self, "auxiliaryLabel")});
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("TavroApp.DayViewMoveAndExerciseChartTableViewCell", "chartView", "@"),
    instanceMethod("TavroApp.DayViewMoveAndExerciseChartTableViewCell", "auxiliaryLabel", "@"),
    instanceMethod("TavroApp.DayViewMoveAndExerciseChartTableViewCell", "labelPair", "@"),
    classExists("TavroApp.DayViewTitleAndValueLabelPair"),
};

using Category = DayViewMoveAndExerciseChartTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
