#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// The header of a section of the workouts list is one heading: its date, then its detail.
class CHListTableHeaderViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHListTableHeaderViewAccessibility";
  static constexpr Name target = "CHListTableHeaderView";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() {
    return __UIAXStringForVariables({accessibilityLabelOf(safeValueForKey(self, "_dateLabel")),
                                     accessibilityLabelOf(safeValueForKey(self, "_detailLabel"))});
  }

  UIAccessibilityTraits accessibilityTraits() {
    return super.send<UIAccessibilityTraits>() | UIAccessibilityTraitHeader;
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHListTableHeaderView", "_dateLabel", "UILabel"),
    instanceVariable("CHListTableHeaderView", "_detailLabel", "_UITableViewHeaderFooterViewLabel"),
};

using Category = CHListTableHeaderViewAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel")
                                .method<&Category::accessibilityTraits>("accessibilityTraits");

}  // namespace
}  // namespace tavro
