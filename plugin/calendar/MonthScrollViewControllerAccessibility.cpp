#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// Gives the scroll view of the months a fixed identification.
class MonthScrollViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "MonthScrollViewControllerAccessibility";
  static constexpr Name target = "MonthScrollViewController";

  void viewDidLoad() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    trySend<void>(safeValueForKey(self, "_scrollView"),
                  "accessibilitySetIdentification:", string("WorstScrollViewEver"));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("MonthScrollViewController", "viewDidLoad", "v"),
    instanceVariable("MonthScrollViewController", "_scrollView", "UIScrollView"),
};

using Category = MonthScrollViewControllerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::viewDidLoad>("viewDidLoad")
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
