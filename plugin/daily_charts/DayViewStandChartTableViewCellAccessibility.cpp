#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/ChartElements.h"

namespace tavro {
namespace {

/// The stand chart's cell reads its title, its chart, then its idle hours. It names its title by no
/// key, so the title is found by its class.
class DayViewStandChartTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "DayViewStandChartTableViewCellAccessibility";
  static constexpr Name target = "TavroApp.DayViewStandChartTableViewCell";

  id accessibilityElements() {
    const Ref<NSArray> pairs = descendantsOfClass(self, "TavroApp.DayViewTitleAndValueLabelPair");
    const id labelPair = pairs ? pairs->firstObject() : id();
    annotateLabelPair(labelPair);
    return axArrayByIgnoringNilElements(
        {labelPair, safeValueForKey(self, "chartView"), safeValueForKey(self, "idleHoursLabel")});
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("TavroApp.DayViewStandChartTableViewCell", "chartView", "@"),
    instanceMethod("TavroApp.DayViewStandChartTableViewCell", "idleHoursLabel", "@"),
    classExists("TavroApp.DayViewTitleAndValueLabelPair"),
};

using Category = DayViewStandChartTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
