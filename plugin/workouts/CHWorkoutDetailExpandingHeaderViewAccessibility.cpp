#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

constexpr std::int64_t kExpanded = 1;
constexpr std::int64_t kCollapsed = 2;

/// The header of a section that opens and closes is one element: a heading, and the button that
/// stands in it.
class CHWorkoutDetailExpandingHeaderViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailExpandingHeaderViewAccessibility";
  static constexpr Name target = "CHWorkoutDetailExpandingHeaderView";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() { return stringForLabelKeyValues(self, "_titleLabel"); }

  UIAccessibilityTraits accessibilityTraits() {
    return UIAccessibilityTraitButton | UIAccessibilityTraitHeader;
  }

  /// A tap in the header's middle would miss the button.
  CGPoint accessibilityActivationPoint() {
    return trySend<CGPoint>(safeUIViewForKey(self, "_expandButton"),
                            "accessibilityActivationPoint");
  }

  std::int64_t _accessibilityExpandedStatus() {
    return safeBoolForKey(self, "_expanded") ? kExpanded : kCollapsed;
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHWorkoutDetailExpandingHeaderView", "_titleLabel", "UILabel"),
    instanceVariable("CHWorkoutDetailExpandingHeaderView", "_expandButton", "UIButton"),
    instanceVariable("CHWorkoutDetailExpandingHeaderView", "_expanded", "B"),
};

using Category = CHWorkoutDetailExpandingHeaderViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::isAccessibilityElement>("isAccessibilityElement")
        .method<&Category::accessibilityLabel>("accessibilityLabel")
        .method<&Category::accessibilityTraits>("accessibilityTraits")
        .method<&Category::accessibilityActivationPoint>("accessibilityActivationPoint")
        .method<&Category::_accessibilityExpandedStatus>("_accessibilityExpandedStatus");

}  // namespace
}  // namespace tavro
