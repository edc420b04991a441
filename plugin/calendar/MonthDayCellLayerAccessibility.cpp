#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Speech.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// The rings are drawn below the cell's number and are touched with it.
constexpr double kSideMargin = 10;
constexpr double kHeightBelow = 70;

/// A day of the calendar is one element: its date, then its workout and its rings.
class MonthDayCellLayerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "MonthDayCellLayerAccessibility";
  static constexpr Name target = "MonthDayCellLayer";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() {
    const Ref<NSString> today =
        safeBoolForKey(self, "representsToday") ? localized("today") : nullptr;
    const id container = trySend<id>(self, "accessibilityContainer");
    const bool isInMonth = isKindOf(container.get(), AXSafeClassFromString("MonthWeekView"));
    return __UIAXStringForVariables({today, AXDateStringForFormat(typedRead<NSDate>(self, "date"),
                                                                  isInMonth ? "dMMMM" : "EEEE")});
  }

  id accessibilityValue() {
    if (safeBoolForKey(self, "isFutureDay")) {
      return localized("no.data");
    }
    const Ref<NSString> rings =
        accessibilityTavroStringForDate(typedRead<NSDate>(self, "date"), true);
    const Ref<NSString> workout =
        safeBoolForKey(self, "_hasWorkout") ? localized("worked.out") : nullptr;
    const id value = __UIAXStringForVariables({workout, rings});
    return value ? value : id(localized("no.data"));
  }

  CGRect accessibilityFrame() {
    const auto own = trySend<CGRect>(self, "frame");
    const auto view =
        as<UIView>(trySend<id>(self, "_accessibilityAncestorIsKindOf:", classOf<UIView>()));
    return UIAccessibilityConvertFrameToScreenCoordinates(
        {own.origin.x - kSideMargin, own.origin.y, own.size.width + 2 * kSideMargin,
         own.size.height + kHeightBelow},
        view);
  }
};

constexpr HostCheck kHostContract[] = {
    classMethod("ActivitySummaryCache", "sharedInstance", "@"),
    instanceVariable("MonthDayCellLayer", "_hasWorkout", "B"),
    instanceMethod("MonthDayCellLayer", "isFutureDay", "B"),
    instanceMethod("HKCalendarDayCell", "representsToday", "B"),
    instanceMethod("HKCalendarDayCell", "date", "@"),
    kindOfClass("MonthDayCellLayer", "HKCalendarDayCell"),
    classExists("MonthWeekView"),
    classExists("MonthScrollViewController"),
    classExists("MonthViewController"),
};

using Category = MonthDayCellLayerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityValue>("accessibilityValue")
                                .method<&Category::accessibilityFrame>("accessibilityFrame");

}  // namespace
}  // namespace tavro
