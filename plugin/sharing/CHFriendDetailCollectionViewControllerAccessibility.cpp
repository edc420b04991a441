#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "plugin/sharing/SendMessageButton.h"

namespace tavro {
namespace {

/// A friend's page says what its send-message button does; one's own page has nobody to write to.
class CHFriendDetailCollectionViewControllerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendDetailCollectionViewControllerAccessibility";
  static constexpr Name target = "CHFriendDetailCollectionViewController";

  void viewDidLoad() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    if (!safeBoolForKey(self, "_isMe")) {
      annotateSendMessageButton(self);
    }
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHFriendDetailCollectionViewController", "_isMe", "B"),
    instanceMethod("CHFriendDetailCollectionViewController", "_sendMessageButtonTapped:", "v", "@"),
    instanceMethod("CHFriendDetailCollectionViewController", "viewDidLoad", "v"),
    kindOfClass("CHFriendDetailCollectionViewController", "UIViewController"),
};

using Category = CHFriendDetailCollectionViewControllerAccessibility;
const Registered category = safeCategory<Category, kHostContract>()
                                .method<&Category::viewDidLoad>("viewDidLoad")
                                .method<&Category::_accessibilityLoadAccessibilityInformation>(
                                    "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
