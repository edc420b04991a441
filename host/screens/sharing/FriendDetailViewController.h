#pragma once

#include "host/Diary.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

class Application;

/// A person's page: today's rings and what can be done. One's own page has nobody to write to.
/// Message: `_sendMessageButtonTapped:` ("v,@").
class CHFriendDetailCollectionViewController : public UIViewController {
 public:
  static constexpr Name className = "CHFriendDetailCollectionViewController";

  bool _isMe = false;

  /// Set before the view is asked for.
  void setPerson(std::string name, const Rings& rings, bool isMe);
  void viewDidLoad();
  void sendMessageButtonTapped(const id& item);

 private:
  std::string name_;
  Rings rings_;
};

/// The page of the first friend of the diary, or the user's own page when there are no friends.
Ref<UIViewController> makeFriendDetail(const Application& application);

}  // namespace tavro
