#pragma once

#include "host/Diary.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

class Application;

/// Invitations and other messages from friends. Message: `_sendMessageButtonTapped:` ("v,@").
class CHFriendInboxTableViewController : public UIViewController {
 public:
  static constexpr Name className = "CHFriendInboxTableViewController";

  /// Set before the view is asked for.
  void setMessages(const std::vector<InboxMessage>& messages) { messages_ = messages; }
  void viewDidLoad();
  void sendMessageButtonTapped(const id& item);

 private:
  std::vector<InboxMessage> messages_;
};

Ref<UIViewController> makeFriendInbox(const Application& application);

}  // namespace tavro
