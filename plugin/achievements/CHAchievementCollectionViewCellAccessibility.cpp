#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// An achievement's cell is one element that says the achievement's title.
class CHAchievementCollectionViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHAchievementCollectionViewCellAccessibility";
  static constexpr Name target = "CHAchievementCollectionViewCell";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() {
    return accessibilityLocalizedStringForAchievement(safeValueForKey(self, "achievement"));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("CHAchievementCollectionViewCell", "achievement", "@"),
};

using Category = CHAchievementCollectionViewCellAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel");

}  // namespace
}  // namespace tavro
