#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIControls.h"

namespace tavro {
namespace {

/// A goal is one adjustable element; adjusting it presses the host's own buttons, so that steps and
/// limits stay the host's.
class CHASActivitySetupGoalViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHASActivitySetupGoalViewAccessibility";
  static constexpr Name target = "CHASActivitySetupGoalView";

  bool isAccessibilityElement() { return true; }

  id accessibilityValue() {
    const auto goal = typedRead<UILabel>(self, "_goalLabel");
    const auto unit = typedRead<UILabel>(self, "_unitLabel");
    if (!goal || !unit) {
      return super.send<id>();
    }
    return __UIAXStringForVariables({safeStringForKey(goal, "text"), safeStringForKey(unit, "text"),
                                     string(kVariablesSentinel)});
  }

  UIAccessibilityTraits accessibilityTraits() { return UIAccessibilityTraitAdjustable; }

  void accessibilityIncrement() {
    send<void>(self, "_accessibilityPerformButtonActionForButton:", string("_plusButton"));
  }

  void accessibilityDecrement() {
    send<void>(self, "_accessibilityPerformButtonActionForButton:", string("_minusButton"));
  }

  void _accessibilityPerformButtonActionForButton(const Ref<NSString>& key) {
    const id controller = safeValueForKey(self, "buttonController");
    if (const auto button = typedRead<UIButton>(self, Name::make(utf8(key)))) {
      trySend<void>(controller, "_performPlusMinusActionWithButton:", button);
    }
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHASActivitySetupGoalView", "_goalLabel", "UILabel"),
    instanceVariable("CHASActivitySetupGoalView", "_unitLabel", "UILabel"),
    instanceVariable("CHASActivitySetupGoalView", "_minusButton", "UIButton"),
    instanceVariable("CHASActivitySetupGoalView", "_plusButton", "UIButton"),
    instanceMethod("CHASActivitySetupGoalView", "buttonController", "@"),
    instanceMethod("TVUIValueAdjustmentButtonController", "_performPlusMinusActionWithButton:", "v",
                   "@"),
};

using Category = CHASActivitySetupGoalViewAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::isAccessibilityElement>("isAccessibilityElement")
                                .method<&Category::accessibilityValue>("accessibilityValue")
                                .method<&Category::accessibilityTraits>("accessibilityTraits")
                                .method<&Category::accessibilityIncrement>("accessibilityIncrement")
                                .method<&Category::accessibilityDecrement>("accessibilityDecrement")
                                .method<&Category::_accessibilityPerformButtonActionForButton>(
                                    "_accessibilityPerformButtonActionForButton:");

}  // namespace
}  // namespace tavro
