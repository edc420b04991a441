#pragma once

#include "host/Diary.h"
#include "host/libraries/ActivitySharing.h"
#include "platform/healthkit/HKActivitySummary.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// How friends and their rings are written.
class CHFriendFormattingManager : public NSObject {
 public:
  static constexpr Name className = "CHFriendFormattingManager";

  /// The name, behind a bullet when there is news.
  [[nodiscard]] Ref<NSString> nameText(const ASFriend& person) const;
  /// "Move 90%"; nil for a ring that was not recorded.
  [[nodiscard]] Ref<NSString> completionText(std::string_view ring,
                                             const HKActivitySummary::Ring& progress) const;
  /// "412 of 460 kcal"; a dash pair stands for an amount that was not recorded.
  [[nodiscard]] Ref<NSString> progressText(const HKActivitySummary::Ring& progress,
                                           std::string_view unit) const;
};

/// A friend's row: the name, two lines about today, and a badge during a competition. Messages:
/// `detailLineOneLabel`, `detailLineTwoLabel`, `competitionBadgeView`,
/// `setFriend:snapshot:formattingManager:animated:`.
class CHFriendListTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHFriendListTableViewCell";
  static constexpr double height = 76;

  /// Makes the row's parts.
  id init();
  id detailLineOneLabel() { return detailLineOneLabel_; }
  id detailLineTwoLabel() { return detailLineTwoLabel_; }
  id competitionBadgeView() { return competitionBadgeView_; }
  /// Fills the row, whatever it held before. The snapshot is the friend's today; nil when it is not
  /// known.
  void setFriend(const Ref<ASFriend>& person, const Ref<HKActivitySummary>& snapshot,
                 const Ref<CHFriendFormattingManager>& formattingManager, bool animated);
  void layoutSubviews();

 private:
  Ref<UILabel> detailLineOneLabel_;
  Ref<UILabel> detailLineTwoLabel_;
  Ref<UIImageView> competitionBadgeView_;
};

/// A competition's row: its score and the days that remain.
class CHFriendListCompetitionTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHFriendListCompetitionTableViewCell";
  static constexpr double height = 60;

  Ref<ASCompetitionScoreView> _scoreView;
  Ref<UILabel> _daysRemainingLabel;

  /// Makes the row's parts.
  id init();
  void setCompetition(std::string_view friendName, const Competition& competition);
  void layoutSubviews();
};

}  // namespace tavro
