#include "host/screens/sharing/FriendDetailCells.h"

namespace tavro {
namespace {

using GoalCell = CHFriendDetailGoalCell;
const Registered goalCellClass = defineClass<GoalCell, UICollectionViewCell>()
                                     .method<&GoalCell::init>("init")
                                     .method<&GoalCell::layoutSubviews>("layoutSubviews")
                                     .variable<&GoalCell::_titleLabel>("_titleLabel")
                                     .variable<&GoalCell::_subtitleLabel>("_subtitleLabel");
const Registered actionCellClass =
    defineClass<CHFriendDetailActionCell, UICollectionViewCell>()
        .method<&CHFriendDetailActionCell::layoutSubviews>("layoutSubviews");

constexpr double kMargin = 16;

}  // namespace

id CHFriendDetailGoalCell::init() {
  _titleLabel = makeLabel("");
  _subtitleLabel = makeLabel("");
  addSubview(_titleLabel);
  addSubview(_subtitleLabel);
  return this;
}

void CHFriendDetailGoalCell::layoutSubviews() {
  const double width = frame().size.width - 2 * kMargin;
  _titleLabel->setFrame({kMargin, 6, width, 22});
  _subtitleLabel->setFrame({kMargin, 30, width, 24});
}

void CHFriendDetailActionCell::setTitle(std::string_view title) {
  if (!label_) {
    label_ = makeLabel("");
    addSubview(label_);
  }
  label_->setText(string(title));
}

void CHFriendDetailActionCell::layoutSubviews() {
  if (label_) {
    label_->setFrame({kMargin, 0, frame().size.width - 2 * kMargin, frame().size.height});
  }
}

}  // namespace tavro
