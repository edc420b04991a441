#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// Names the button beside the month's title, which is a picture.
class MonthViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "MonthViewControllerAccessibility";
  static constexpr Name target = "MonthViewController";

  void viewDidLoad() {
    super.send<void>();
    const id button =
        safeValueForKey(safeValueForKey(self, "navigationItem"), "rightBarButtonItem");
    trySend<void>(button, "setAccessibilityLabel:", localized("today"));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("MonthViewController", "viewDidLoad", "v"),
};

using Category = MonthViewControllerAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::viewDidLoad>("viewDidLoad");

}  // namespace
}  // namespace tavro
