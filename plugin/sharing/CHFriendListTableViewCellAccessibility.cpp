#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/uikit/UITables.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

constexpr std::u16string_view kBullet = u"\u2022";

/// What a name label says: its text without the bullets that mark news.
Ref<NSString> nameWithoutBullets(const id& nameLabel) {
  const Ref<NSString> name = safeStringForKey(nameLabel, "text");
  return name ? stringByReplacing(*name, kBullet, u"") : nullptr;
}

/// A friend's row is one element that reads name, detail lines and competition badge.
class CHFriendListTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHFriendListTableViewCellAccessibility";
  static constexpr Name target = "CHFriendListTableViewCell";

  bool isAccessibilityElement() { return true; }

  // Rows are reused, so each friend that a row is filled with is a new label.
  void setFriend(const id& person, const id& snapshot, const id& formattingManager, bool animated) {
    super.send<void>(person, snapshot, formattingManager, animated);
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    const auto name = typedRead<UILabel>(as<UITableViewCell>(self), "textLabel");
    if (!name) {
      return;
    }
    const id badge = safeValueForKey(self, "competitionBadgeView");
    trySend<void>(badge, "setIsAccessibilityElement:", true);
    trySend<void>(badge, "setAccessibilityLabel:", localized("competition.in.progress"));
    trySend<void>(name, "_setAccessibilityLabelBlock:", LabelBlock([name = Weak<>(name.get())] {
                    return nameWithoutBullets(name.strong());
                  }));
    const Ref<NSArray> parts =
        axArrayByIgnoringNilElements({name, safeValueForKey(self, "detailLineOneLabel"),
                                      safeValueForKey(self, "detailLineTwoLabel"), badge});
    trySend<void>(self, "setAccessibilityLabel:", AXLabelForElements(parts));
  }
};

constexpr HostCheck kHostContract[] = {
    kindOfClass("CHFriendListTableViewCell", "UITableViewCell"),
    instanceMethod("CHFriendListTableViewCell", "detailLineOneLabel", "@"),
    instanceMethod("CHFriendListTableViewCell", "detailLineTwoLabel", "@"),
    instanceMethod("CHFriendListTableViewCell", "competitionBadgeView", "@"),
    instanceMethod("CHFriendListTableViewCell",
                   "setFriend:snapshot:formattingManager:animated:", "v", "@", "@", "@", "B"),
};

using Category = CHFriendListTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::isAccessibilityElement>("isAccessibilityElement")
        .method<&Category::setFriend>("setFriend:snapshot:formattingManager:animated:")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
