#include <tuple>

#include "host/screens/sharing/FriendDetailCells.h"
#include "host/screens/sharing/FriendDetailViewController.h"
#include "host/screens/sharing/FriendInboxBarButtonView.h"
#include "host/screens/sharing/FriendInboxViewController.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

constexpr const char* kMessages = "Messages, button, Starts a new message to a friend";

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
  const auto page = pageOf(false);
  send<id>(page, "view");
  const auto bar = make<UINavigationItem>();
  const auto button = sendItem("Write");
  for (const id& noList : {id(), id(button)}) {
    answers(bar, "rightBarButtonItems", noList);
    for (const id& odd : {id(), id(string("bar")), id(bar)}) {
      answers(page, "navigationItem", odd);
      EXPECT_NO_THROW(load(page));
    }
  }
  EXPECT_EQ(heard(button), Utterances{"Write, button"});
  answers(bar, "rightBarButtonItems",
          arrayWithObjects({string("no item"), make<UIBarButtonItem>(), button}));
  load(page);
  EXPECT_EQ(heard(button), Utterances{kMessages});
}

TEST_F(FriendDetailTest, TheLabelledButtonStillWrites) {
  const auto page = pageOf(false);
  window->setRootViewController(page);
  ASSERT_TRUE(activate(page->navigationItem()->rightBarButtonItem()));
  const Utterances spoken = heard(window);
  EXPECT_EQ((Utterances{spoken.end() - 3, spoken.end()}),
            (Utterances{"New Message", "Cancel, button", "To: Ines"}));
  EXPECT_EQ(heardOn(pageOf(true)).back(), "Share Today's Activity, button");
}

TEST_F(FriendDetailTest, AGoalIsItsTitleWithItsSubtitleAsValue) {
  const auto cell = makeView<CHFriendDetailGoalCell>({0, 0, 390, 60});
  cell->_titleLabel->setText(string("Move"));
  cell->_subtitleLabel->setText(string("412KCAL"));
  EXPECT_TRUE(isElement(cell));
  EXPECT_EQ(labelOf(cell), "Move");
  EXPECT_EQ(valueOf(cell), "412KCAL");
  setLabel(cell->_subtitleLabel, "412 kilocalories");
  EXPECT_EQ(valueOf(cell), "412 kilocalories") << "what a label says, not what it shows";
  cell->_titleLabel = nullptr;
  EXPECT_EQ(heard(cell), Utterances{"412 kilocalories"});
  cell->_subtitleLabel = nullptr;
  EXPECT_TRUE(isElement(cell));
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
  setTraits(cell, UIAccessibilityTraitSelected);
  EXPECT_EQ(traitsOf(cell), UIAccessibilityTraitSelected | UIAccessibilityTraitButton);
}

TEST_F(FriendDetailTest, TheInboxButtonSaysWhatItsBadgeCounts) {
  const std::tuple<const char*, const char*, const char*> cases[] = {
      {"en_US", "3", "3 new items"},       {"en_US", "1", "1 new item"},
      {"en_US", "3.7", "3 new items"},     {"en_US", "0.9", ""},
      {"de_DE", "3,7", "3 neue Einträge"}, {"de_DE", "3.7", ""},
      {"ar_EG", "٣", "3 عناصر جديدة"},     {"en_US", "99999999999", "2147483647 new items"},
  };
  const auto button = makeView<CHFriendInboxBarButtonView>();
  for (const auto& [locale, text, value] : cases) {
    Settings::current().locale = locale;
    answers(button->_badgeView, "badgeText", string(text));
    EXPECT_EQ(valueOf(button), value) << locale << " \"" << text << "\"";
  }
  Settings::current().locale = "en_US";
  for (const char* const text : {"0", "-3", "", "abc", "3 new", " 3"}) {
    answers(button->_badgeView, "badgeText", string(text));
    EXPECT_EQ(valueOf(button), "") << text;
  }
}

TEST_F(FriendDetailTest, TheInboxButtonIsNamedWhateverItsBadgeIs) {
  const Utterances nameAlone{"Friends inbox, button"};
  const auto button = makeView<CHFriendInboxBarButtonView>();
  for (const id& noText : {id(), id(number(std::int64_t{3})), id(makeLabel("3"))}) {
    answers(button->_badgeView, "badgeText", noText);
    EXPECT_EQ(heard(button), nameAlone);
  }
  raises(button->_badgeView, "badgeText");
  EXPECT_EQ(heard(button), nameAlone);
  button->_badgeView = nullptr;
  EXPECT_EQ(heard(button), nameAlone);
}

}  // namespace
}  // namespace tavro
