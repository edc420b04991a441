#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A value with its unit is shown with the unit's abbreviation and said with its name.
class AX_TavroNSStringAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "AX_TavroNSStringAccessibility";
  static constexpr Name target = "NSString";

  id attrStringWithValueUnit(const id& value, const id& unit) {
    id shown = super.send<id>(value, unit);
    if (const id spokenUnit = accessibilityLabelOf(unit)) {
      AXPerformSafeBlock(
          [&] { send<void>(shown, "setAccessibilityLabel:", super.send<id>(value, spokenUnit)); });
    }
    return shown;
  }
};

constexpr HostCheck kHostContract[] = {
    classMethod("NSString", "attrStringWithValue: unit:", "@", "@", "@"),
};

using Category = AX_TavroNSStringAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().classMethod<&Category::attrStringWithValueUnit>(
        "attrStringWithValue:unit:");

}  // namespace
}  // namespace tavro
