#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIAccessibility.h"

namespace tavro {
namespace {

constexpr Name kGoalViews[] = {"_moveGoalView", "_exerciseGoalView", "_standGoalView"};

/// The goal setup lets only the goal that it presents be heard, and moves the reader there.
class CHASActivitySetupViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHASActivitySetupViewControllerAccessibility";
  static constexpr Name target = "CHASActivitySetupViewController";

  // One body for all three: each continues in the host's method of the message that was sent.
  void presentGoal() {
    super.send<void>();
    trySend<void>(self, "_accessibilityUpdateCurrentPresentedView");
  }

  void _accessibilityUpdateCurrentPresentedView() {
    for (const Name goalView : kGoalViews) {
      trySend<void>(safeValueForKey(self, goalView), "setAccessibilityElementsHidden:", true);
    }
    const id presented = safeValueForKey(self, "_currentlyPresentedView");
    trySend<void>(presented, "setAccessibilityElementsHidden:", false);
    UIAccessibilityPostNotification(UIAccessibilityLayoutChangedNotification, presented);
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHASActivitySetupViewController", "_currentlyPresentedView",
                     "CHASActivitySetupGoalView"),
    instanceVariable("CHASActivitySetupViewController", "_moveGoalView",
                     "CHASActivitySetupGoalView"),
    instanceVariable("CHASActivitySetupViewController", "_exerciseGoalView",
                     "CHASActivitySetupGoalView"),
    instanceVariable("CHASActivitySetupViewController", "_standGoalView",
                     "CHASActivitySetupGoalView"),
    instanceMethod("CHASActivitySetupViewController", "viewDidLoad", "v"),
    instanceMethod("CHASActivitySetupViewController", "_displayExerciseGoalView", "v"),
    instanceMethod("CHASActivitySetupViewController", "_displayStandGoalView", "v"),
};

using Category = CHASActivitySetupViewControllerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::presentGoal>("viewDidLoad")
                                .method<&Category::presentGoal>("_displayExerciseGoalView")
                                .method<&Category::presentGoal>("_displayStandGoalView")
                                .method<&Category::_accessibilityUpdateCurrentPresentedView>(
                                    "_accessibilityUpdateCurrentPresentedView");

}  // namespace
}  // namespace tavro
