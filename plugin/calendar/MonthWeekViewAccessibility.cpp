#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Traversal.h"

namespace tavro {
namespace {

/// A row of the calendar hands out its days, which are layers and not found otherwise, and the
/// title of the month that begins in it.
class MonthWeekViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "MonthWeekViewAccessibility";
  static constexpr Name target = "MonthWeekView";

  id accessibilityElements() {
    const Ref<NSMutableArray> elements = mutableArray();
    elements->axSafelyAddObject(safeValueForKey(self, "monthTitleView"));
    Class* const dayClass = AXSafeClassFromString("MonthDayCellLayer");
    if (const auto sublayers = safeArrayForKey(safeValueForKey(self, "layer"), "sublayers")) {
      for (const id& sublayer : *sublayers) {
        if (isKindOf(sublayer.get(), dayClass)) {
          // Within a month row a day says its day and month instead of its weekday.
          trySend<void>(sublayer, "setAccessibilityContainer:", id(self));
          elements->addObject(sublayer);
        }
      }
    }
    return sortedArrayUsingSelector(elements, "accessibilityCompareGeometry:");
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("HKCalendarWeekView", "monthTitleView", "@"),
    kindOfClass("MonthWeekView", "HKCalendarWeekView"),
};

using Category = MonthWeekViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
