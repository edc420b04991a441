#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIControls.h"

namespace tavro {
namespace {

/// An action of a friend's page is a button named by the first label in it.
class CHFriendDetailActionCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendDetailActionCellAccessibility";
  static constexpr Name target = "CHFriendDetailActionCell";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() {
    return accessibilityLabelOf(
        trySend<id>(self, "_accessibilityFindSubviewDescendant:", ViewTest([](const id& view) {
                      return isKindOf(view.get(), classOf<UILabel>());
                    })));
  }

  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitButton;
  }
};

using Category = CHFriendDetailActionCellAccessibility;
const Registered category = safeCategory<Category, kNoHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityTraits>("accessibilityTraits");

}  // namespace
}  // namespace tavro
