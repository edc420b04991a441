#include "host/screens/sharing/FriendDetailViewController.h"

#include <utility>

#include "host/Application.h"
#include "host/screens/day/DayViewController.h"
#include "host/screens/sharing/FriendDetailCells.h"
#include "host/screens/sharing/FriendRows.h"
#include "host/screens/sharing/MessageComposer.h"

namespace tavro {
namespace {

using Controller = CHFriendDetailCollectionViewController;
const Registered controllerClass =
    defineClass<Controller, UIViewController>()
        .method<&Controller::viewDidLoad>("viewDidLoad")
        .method<&Controller::sendMessageButtonTapped>("_sendMessageButtonTapped:")
        .variable<&Controller::_isMe>("_isMe");

struct GoalRow {
  std::string_view title;
  HKActivitySummary::Ring HKActivitySummary::*ring;
  std::string_view unit;
};
constexpr GoalRow kGoalRows[] = {
    {"Move", &HKActivitySummary::activeEnergy, "kcal"},
    {"Exercise", &HKActivitySummary::exerciseTime, "min"},
    {"Stand", &HKActivitySummary::standHours, "hr"},
};

constexpr std::string_view kFriendActions[] = {"Mute Notifications", "Hide My Activity",
                                               "Remove Friend"};
constexpr std::string_view kMyActions[] = {"Share Today's Activity"};

}  // namespace

void CHFriendDetailCollectionViewController::setPerson(std::string name, const Rings& rings,
                                                       bool isMe) {
  name_ = std::move(name);
  rings_ = rings;
  _isMe = isMe;
}

void CHFriendDetailCollectionViewController::viewDidLoad() {
  const auto list = makeView<UITableView>({0, 0, 390, 800});
  setView(list);
  navigationItem()->title = string(name_);
  if (!_isMe) {
    // The item shows a picture, so it has no title.
    const auto item = tavro::make<UIBarButtonItem>();
    item->setTarget(this, "_sendMessageButtonTapped:");
    navigationItem()->rightItems.push_back(item);
  }
  const Ref<HKActivitySummary> summary = summaryOf(rings_);
  const auto formattingManager = tavro::make<CHFriendFormattingManager>();
  for (const GoalRow& row : kGoalRows) {
    const auto cell = makeView<CHFriendDetailGoalCell>();
    cell->_titleLabel->setText(string(row.title));
    cell->_subtitleLabel->setText(
        formattingManager->progressText(summary.get()->*row.ring, row.unit));
    list->appendRow(cell, CHFriendDetailGoalCell::height);
  }
  const std::span<const std::string_view> actions =
      _isMe ? std::span<const std::string_view>(kMyActions) : kFriendActions;
  for (const std::string_view action : actions) {
    const auto cell = makeView<CHFriendDetailActionCell>();
    cell->setTitle(action);
    list->appendRow(cell, CHFriendDetailActionCell::height);
  }
}

void CHFriendDetailCollectionViewController::sendMessageButtonTapped(const id& /*item*/) {
  presentMessageComposer(*view(), name_);
}

Ref<UIViewController> makeFriendDetail(const Application& application) {
  const auto controller = makeController<CHFriendDetailCollectionViewController>();
  const Diary& diary = application.diary();
  if (!diary.friends.empty()) {
    controller->setPerson(diary.friends.front().name, diary.friends.front(), false);
  } else {
    const Day* const today = application.today();
    controller->setPerson(diary.person.firstName, today == nullptr ? Rings() : Rings(*today), true);
  }
  return controller;
}

}  // namespace tavro
