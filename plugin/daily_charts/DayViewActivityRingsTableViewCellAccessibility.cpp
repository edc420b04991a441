#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/ChartElements.h"

namespace tavro {
namespace {

/// The rings cell hands out its rings and nothing of the drawing around them.
class DayViewActivityRingsTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "DayViewActivityRingsTableViewCellAccessibility";
  static constexpr Name target = "TavroApp.DayViewActivityRingsTableViewCell";

  id accessibilityElements() { return descendantsOfClass(self, "ARUIRingsView"); }
};

constexpr HostCheck kHostContract[] = {classExists("ARUIRingsView")};

using Category = DayViewActivityRingsTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
