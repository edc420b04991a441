#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A goal of a friend is one element: its title, and the subtitle as its value.
class CHFriendDetailGoalCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendDetailGoalCellAccessibility";
  static constexpr Name target = "CHFriendDetailGoalCell";

  bool isAccessibilityElement() { return true; }
  id accessibilityLabel() { return accessibilityLabelOf(safeValueForKey(self, "_titleLabel")); }
  id accessibilityValue() { return accessibilityLabelOf(safeValueForKey(self, "_subtitleLabel")); }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHFriendDetailGoalCell", "_titleLabel", "UILabel"),
    instanceVariable("CHFriendDetailGoalCell", "_subtitleLabel", "UILabel"),
};

using Category = CHFriendDetailGoalCellAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityValue>("accessibilityValue");

}  // namespace
}  // namespace tavro
