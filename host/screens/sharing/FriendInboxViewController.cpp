#include "host/screens/sharing/FriendInboxViewController.h"

#include "host/Application.h"
#include "host/screens/sharing/MessageComposer.h"
#include "platform/uikit/UITables.h"

namespace tavro {
namespace {

using Controller = CHFriendInboxTableViewController;
const Registered controllerClass =
    defineClass<Controller, UIViewController>()
        .method<&Controller::viewDidLoad>("viewDidLoad")
        .method<&Controller::sendMessageButtonTapped>("_sendMessageButtonTapped:");

Ref<UITableViewCell> messageRow(const InboxMessage& message) {
  const auto row = makeView<UITableViewCell>();
  row->setTextLabel(makeLabel(message.from, {32, 8, 340, 22}));
  row->setDetailTextLabel(makeLabel(message.text, {32, 32, 340, 20}));
  const auto unreadDot = makeView<UIView>({12, 26, 8, 8});
  unreadDot->setHidden(!message.unread);
  row->addSubview(unreadDot);
  return row;
}

}  // namespace

void CHFriendInboxTableViewController::viewDidLoad() {
  const auto table = makeView<UITableView>({0, 0, 390, 800});
  setView(table);
  // The item shows a picture, so it has no title.
  const auto item = tavro::make<UIBarButtonItem>();
  item->setTarget(this, "_sendMessageButtonTapped:");
  navigationItem()->title = string("Inbox");
  navigationItem()->rightItems.push_back(item);
  for (const InboxMessage& message : messages_) {
    table->appendRow(messageRow(message), 60);
  }
  if (messages_.empty()) {
    table->appendRow(makeLabel("No messages"), 44);
  }
}

void CHFriendInboxTableViewController::sendMessageButtonTapped(const id& /*item*/) {
  presentMessageComposer(*view(), "");
}

Ref<UIViewController> makeFriendInbox(const Application& application) {
  const auto controller = makeController<CHFriendInboxTableViewController>();
  controller->setMessages(application.diary().inbox);
  return controller;
}

}  // namespace tavro
