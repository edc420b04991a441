#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// The buttons of a pair of trends say nothing themselves and would hide the metrics inside them.
class TrendPairTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TrendPairTableViewCellAccessibility";
  static constexpr Name target = "TavroApp.TrendPairTableViewCell";

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    Class* const buttonClass = AXSafeClassFromString("UIButton");
    const auto buttons = as<NSArray>(trySend<id>(
        self, "_accessibilityFindUnsortedDescendantsPassingTest:",
        ViewTest([buttonClass](const id& view) { return isKindOf(view.get(), buttonClass); })));
    if (buttons) {
      for (const id& button : *buttons) {
        trySend<void>(button, "setIsAccessibilityElement:", false);
      }
    }
  }
};

using Category = TrendPairTableViewCellAccessibility;
const Registered category = safeCategory<Category, kNoHostContract>()
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
