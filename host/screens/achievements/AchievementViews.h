#pragma once

#include "host/libraries/Achievements.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// Heads the achievements of one section. Message: `label`.
class CHAchievementsSectionHeaderView : public UIView {
 public:
  static constexpr Name className = "CHAchievementsSectionHeaderView";
  static constexpr double height = 40;

  /// Makes the label.
  id init();
  id label() { return label_; }
  void setTitle(std::string_view title) { label_->setText(string(title)); }
  void layoutSubviews();

 private:
  Ref<UILabel> label_;
};

/// What a cell shows of an achievement: its badge above its title and, on a second line, the day on
/// which it was earned. Messages: `label`, `badgeView`.
class CHAchievementsCellContentView : public UIView {
 public:
  static constexpr Name className = "CHAchievementsCellContentView";

  Ref<UILabel> _label;
  Ref<UIImageView> _badgeView;

  /// Makes the label and the badge.
  id init();
  id label() { return _label; }
  id badgeView() { return _badgeView; }
  void setAchievement(const ACHAchievement& achievement, const Ref<NSString>& title);
  void layoutSubviews();
};

/// An achievement's cell in the collection. Message: `achievement`.
class CHAchievementCollectionViewCell : public UICollectionViewCell {
 public:
  static constexpr Name className = "CHAchievementCollectionViewCell";

  /// Makes the content.
  id init();
  id achievement() { return achievement_; }
  void setAchievement(const Ref<ACHAchievement>& achievement, const Ref<NSString>& title);
  void layoutSubviews();

 private:
  Ref<ACHAchievement> achievement_;
  Ref<CHAchievementsCellContentView> content_;
};

/// The picture of a badge, which says whether the achievement was earned.
Ref<UIImage> badgeImageOf(const ACHAchievement& achievement);

}  // namespace tavro
