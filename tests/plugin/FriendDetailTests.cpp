#include "host/screens/sharing/FriendDetailCells.h"
#include "host/screens/sharing/FriendDetailViewController.h"
#include "host/screens/sharing/FriendInboxBarButtonView.h"
#include "host/screens/sharing/FriendInboxViewController.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Utterances = std::vector<std::string>;
constexpr const char* kMessages = "Messages, button, Starts a new message to a friend";

/// Answers one message as a test wants it, or raises.
class OddBadge : public CHFriendInboxBadgeView {
 public:
  static constexpr Name className = "OddBadge";
  id text;
  bool raises = false;

  id oddText() { return raises ? throw NSException(kRangeException, "no count") : text; }
};
const Registered oddBadge =
    defineClass<OddBadge, CHFriendInboxBadgeView>().method<&OddBadge::oddText>("badgeText");

/// A page whose host answers the key of its bar with something else.
class OddPage : public CHFriendDetailCollectionViewController {
 public:
  static constexpr Name className = "OddPage";
  id bar;
  id oddBar() { return bar; }
};
const Registered oddPage =
    defineClass<OddPage, CHFriendDetailCollectionViewController>().method<&OddPage::oddBar>(
        "navigationItem");

class OddBar : public NSObject {
 public:
  static constexpr Name className = "OddBar";
  id items;
  id rightItems() { return items; }
};
const Registered oddBar =
    defineClass<OddBar, NSObject>().method<&OddBar::rightItems>("rightBarButtonItems");

Ref<UIBarButtonItem> itemWith(std::string_view title, Name action) {
  const auto item = make<UIBarButtonItem>();
  item->setTitle(string(title));
  item->setTarget(nullptr, action);
  return item;
}

Ref<UIBarButtonItem> sendItem(std::string_view title) {
  return itemWith(title, "_sendMessageButtonTapped:");
}

class FriendDetailTest : public PluginTest {
 protected:
  static Ref<CHFriendDetailCollectionViewController> pageOf(bool isMe) {
    const auto page = makeController<CHFriendDetailCollectionViewController>();
    Rings rings;
    rings.move = 412;
    rings.moveGoal = 460;
    page->setPerson("Ines", rings, isMe);
    return page;
  }

  /// What a screen's right-hand items say when it is shown with these items before its own.
  Utterances rightItemsOf(const Ref<UIViewController>& controller,
                          const std::vector<Ref<UIBarButtonItem>>& items) {
    controller->navigationItem()->rightItems = items;
    send<id>(controller, "view");
    Utterances spoken;
    for (const Ref<UIBarButtonItem>& item : controller->navigationItem()->rightItems) {
      spoken.push_back(heard(item).at(0));
    }
    return spoken;
  }
};

TEST_F(FriendDetailTest, TheFirstSendMessageButtonIsLabelledAlone) {
  const auto items = [] {
    return std::vector{itemWith("Mute", "_muteTapped:"), sendItem("First"), sendItem("Second")};
  };
  // The screen's own button, a picture without a title, comes last.
  const Utterances labelled{"Mute, button", kMessages, "Second, button", "button"};
  EXPECT_EQ(rightItemsOf(pageOf(false), items()), labelled);
  EXPECT_EQ(rightItemsOf(makeController<CHFriendInboxTableViewController>(), items()), labelled);
  EXPECT_EQ(rightItemsOf(pageOf(true), items()),
            (Utterances{"Mute, button", "First, button", "Second, button"}))
      << "one's own page is left as it is";
}

TEST_F(FriendDetailTest, OnlyTheBarButtonsOfTheLoadAreLabelled) {
  const auto page = pageOf(false);
  send<id>(page, "view");
  const auto later = sendItem("Later");
  page->navigationItem()->rightItems = {later};
  EXPECT_EQ(heard(later), Utterances{"Later, button"});
  window->setRootViewController(page);
  EXPECT_EQ(heard(later), Utterances{kMessages}) << "appearing on screen is another load";
}

TEST_F(FriendDetailTest, OddBarsAreLeftAlone) {
  const auto page = makeController<OddPage>();
  const auto bar = make<OddBar>();
  for (const id& odd : {id(), id(string("bar")), id(bar)}) {
    page->bar = odd;
    EXPECT_NO_THROW(send<id>(page, "view"));
    EXPECT_NO_THROW(send<void>(page, "_accessibilityLoadAccessibilityInformation"));
  }
  const auto button = sendItem("Write");
  bar->items = button;  // no list
  send<void>(page, "_accessibilityLoadAccessibilityInformation");
  EXPECT_EQ(heard(button), Utterances{"Write, button"});
  bar->items = arrayWithObjects({string("no item"), make<UIBarButtonItem>(), button});
  send<void>(page, "_accessibilityLoadAccessibilityInformation");
  EXPECT_EQ(heard(button), Utterances{kMessages});
}

TEST_F(FriendDetailTest, APageReadsGoalsAndActionsAndItsButtonStillWrites) {
  const auto page = pageOf(false);
  window->setRootViewController(page);
  EXPECT_EQ(heard(window),
            (Utterances{"Ines, heading", kMessages, "Move, 412 of 460 kcal",
                        "Exercise, -- of 0 min", "Stand, -- of 0 hr", "Mute Notifications, button",
                        "Hide My Activity, button", "Remove Friend, button"}));
  ASSERT_TRUE(send<bool>(page->navigationItem()->rightBarButtonItem(), "accessibilityActivate"));
  const Utterances spoken = heard(window);
  EXPECT_EQ((Utterances{spoken.end() - 3, spoken.end()}),
            (Utterances{"New Message", "Cancel, button", "To: Ines"}));
  window->setRootViewController(pageOf(true));
  EXPECT_EQ(heard(window).back(), "Share Today's Activity, button");
}

TEST_F(FriendDetailTest, AGoalIsItsTitleWithItsSubtitleAsValue) {
  const auto cell = makeView<CHFriendDetailGoalCell>({0, 0, 390, 60});
  cell->_titleLabel->setText(string("Move"));
  cell->_subtitleLabel->setText(string("412KCAL"));
  EXPECT_TRUE(send<bool>(cell, "isAccessibilityElement"));
  EXPECT_EQ(labelOf(cell), "Move");
  EXPECT_EQ(valueOf(cell), "412KCAL");
  send<void>(cell->_subtitleLabel, "setAccessibilityLabel:", string("412 kilocalories"));
  EXPECT_EQ(valueOf(cell), "412 kilocalories") << "what a label says, not what it shows";
  cell->_titleLabel = nullptr;
  EXPECT_EQ(heard(cell), Utterances{"412 kilocalories"});
  cell->_subtitleLabel = nullptr;
  EXPECT_TRUE(send<bool>(cell, "isAccessibilityElement"));
  EXPECT_EQ(heard(cell), Utterances());
}

TEST_F(FriendDetailTest, AnActionIsAButtonNamedByItsFirstLabel) {
  const auto cell = makeView<CHFriendDetailActionCell>({0, 0, 390, 48});
  EXPECT_EQ(heard(cell), Utterances{"button"}) << "a button without a label";
  cell->addSubview(makeView<UIButton>());
  const auto box = makeView<UIView>();
  box->addSubview(makeView<UITableViewHeaderFooterViewLabel>());
  as<UILabel>(box->subviewList()[0])->setText(string("Nested"));
  cell->addSubview(box);
  cell->addSubview(makeLabel("Later"));
  EXPECT_EQ(heard(cell), Utterances{"Nested, button"});
  send<void>(cell, "setAccessibilityTraits:", UIAccessibilityTraitSelected);
  EXPECT_EQ(send<UIAccessibilityTraits>(cell, "accessibilityTraits"),
            UIAccessibilityTraitSelected | UIAccessibilityTraitButton);
}

TEST_F(FriendDetailTest, TheInboxButtonSaysWhatItsBadgeCounts) {
  struct Case {
    const char* locale;
    const char* text;
    const char* value;
  };
  const Case cases[] = {
      {"en_US", "3", "3 new items"},
      {"en_US", "1", "1 new item"},
      {"en_US", "0", ""},
      {"en_US", "-3", ""},
      {"en_US", "", ""},
      {"en_US", "abc", ""},
      {"en_US", "3 new", ""},
      {"en_US", " 3", ""},
      {"en_US", "3.7", "3 new items"},
      {"en_US", "0.9", ""},
      {"de_DE", "3,7", "3 neue Einträge"},
      {"de_DE", "3.7", ""},
      {"ar_EG", "٣", "3 عناصر جديدة"},
      {"en_US", "99999999999", "2147483647 new items"},
  };
  const auto button = makeView<CHFriendInboxBarButtonView>();
  const auto badge = makeView<OddBadge>();
  button->_badgeView = badge;
  for (const Case& each : cases) {
    Settings::current().locale = each.locale;
    badge->text = string(each.text);
    EXPECT_EQ(valueOf(button), each.value) << each.locale << " \"" << each.text << "\"";
  }
}

TEST_F(FriendDetailTest, TheInboxButtonIsNamedWhateverItsBadgeIs) {
  const auto button = makeView<CHFriendInboxBarButtonView>();
  const auto badge = makeView<OddBadge>();
  for (const id& noText : {id(), id(number(std::int64_t{3})), id(makeLabel("3"))}) {
    badge->text = noText;
    button->_badgeView = badge;
    EXPECT_EQ(heard(button), Utterances{"Friends inbox, button"});
  }
  badge->raises = true;
  EXPECT_EQ(valueOf(button), "");
  button->_badgeView = nullptr;
  EXPECT_EQ(heard(button), Utterances{"Friends inbox, button"});
}

}  // namespace
}  // namespace tavro
