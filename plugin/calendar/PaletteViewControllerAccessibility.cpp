#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {
namespace {

/// The week palette is its weekday header: the labels say what the days below them show.
class PaletteViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "PaletteViewControllerAccessibility";
  static constexpr Name target = "PaletteViewController";

  void viewDidLoad() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    if (const auto controller = as<UIViewController>(self)) {
      trySend<void>(trySend<id>(controller, "view"), "setAccessibilityElements:",
                    axArrayByIgnoringNilElements({safeValueForKey(self, "_paletteView")}));
    }
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("PaletteViewController", "_paletteView", "PaletteWeekdayHeaderView"),
    instanceMethod("PaletteViewController", "viewDidLoad", "v"),
};

using Category = PaletteViewControllerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::viewDidLoad>("viewDidLoad")
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
