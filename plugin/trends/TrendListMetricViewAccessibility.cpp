#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A metric of the trends list is one button: its title, how it develops, its value.
class TrendListMetricViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TrendListMetricViewAccessibility";
  static constexpr Name target = "TavroApp.TrendListMetricView";

  id accessibilityLabel() {
    return AXLabelForElements(axArrayByIgnoringNilElements({safeValueForKey(self, "titleLabel"),
                                                            safeStringForKey(self, "trendString"),
                                                            safeValueForKey(self, "valueLabel")}));
  }
  bool isAccessibilityElement() { return true; }
  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitButton;
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("TavroApp.TrendListMetricView", "titleLabel", "@"),
    instanceMethod("TavroApp.TrendListMetricView", "trendString", "@"),
    instanceMethod("TavroApp.TrendListMetricView", "valueLabel", "@"),
};

using Category = TrendListMetricViewAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityTraits>("accessibilityTraits");

}  // namespace
}  // namespace tavro
