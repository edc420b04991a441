#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A day of the week palette is selected while its circle is fully opaque.
class WeekPaletteTappableDayAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "WeekPaletteTappableDayAccessibility";
  static constexpr Name target = "WeekPaletteTappableDay";

  UIAccessibilityTraits accessibilityTraits() {
    const bool isChosen = safeDoubleForKey(safeValueForKey(self, "_circle"), "alpha") == 1.0;
    return super.send<UIAccessibilityTraits>() |
           (isChosen ? UIAccessibilityTraitSelected : UIAccessibilityTraitNone);
  }

  // Without a path the element's frame outlines it, not its circle.
  id accessibilityPath() { return nullptr; }
};

constexpr HostCheck kHostContract[] = {
    kindOfClass("WeekPaletteTappableDay", "ActivityTappableDay"),
    instanceVariable("WeekPaletteTappableDay", "_circle", "UIView"),
};

using Category = WeekPaletteTappableDayAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::accessibilityTraits>("accessibilityTraits")
                                .method<&Category::accessibilityPath>("accessibilityPath");

}  // namespace
}  // namespace tavro
