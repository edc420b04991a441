#include "host/screens/sharing/FriendRows.h"

#include <cmath>

#include "platform/accessibility/Labels.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

const Registered formattingClass = defineClass<CHFriendFormattingManager, NSObject>();

using FriendCell = CHFriendListTableViewCell;
const Registered friendCellClass =
    defineClass<FriendCell, UITableViewCell>()
        .method<&FriendCell::init>("init")
        .method<&FriendCell::detailLineOneLabel>("detailLineOneLabel")
        .method<&FriendCell::detailLineTwoLabel>("detailLineTwoLabel")
        .method<&FriendCell::competitionBadgeView>("competitionBadgeView")
        .method<&FriendCell::setFriend>("setFriend:snapshot:formattingManager:animated:")
        .method<&FriendCell::layoutSubviews>("layoutSubviews");

using CompetitionCell = CHFriendListCompetitionTableViewCell;
const Registered competitionCellClass =
    defineClass<CompetitionCell, UITableViewCell>()
        .method<&CompetitionCell::init>("init")
        .method<&CompetitionCell::layoutSubviews>("layoutSubviews")
        .variable<&CompetitionCell::_scoreView>("_scoreView")
        .variable<&CompetitionCell::_daysRemainingLabel>("_daysRemainingLabel");

constexpr double kMargin = 16;
constexpr double kBadgeSize = 32;

std::string daysRemaining(std::int64_t days) {
  return utf8(decimalString(static_cast<double>(days), 0)) +
         (days == 1 ? " day remaining" : " days remaining");
}

}  // namespace

Ref<NSString> CHFriendFormattingManager::nameText(const ASFriend& person) const {
  // The bullet is drawn with a gap of its own.
  return string((person.hasNews ? "\u2022" : "") + person.name);
}

Ref<NSString> CHFriendFormattingManager::completionText(
    std::string_view ring, const HKActivitySummary::Ring& progress) const {
  return progress.amount
             ? string(std::string(ring) + " " + utf8(percentString(progress.completion())))
             : nullptr;
}

Ref<NSString> CHFriendFormattingManager::progressText(const HKActivitySummary::Ring& progress,
                                                      std::string_view unit) const {
  const std::string amount =
      progress.amount ? utf8(decimalString(std::round(*progress.amount), 0)) : "--";
  return string(amount + " of " + utf8(decimalString(progress.goal, 0)) + " " + std::string(unit));
}

id CHFriendListTableViewCell::init() {
  setTextLabel(makeLabel(""));
  detailLineOneLabel_ = makeLabel("");
  detailLineTwoLabel_ = makeLabel("");
  competitionBadgeView_ = makeView<UIImageView>();
  addSubview(detailLineOneLabel_);
  addSubview(detailLineTwoLabel_);
  addSubview(competitionBadgeView_);
  return this;
}

void CHFriendListTableViewCell::setFriend(const Ref<ASFriend>& person,
                                          const Ref<HKActivitySummary>& snapshot,
                                          const Ref<CHFriendFormattingManager>& formattingManager,
                                          bool /*animated*/) {
  if (!formattingManager) {
    return;
  }
  textLabel()->setText(person ? formattingManager->nameText(*person) : nullptr);
  competitionBadgeView_->setHidden(!person || !person->isCompeting);
  const auto summary = snapshot ? snapshot : tavro::make<HKActivitySummary>();
  const auto text = [&](std::string_view ring, const HKActivitySummary::Ring& progress) {
    return formattingManager->completionText(ring, progress);
  };
  const Ref<NSString> move = text("Move", summary->activeEnergy);
  detailLineOneLabel_->setText(move ? move : string("No activity today"));
  detailLineTwoLabel_->setText(plainText(AXLabelForElements(axArrayByIgnoringNilElements(
      {text("Exercise", summary->exerciseTime), text("Stand", summary->standHours)}))));
}

void CHFriendListTableViewCell::layoutSubviews() {
  const double width = frame().size.width - 3 * kMargin - kBadgeSize;
  textLabel()->setFrame({kMargin, 8, width, 22});
  detailLineOneLabel_->setFrame({kMargin, 30, width, 18});
  detailLineTwoLabel_->setFrame({kMargin, 50, width, 18});
  competitionBadgeView_->setFrame({frame().size.width - kMargin - kBadgeSize,
                                   (frame().size.height - kBadgeSize) / 2, kBadgeSize, kBadgeSize});
}

id CHFriendListCompetitionTableViewCell::init() {
  _scoreView = makeView<ASCompetitionScoreView>();
  _daysRemainingLabel = makeLabel("");
  addSubview(_scoreView);
  addSubview(_daysRemainingLabel);
  return this;
}

void CHFriendListCompetitionTableViewCell::setCompetition(std::string_view friendName,
                                                          const Competition& competition) {
  _scoreView->setScores(competition.myScore, friendName, competition.friendScore);
  _daysRemainingLabel->setText(string(daysRemaining(competition.daysRemaining)));
}

void CHFriendListCompetitionTableViewCell::layoutSubviews() {
  // The remaining days stand above the score, in small letters.
  const double width = frame().size.width - 2 * kMargin;
  _daysRemainingLabel->setFrame({kMargin, 4, width, 18});
  _scoreView->setFrame({kMargin, 24, width, 32});
}

}  // namespace tavro
