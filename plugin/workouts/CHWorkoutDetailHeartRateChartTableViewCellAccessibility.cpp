#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIControls.h"

namespace tavro {
namespace {

/// The first direct subview of that class, or nil; nil for nil.
template <class T>
Ref<T> firstSubview(const Ref<UIView>& view) {
  if (view) {
    for (const Ref<UIView>& subview : view->subviewList()) {
      if (Ref<T> found = as<T>(subview)) {
        return found;
      }
    }
  }
  return nullptr;
}

id labelOfOverlay(const Ref<UIView>& overlay) {
  const Ref<UILabel> label = firstSubview<UILabel>(overlay);
  return label ? accessibilityLabelOf(label) : UIAXStringForAllChildren(overlay);
}

/// The overlay that stands in for a chart without data is one button while it is shown. It says
/// its label and acts as its button does.
class CHWorkoutDetailHeartRateChartTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailHeartRateChartTableViewCellAccessibility";
  static constexpr Name target = "CHWorkoutDetailHeartRateChartTableViewCell";

  void _createAndConstraintNoDataOverlay() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    const Ref<UIView> overlay = safeUIViewForKey(self, "_noDataOverlayView");
    trySend<void>(overlay,
                  "_setIsAccessibilityElementBlock:", FlagBlock([held = Weak<UIView>(overlay)] {
                    const Ref<UIView> shown = held.strong();
                    return shown && !shown->isHidden();
                  }));
    trySend<void>(overlay,
                  "_setAccessibilityLabelBlock:", LabelBlock([held = Weak<UIView>(overlay)] {
                    return labelOfOverlay(held.strong());
                  }));
    trySend<void>(
        overlay, "_setAccessibilityActivateBlock:", FlagBlock([held = Weak<UIView>(overlay)] {
          return trySend<bool>(firstSubview<UIButton>(held.strong()), "accessibilityActivate");
        }));
    trySend<void>(overlay, "setAccessibilityTraits:", UIAccessibilityTraitButton);
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHWorkoutDetailHeartRateChartTableViewCell", "_noDataOverlayView", "UIView"),
    instanceMethod("CHWorkoutDetailHeartRateChartTableViewCell",
                   "_createAndConstraintNoDataOverlay", "v"),
};

using Category = CHWorkoutDetailHeartRateChartTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation")
        .method<&Category::_createAndConstraintNoDataOverlay>("_createAndConstraintNoDataOverlay");

}  // namespace
}  // namespace tavro
