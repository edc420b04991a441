#include "host/screens/achievements/AchievementViews.h"

#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

using Header = CHAchievementsSectionHeaderView;
const Registered headerClass = defineClass<Header, UIView>()
                                   .method<&Header::init>("init")
                                   .method<&Header::label>("label")
                                   .method<&Header::layoutSubviews>("layoutSubviews");

using Content = CHAchievementsCellContentView;
const Registered contentClass = defineClass<Content, UIView>()
                                    .method<&Content::init>("init")
                                    .method<&Content::label>("label")
                                    .method<&Content::badgeView>("badgeView")
                                    .method<&Content::layoutSubviews>("layoutSubviews")
                                    .variable<&Content::_label>("_label")
                                    .variable<&Content::_badgeView>("_badgeView");

using Cell = CHAchievementCollectionViewCell;
const Registered cellClass = defineClass<Cell, UICollectionViewCell>()
                                 .method<&Cell::init>("init")
                                 .method<&Cell::achievement>("achievement")
                                 .method<&Cell::layoutSubviews>("layoutSubviews");

constexpr double kMargin = 16;
constexpr double kTextHeight = 44;

}  // namespace

id CHAchievementsSectionHeaderView::init() {
  label_ = makeLabel("");
  addSubview(label_);
  return this;
}

void CHAchievementsSectionHeaderView::layoutSubviews() {
  label_->setFrame({kMargin, 8, frame().size.width - 2 * kMargin, frame().size.height - 8});
}

id CHAchievementsCellContentView::init() {
  _badgeView = makeView<UIImageView>();
  _label = makeLabel("");
  addSubview(_badgeView);
  addSubview(_label);
  return this;
}

void CHAchievementsCellContentView::setAchievement(const ACHAchievement& achievement,
                                                   const Ref<NSString>& title) {
  const auto day = dateStringForFormat(achievement.earnedDate, "MMMdyyyy");
  _label->setText(day ? stringWithFormat(string("%1$@\n%2$@"), {id(title), id(day)}) : title);
  _badgeView->setImage(badgeImageOf(achievement));
}

void CHAchievementsCellContentView::layoutSubviews() {
  const CGSize size = frame().size;
  _badgeView->setFrame({kMargin, 0, size.width - 2 * kMargin, size.height - kTextHeight});
  _label->setFrame({0, size.height - kTextHeight, size.width, kTextHeight});
}

id CHAchievementCollectionViewCell::init() {
  content_ = makeView<CHAchievementsCellContentView>();
  addSubview(content_);
  return this;
}

void CHAchievementCollectionViewCell::setAchievement(const Ref<ACHAchievement>& achievement,
                                                     const Ref<NSString>& title) {
  achievement_ = achievement;
  content_->setAchievement(*achievement, title);
}

void CHAchievementCollectionViewCell::layoutSubviews() { content_->setFrame(bounds()); }

Ref<UIImage> badgeImageOf(const ACHAchievement& achievement) {
  auto image = make<UIImage>();
  image->name = achievement.earnedDate ? "badge" : "badge-outline";
  send<void>(image, "setAccessibilityValue:",
             string(achievement.earnedDate ? "Earned" : "Not earned yet"));
  return image;
}

}  // namespace tavro
