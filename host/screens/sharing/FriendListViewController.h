#pragma once

#include "host/screens/sharing/FriendRows.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

class Application;

/// The friends: competitions first, then everyone in an order that the user chooses.
class CHFriendListViewController : public UIViewController {
 public:
  static constexpr Name className = "CHFriendListViewController";

  /// Shows the present order as its title; each tap goes on to the next one.
  Ref<UIBarButtonItem> _sortBarButtonItem;

  /// Set before the view is asked for. The diary must outlive the controller.
  void setDiary(const Diary* diary) { diary_ = diary; }
  void viewDidLoad();
  void sortButtonTapped(const id& item);

 private:
  void showFriendsInOrder(bool animated);

  const Diary* diary_ = nullptr;
  std::size_t order_ = 0;
  std::vector<Ref<CHFriendListTableViewCell>> rows_;
};

Ref<UIViewController> makeFriendList(const Application& application);

}  // namespace tavro
