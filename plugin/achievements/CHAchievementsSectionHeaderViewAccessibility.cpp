#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIAccessibility.h"

namespace tavro {
namespace {

/// A section of the achievements is headed by its label.
class CHAchievementsSectionHeaderViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHAchievementsSectionHeaderViewAccessibility";
  static constexpr Name target = "CHAchievementsSectionHeaderView";

  bool isAccessibilityElement() { return true; }

  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitHeader;
  }

  id accessibilityLabel() {
    return trySend<id>(self, "_accessibilityStringForLabelKeyValues:", string("label"));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("CHAchievementsSectionHeaderView", "label", "@"),
};

using Category = CHAchievementsSectionHeaderViewAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityTraits>("accessibilityTraits")
                                .method<&Category::accessibilityLabel>("accessibilityLabel");

}  // namespace
}  // namespace tavro
