#include "platform/accessibility/SafeCategory.h"
#include "plugin/sharing/SendMessageButton.h"

namespace tavro {
namespace {

/// The inbox says what its send-message button does.
class CHFriendInboxTableViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendInboxTableViewControllerAccessibility";
  static constexpr Name target = "CHFriendInboxTableViewController";

  void viewDidLoad() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    annotateSendMessageButton(self);
  }
};

constexpr HostCheck kHostContract[] = {
    kindOfClass("CHFriendInboxTableViewController", "UIViewController"),
    instanceMethod("CHFriendInboxTableViewController", "viewDidLoad", "v"),
    instanceMethod("CHFriendInboxTableViewController", "_sendMessageButtonTapped:", "v", "@"),
};

using Category = CHFriendInboxTableViewControllerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::viewDidLoad>("viewDidLoad")
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
