#include "host/screens/sharing/FriendListViewController.h"

#include <algorithm>

#include "host/Application.h"
#include "host/screens/day/DayViewController.h"
#include "host/screens/sharing/FriendInboxBarButtonView.h"
#include "host/screens/sharing/FriendInboxViewController.h"

namespace tavro {
namespace {

const Registered controllerClass =
    defineClass<CHFriendListViewController, UIViewController>()
        .method<&CHFriendListViewController::viewDidLoad>("viewDidLoad")
        .method<&CHFriendListViewController::sortButtonTapped>("_sortButtonTapped:")
        .variable<&CHFriendListViewController::_sortBarButtonItem>("_sortBarButtonItem");

/// An order of the friends: by name, or those first who completed most of a ring.
struct FriendOrder {
  std::string_view title;
  HKActivitySummary::Ring HKActivitySummary::*ring;
};
constexpr FriendOrder kOrders[] = {
    {"Name", nullptr},
    {"Move", &HKActivitySummary::activeEnergy},
    {"Exercise", &HKActivitySummary::exerciseTime},
    {"Stand", &HKActivitySummary::standHours},
};

struct ListedFriend {
  Ref<ASFriend> person;
  Ref<HKActivitySummary> snapshot;
};

std::vector<ListedFriend> friendsInOrder(const Diary& diary, const FriendOrder& order) {
  std::vector<ListedFriend> listed;
  for (const Friend& each : diary.friends) {
    const auto person = make<ASFriend>();
    person->name = each.name;
    person->hasNews = each.hasNews;
    person->isCompeting = each.competition.has_value();
    listed.push_back({person, summaryOf(each)});
  }
  std::ranges::stable_sort(listed, [&](const ListedFriend& left, const ListedFriend& right) {
    return order.ring == nullptr ? left.person->name < right.person->name
                                 : (left.snapshot.get()->*order.ring).completion() >
                                       (right.snapshot.get()->*order.ring).completion();
  });
  return listed;
}

void appendHeader(UITableView& table, std::string_view title) {
  const auto header = makeView<UITableViewHeaderFooterViewLabel>();
  header->setText(string(title));
  send<void>(header, "setAccessibilityTraits:", UIAccessibilityTraitHeader);
  table.appendRow(header, 32);
}

Ref<UIBarButtonItem> inboxItem(const Diary& diary) {
  const auto button = makeView<CHFriendInboxBarButtonView>({334, 0, 44, 44});
  button->_badgeView->setCount(std::ranges::count(diary.inbox, true, &InboxMessage::unread));
  button->layoutIfNeeded();
  button->setAction([&diary] {
    if (UIWindow* const window = UIWindow::keyWindow()) {
      const auto inbox = makeController<CHFriendInboxTableViewController>();
      inbox->setMessages(diary.inbox);
      window->setRootViewController(inbox);
    }
  });
  const auto item = make<UIBarButtonItem>();
  item->setCustomView(button);
  return item;
}

}  // namespace

void CHFriendListViewController::viewDidLoad() {
  const auto table = makeView<UITableView>({0, 0, 390, 800});
  setView(table);
  _sortBarButtonItem = tavro::make<UIBarButtonItem>();
  _sortBarButtonItem->setTarget(this, "_sortButtonTapped:");
  navigationItem()->title = string("Sharing");
  navigationItem()->leftItems = {_sortBarButtonItem};
  navigationItem()->rightItems = {inboxItem(*diary_)};
  const bool hasCompetitions = std::ranges::any_of(
      diary_->friends, [](const Friend& each) { return each.competition.has_value(); });
  if (hasCompetitions) {
    appendHeader(*table, "Competitions");
  }
  for (const Friend& each : diary_->friends) {
    if (each.competition) {
      const auto row = makeView<CHFriendListCompetitionTableViewCell>();
      row->setCompetition(each.name, *each.competition);
      table->appendRow(row, CHFriendListCompetitionTableViewCell::height);
    }
  }
  appendHeader(*table, diary_->friends.empty() ? "No friends yet" : "Friends");
  while (rows_.size() < diary_->friends.size()) {
    rows_.push_back(makeView<CHFriendListTableViewCell>());
    table->appendRow(rows_.back(), CHFriendListTableViewCell::height);
  }
  showFriendsInOrder(false);
}

void CHFriendListViewController::sortButtonTapped(const id& /*item*/) {
  order_ = (order_ + 1) % std::size(kOrders);
  showFriendsInOrder(true);
}

void CHFriendListViewController::showFriendsInOrder(bool animated) {
  const FriendOrder& order = kOrders[order_];
  _sortBarButtonItem->setTitle(string(order.title));
  const auto formattingManager = tavro::make<CHFriendFormattingManager>();
  const std::vector<ListedFriend> listed = friendsInOrder(*diary_, order);
  for (std::size_t row = 0; row < rows_.size(); ++row) {
    send<void>(rows_[row], "setFriend:snapshot:formattingManager:animated:", listed[row].person,
               listed[row].snapshot, formattingManager, animated);
  }
}

Ref<UIViewController> makeFriendList(const Application& application) {
  const auto controller = makeController<CHFriendListViewController>();
  controller->setDiary(&application.diary());
  return controller;
}

}  // namespace tavro
