#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/Formatters.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// The inbox button is one element that says how many new items its badge counts.
class CHFriendInboxBarButtonViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendInboxBarButtonViewAccessibility";
  static constexpr Name target = "CHFriendInboxBarButtonView";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() { return localized("friend.list"); }

  id accessibilityValue() {
    const Ref<NSString> text = safeStringForKey(safeValueForKey(self, "_badgeView"), "badgeText");
    const Ref<NSNumber> number = make<NSNumberFormatter>()->numberFromString(text);
    const std::int64_t count = number ? number->intValue() : 0;
    return count >= 1 ? stringWithFormat(localized("badge.format"), {count}) : nullptr;
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHFriendInboxBarButtonView", "_badgeView", "CHFriendInboxBadgeView"),
    instanceMethod("CHFriendInboxBadgeView", "badgeText", "@"),
};

using Category = CHFriendInboxBarButtonViewAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityValue>("accessibilityValue");

}  // namespace
}  // namespace tavro
