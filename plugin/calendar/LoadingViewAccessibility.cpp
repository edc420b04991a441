#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// While something loads, what lies beside the loading view is not to be heard.
class LoadingViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "LoadingViewAccessibility";
  static constexpr Name target = "LoadingView";

  bool accessibilityViewIsModal() { return true; }
};

using Category = LoadingViewAccessibility;
const Registered category =
    safeCategory<Category, kNoHostContract>().method<&Category::accessibilityViewIsModal>(
        "accessibilityViewIsModal");

}  // namespace
}  // namespace tavro
