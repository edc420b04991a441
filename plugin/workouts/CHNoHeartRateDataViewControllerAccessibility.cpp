#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIAccessibility.h"

namespace tavro {
namespace {

/// The screen that explains a missing heart rate: its title is a heading, and the text of its link
/// is said by the button that opens it, once.
class CHNoHeartRateDataViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHNoHeartRateDataViewControllerAccessibility";
  static constexpr Name target = "CHNoHeartRateDataViewController";

  void loadView() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    AXPerformSafeBlock([this] {
      const id title = safeValueForKey(self, "titleLabel");
      const auto traits = send<UIAccessibilityTraits>(title, "accessibilityTraits");
      trySend<void>(title, "setAccessibilityTraits:", traits | UIAccessibilityTraitHeader);
    });
    trySend<void>(safeValueForKey(self, "linkLabel"), "setIsAccessibilityElement:", false);
    const Weak<> controller(self);
    trySend<void>(safeValueForKey(self, "linkButton"),
                  "_setAccessibilityLabelBlock:", LabelBlock([controller] {
                    return accessibilityLabelOf(safeValueForKey(controller.strong(), "linkLabel"));
                  }));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("CHNoHeartRateDataViewController", "loadView", "v"),
    instanceMethod("CHNoHeartRateDataViewController", "titleLabel", "@"),
    instanceMethod("CHNoHeartRateDataViewController", "linkLabel", "@"),
    instanceMethod("CHNoHeartRateDataViewController", "linkButton", "@"),
};

using Category = CHNoHeartRateDataViewControllerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::loadView>("loadView")
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
