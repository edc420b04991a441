#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIControls.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// The achievement's screen names its badge, and reads its text line by line.
class CHAchievementDetailViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHAchievementDetailViewControllerAccessibility";
  static constexpr Name target = "CHAchievementDetailViewController";

  void _axAnnotateAchievementView() {
    annotateBadge();
    const auto label = typedRead<UILabel>(self, "label");
    const Ref<NSString> text = safeStringForKey(label, "text");
    if (lengthOfText(text) > 0) {
      trySend<void>(label, "setAccessibilityLabel:",
                    AXLabelForElements(componentsSeparatedByNewlines(*text)));
    }
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    trySend<void>(self, "_axAnnotateAchievementView");
  }

  void viewDidLoad() {
    super.send<void>();
    trySend<void>(self, "_axAnnotateAchievementView");
  }

 private:
  void annotateBadge() {
    const auto title =
        as<NSString>(trySend<id>(safeValueForKey(self, "_locProvider"),
                                 "titleForAchievement:", safeValueForKey(self, "_achievement")));
    if (lengthOfText(title) == 0) {
      return;
    }
    const Ref<UIView> badge = safeUIViewForKey(self, "badgeContainer");
    trySend<void>(badge, "setIsAccessibilityElement:", true);
    trySend<void>(badge, "setAccessibilityLabel:",
                  stringWithFormat(localized("achievement.badge.format"), {id(title)}));
    // The badge is drawn by other means, and its container may count as hidden meanwhile.
    trySend<void>(badge, "_accessibilitySetViewIsVisible:", true);
    trySend<void>(badge, "_accessibilitySetOverridesInvisibility:", true);
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHAchievementDetailViewController", "_achievement", "ACHAchievement"),
    instanceMethod("CHAchievementDetailViewController", "label", "@"),
    instanceMethod("CHAchievementDetailViewController", "badgeContainer", "@"),
    instanceMethod("CHAchievementDetailViewController", "viewDidLoad", "v"),
    instanceVariable("CHAchievementDetailViewController", "_locProvider",
                     "AAUIAchievementLocalizationProvider"),
    instanceMethod("AAUIAchievementLocalizationProvider", "titleForAchievement:", "@", "@"),
};

using Category = CHAchievementDetailViewControllerAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::_axAnnotateAchievementView>("_axAnnotateAchievementView")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation")
        .method<&Category::viewDidLoad>("viewDidLoad");

}  // namespace
}  // namespace tavro
