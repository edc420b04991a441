#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// A workout's map is one button that says the route's title and covers what is shown of it.
class CHWorkoutDetailMapViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailMapViewAccessibility";
  static constexpr Name target = "CHWorkoutDetailMapView";

  bool isAccessibilityElement() { return true; }
  id accessibilityLabel() { return stringForLabelKeyValues(self, "_titleLabel"); }
  id accessibilityHint() { return localized("workout.detail.map.hint"); }
  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitButton;
  }
  CGRect accessibilityFrame() {
    const auto map = as<UIView>(self);
    return UIAXFrameForElements(map ? map->subviews() : nullptr);
  }
};

constexpr HostCheck kHostContract[] = {
    kindOfClass("CHWorkoutDetailMapView", "UIView"),
    instanceVariable("CHWorkoutDetailMapView", "_titleLabel", "UILabel"),
};

using Category = CHWorkoutDetailMapViewAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityHint>("accessibilityHint")
                                .method<&Category::accessibilityFrame>("accessibilityFrame")
                                .method<&Category::accessibilityTraits>("accessibilityTraits");

}  // namespace
}  // namespace tavro
