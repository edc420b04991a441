#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/ChartElements.h"

namespace tavro {
namespace {

/// The weather of a workout is one element that says everything but the button, then the button.
/// Both are made once for the view.
class _CHWorkoutDetailWeatherViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "_CHWorkoutDetailWeatherViewAccessibility";
  static constexpr Name target = "_CHWorkoutDetailWeatherView";

  id accessibilityElements() {
    return elementsBuiltOnce(self, 2, [this](NSMutableArray& elements) { build(elements); });
  }

 private:
  void build(NSMutableArray& elements) {
    const id button = safeValueForKey(self, "_twcButton");
    std::vector<id> spoken;
    // The union begins at the view's own origin, which the element therefore always covers.
    CGRect covered = CGRectZero;
    if (const auto weather = as<UIView>(self)) {
      for (const Ref<UIView>& subview : weather->subviewList()) {
        if (subview == button) {
          continue;
        }
        spoken.emplace_back(subview);
        covered = CGRectUnion(covered, subview->frame());
      }
    }
    addChartElement(elements, as<UIView>(self), covered,
                    AXLabelForElements(arrayWithObjects(std::move(spoken))), nullptr);
    elements.axSafelyAddObject(button);
  }
};

constexpr HostCheck kHostContract[] = {
    kindOfClass("_CHWorkoutDetailWeatherView", "UIView"),
    instanceVariable("_CHWorkoutDetailWeatherView", "_weatherConditionImageView", "UIImageView"),
    instanceVariable("_CHWorkoutDetailWeatherView", "_twcButton", "UIButton"),
};

using Category = _CHWorkoutDetailWeatherViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
