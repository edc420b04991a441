#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A competition's row is one element that reads the score, then the days remaining.
class CHFriendListCompetitionTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendListCompetitionTableViewCellAccessibility";
  static constexpr Name target = "CHFriendListCompetitionTableViewCell";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() {
    return trySend<id>(
        self, "_accessibilityStringForLabelKeyValues:", string("_scoreView, _daysRemainingLabel"));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHFriendListCompetitionTableViewCell", "_daysRemainingLabel", "UILabel"),
    instanceVariable("CHFriendListCompetitionTableViewCell", "_scoreView",
                     "ASCompetitionScoreView"),
};

using Category = CHFriendListCompetitionTableViewCellAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel");

}  // namespace
}  // namespace tavro
