#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIControls.h"

namespace tavro {
namespace {

/// The content of an achievement's cell is one button: its text line by line, and what the picture
/// of the badge says of itself.
class CHAchievementsCellContentViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHAchievementsCellContentViewAccessibility";
  static constexpr Name target = "CHAchievementsCellContentView";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() {
    const Ref<NSString> text = safeStringForKey(typedRead<UILabel>(self, "_label"), "text");
    return lengthOfText(text) > 0 ? AXLabelForElements(componentsSeparatedByNewlines(*text))
                                  : super.send<id>();
  }

  id accessibilityValue() {
    const id image = safeValueForKey(safeValueForKey(self, "_badgeView"), "image");
    const id value = trySend<id>(image, "accessibilityValue");
    return lengthOfText(value) > 0 ? value : super.send<id>();
  }

  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitButton;
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("CHAchievementsCellContentView", "label", "@"),
    instanceMethod("CHAchievementsCellContentView", "badgeView", "@"),
};

using Category = CHAchievementsCellContentViewAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityValue>("accessibilityValue")
                                .method<&Category::accessibilityTraits>("accessibilityTraits");

}  // namespace
}  // namespace tavro
