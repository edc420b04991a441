#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Speech.h"
#include "platform/uikit/UIControls.h"

namespace tavro {
namespace {

/// A month's title shows a number and is a heading that says the month's name.
class _TavroMonthTitleLabelAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "_TavroMonthTitleLabelAccessibility";
  static constexpr Name target = "_TavroMonthTitleLabel";

  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitHeader;
  }

  id accessibilityLabel() {
    const auto label = as<UILabel>(self);
    const Ref<NSString> number = label ? label->text() : nullptr;
    if (lengthOfText(number) == 0) {
      return super.send<id>();
    }
    // What is no month's number is no date, and nothing is said: a wrong name would be worse.
    return AXDateStringForFormat(AXDateFromStringWithFormat(number, "MM"), "MMMM");
  }
};

constexpr HostCheck kHostContract[] = {kindOfClass("_TavroMonthTitleLabel", "UILabel")};

using Category = _TavroMonthTitleLabelAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::accessibilityTraits>("accessibilityTraits")
                                .method<&Category::accessibilityLabel>("accessibilityLabel");

}  // namespace
}  // namespace tavro
