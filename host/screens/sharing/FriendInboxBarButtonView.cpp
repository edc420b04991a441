#include "host/screens/sharing/FriendInboxBarButtonView.h"

#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

using Badge = CHFriendInboxBadgeView;
const Registered badgeClass = defineClass<Badge, UIView>()
                                  .method<&Badge::init>("init")
                                  .method<&Badge::badgeText>("badgeText")
                                  .method<&Badge::layoutSubviews>("layoutSubviews");

using Button = CHFriendInboxBarButtonView;
const Registered buttonClass = defineClass<Button, UIButton>()
                                   .method<&Button::init>("init")
                                   .method<&Button::layoutSubviews>("layoutSubviews")
                                   .variable<&Button::_badgeView>("_badgeView");

constexpr double kBadgeSize = 18;

}  // namespace

id CHFriendInboxBadgeView::init() {
  label_ = makeLabel("");
  addSubview(label_);
  return this;
}

void CHFriendInboxBadgeView::setCount(std::int64_t count) {
  label_->setText(tavro::make<NSNumberFormatter>()->stringFromNumber(number(count)));
  setHidden(count <= 0);
}

void CHFriendInboxBadgeView::layoutSubviews() { label_->setFrame(bounds()); }

id CHFriendInboxBarButtonView::init() {
  _badgeView = makeView<CHFriendInboxBadgeView>();
  addSubview(_badgeView);
  return this;
}

void CHFriendInboxBarButtonView::layoutSubviews() {
  _badgeView->setFrame({frame().size.width - kBadgeSize, 0, kBadgeSize, kBadgeSize});
}

}  // namespace tavro
