#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A section header of the trends list is one heading; what can be focused in it stays unsaid.
class TrendListHeaderViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TrendListHeaderViewAccessibility";
  static constexpr Name target = "TavroApp.TrendListHeaderView";

  bool isAccessibilityElement() { return true; }
  id accessibilityLabel() {
    return accessibilityTextForSubhierarchy(self, /*includesHeaders=*/true,
                                            /*focusableItems=*/false);
  }
  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitHeader;
  }
};

using Category = TrendListHeaderViewAccessibility;
const Registered category = safeCategory<Category, kNoHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityTraits>("accessibilityTraits");

}  // namespace
}  // namespace tavro
