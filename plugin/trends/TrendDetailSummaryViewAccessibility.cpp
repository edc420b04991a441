#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// A trend's summary is one element that says everything in it but its heading.
class TrendDetailSummaryViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TrendDetailSummaryViewAccessibility";
  static constexpr Name target = "TavroApp.TrendDetailSummaryView";

  bool isAccessibilityElement() { return true; }
  id accessibilityLabel() {
    return accessibilityTextForSubhierarchy(self, /*includesHeaders=*/false,
                                            /*focusableItems=*/true);
  }
};

using Category = TrendDetailSummaryViewAccessibility;
const Registered category = safeCategory<Category, kNoHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityLabel>("accessibilityLabel");

}  // namespace
}  // namespace tavro
