#pragma once

#include "platform/uikit/UITables.h"

namespace tavro {

/// One ring of a friend: its name above how far it is.
class CHFriendDetailGoalCell : public UICollectionViewCell {
 public:
  static constexpr Name className = "CHFriendDetailGoalCell";
  static constexpr double height = 60;

  Ref<UILabel> _titleLabel;
  Ref<UILabel> _subtitleLabel;

  /// Makes the labels.
  id init();
  void layoutSubviews();
};

/// Something that can be done about a friend: a row with a text.
class CHFriendDetailActionCell : public UICollectionViewCell {
 public:
  static constexpr Name className = "CHFriendDetailActionCell";
  static constexpr double height = 48;

  void setTitle(std::string_view title);
  void layoutSubviews();

 private:
  Ref<UILabel> label_;
};

}  // namespace tavro
