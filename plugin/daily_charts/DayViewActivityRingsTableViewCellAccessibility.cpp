#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// The rings cell hands out its rings and nothing of the drawing around them.
class DayViewActivityRingsTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "DayViewActivityRingsTableViewCellAccessibility";
  static constexpr Name target = "TavroApp.DayViewActivityRingsTableViewCell";

  id accessibilityElements() {
    Class* const ringsClass = AXSafeClassFromString("ARUIRingsView");
    return trySend<id>(
        self, "_accessibilityFindSubviewDescendantsPassingTest:",
        ViewTest([ringsClass](const id& view) { return isKindOf(view.get(), ringsClass); }));
  }
};

constexpr HostCheck kHostContract[] = {classExists("ARUIRingsView")};

using Category = DayViewActivityRingsTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
