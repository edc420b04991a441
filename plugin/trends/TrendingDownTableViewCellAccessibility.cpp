#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A trend that goes down is one button: its metric, then what can be done about it.
class TrendingDownTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TrendingDownTableViewCellAccessibility";
  static constexpr Name target = "TavroApp.TrendingDownTableViewCell";

  bool isAccessibilityElement() { return true; }
  id accessibilityLabel() {
    return AXLabelForElements(axArrayByIgnoringNilElements(
        {safeValueForKey(self, "view"), safeValueForKey(self, "detailLabel")}));
  }
  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitButton;
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("TavroApp.TrendingDownTableViewCell", "view", "@"),
    instanceMethod("TavroApp.TrendingDownTableViewCell", "detailLabel", "@"),
};

using Category = TrendingDownTableViewCellAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityTraits>("accessibilityTraits");

}  // namespace
}  // namespace tavro
