#include <cmath>

#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/ChartElements.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

constexpr double kSecondsPerHour = 3600;

/// The stand chart is a container of one element for each hour that it shows.
class ActivityStandChartViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "ActivityStandChartViewAccessibility";
  static constexpr Name target = "TavroApp.ActivityStandChartView";

  id accessibilityElements() {
    const auto points = as<NSArray>(trySend<id>(self, "_accessibilityGraphData"));
    return elementsBuiltOnce(self, points ? points->count() : 0, [&](NSMutableArray& elements) {
      if (points) {
        build(elements, *points);
      }
    });
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    loadGraphData(self, "standChartPoints", "NSValue", kDayViewGraphElements);
  }

  id _accessibilityGraphData() { return _accessibilityValueForKey(self, kDayViewGraphElements); }

 private:
  void build(NSMutableArray& elements, const NSArray& points) {
    const auto chart = as<UIView>(self);
    if (!chart || points.count() == 0) {
      return;
    }
    const float height = std::floor(static_cast<float>(chart->frame().size.height));
    // Rounded up, so that the hours together reach over the whole chart.
    const float width = std::ceil(static_cast<float>(chart->frame().size.width) /
                                  static_cast<float>(points.count()));
    const Ref<NSString> active = localized("stand.goal.active");
    const Ref<NSString> inactive = localized("stand.goal.inactive");
    addDayParts(elements, chart, {points.count(), kSecondsPerHour, "ha", {width, height}},
                [&](std::size_t hour) { return amountAt(points, hour) > 0 ? active : inactive; });
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("TavroApp.ActivityStandChartView", "standChartPoints", "@"),
};

using Category = ActivityStandChartViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::accessibilityElements>("accessibilityElements")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation")
        .method<&Category::_accessibilityGraphData>("_accessibilityGraphData");

}  // namespace
}  // namespace tavro
