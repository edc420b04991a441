#pragma once

#include "platform/uikit/UIControls.h"

namespace tavro {

/// A count in a red circle; hidden while there is nothing to count. Message: `badgeText`.
class CHFriendInboxBadgeView : public UIView {
 public:
  static constexpr Name className = "CHFriendInboxBadgeView";

  /// Makes the label.
  id init();
  id badgeText() { return label_->text(); }
  void setCount(std::int64_t count);
  void layoutSubviews();

 private:
  Ref<UILabel> label_;
};

/// The button of the navigation bar that opens the inbox: a picture with a badge, no title.
class CHFriendInboxBarButtonView : public UIButton {
 public:
  static constexpr Name className = "CHFriendInboxBarButtonView";

  Ref<CHFriendInboxBadgeView> _badgeView;

  /// Makes the badge.
  id init();
  void layoutSubviews();
};

}  // namespace tavro
