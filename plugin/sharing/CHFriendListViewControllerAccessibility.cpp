#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UIViewController.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// The sort button says what it is for, and the order that it shows as its value.
class CHFriendListViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendListViewControllerAccessibility";
  static constexpr Name target = "CHFriendListViewController";

  void viewDidLoad() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    const auto button = typedRead<UIBarButtonItem>(self, "_sortBarButtonItem");
    // Blocks rather than texts: the host changes the title whenever the order changes.
    trySend<void>(button, "_setAccessibilityLabelBlock:", LabelBlock([] {
                    return localized("sort.by.options");
                  }));
    trySend<void>(button,
                  "_setAccessibilityValueBlock:", LabelBlock([button = Weak<>(button.get())] {
                    return safeStringForKey(button.strong(), "title");
                  }));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHFriendListViewController", "_sortBarButtonItem", "UIBarButtonItem"),
    instanceMethod("CHFriendListViewController", "viewDidLoad", "v"),
};

using Category = CHFriendListViewControllerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::viewDidLoad>("viewDidLoad")
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
