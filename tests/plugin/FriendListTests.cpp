#include "host/screens/sharing/FriendListViewController.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

class FriendListTest : public PluginTest {
 protected:
  void SetUp() override {
    PluginTest::SetUp();
    Friend ines;
    ines.name = "Ines";
    ines.hasNews = true;
    ines.move = 412;
    ines.moveGoal = 460;
    ines.competition = Competition{1284, 1320, 3};
    Friend aiko;
    aiko.name = "Aiko";
    aiko.move = 205;
    aiko.moveGoal = 410;
    diary.friends = {ines, aiko};
    diary.inbox = {{"Maren", "Hello", true}, {"Wren", "Hello", false}};
  }

  Ref<CHFriendListViewController> shownList() {
    const auto controller = makeController<CHFriendListViewController>();
    controller->setDiary(&diary);
    window->setRootViewController(controller);
    return controller;
  }

  static Ref<CHFriendListTableViewCell> rowWith(const char* name, const char* lineOne,
                                                const char* lineTwo) {
    const auto row = makeView<CHFriendListTableViewCell>({0, 0, 390, 76});
    row->textLabel()->setText(name == nullptr ? nullptr : string(name));
    as<UILabel>(row->detailLineOneLabel())->setText(string(lineOne));
    as<UILabel>(row->detailLineTwoLabel())->setText(string(lineTwo));
    return row;
  }

  static void fill(const id& row, const char* name) {
    const auto person = make<ASFriend>();
    person->name = name;
    send<void>(row, "setFriend:snapshot:formattingManager:animated:", person,
               Ref<HKActivitySummary>(), make<CHFriendFormattingManager>(), false);
  }

  Diary diary;
};

TEST_F(FriendListTest, SortingIsHeardWithoutALoadAndReusedRowsReadTheirNewFriends) {
  const auto list = shownList();
  ASSERT_TRUE(activate(list->_sortBarButtonItem));
  const Utterances spoken = heard(window);
  EXPECT_EQ(spoken[0], "Sort by, Move, button");
  EXPECT_EQ(spoken[6], "Ines, Move 90%, Competition in progress");
  EXPECT_EQ(spoken[7], "Aiko, Move 50%");
  list->_sortBarButtonItem->setTitle(string("Nearby"));
  EXPECT_EQ(heard(window)[0], "Sort by, Nearby, button");
  list->_sortBarButtonItem->setTitle(nullptr);
  EXPECT_EQ(heard(window)[0], "Sort by, button");
}

TEST_F(FriendListTest, NothingIsKeptAliveByWhatItSays) {
  auto list = shownList();
  const Weak<UIBarButtonItem> button(list->_sortBarButtonItem);
  window->setRootViewController(nullptr);
  list = nullptr;
  EXPECT_EQ(button.get(), nullptr);

  auto row = rowWith("Ines", "", "");
  load(row);
  const Weak<UILabel> name(row->textLabel());
  row = nullptr;
  EXPECT_EQ(name.get(), nullptr);
}

TEST_F(FriendListTest, ASortButtonThatCannotBeReadIsLeftAlone) {
  const auto list = makeController<CHFriendListViewController>();
  EXPECT_NO_THROW(load(list)) << "before its view was loaded there is none";
  list->setDiary(&diary);
  const id other = make<UIButton>();
  answers(list, "_sortBarButtonItem", other);
  EXPECT_NO_THROW(send<id>(list, "view"));
  EXPECT_EQ(labelOf(list->_sortBarButtonItem), "Name") << "the key decides, not the variable";
  EXPECT_EQ(labelOf(other), "") << "a button of another kind";
}

TEST_F(FriendListTest, ARowReadsNameLinesAndBadgeInThisOrder) {
  struct Case {
    const char* name;
    const char* lineOne;
    const char* lineTwo;
    bool badgeIsHidden;
    const char* label;
  };
  const Case cases[] = {
      {"Ines", "one", "two", false, "Ines, one, two, Competition in progress"},
      {"Ines", "one", "two", true, "Ines, one, two"},
      {"\u2022Ines", "", "two", true, "Ines, two"},
      {"\u2022 Ines", "", "", true, " Ines"},
      {"\u2022\u2022I\u2022nes \u2022", "", "", true, "Ines "},
      {"Ines", "\u2022 one", "", true, "Ines, \u2022 one"},
      {"\u2022", "one", "", true, "one"},
      {nullptr, "one", "", false, "one, Competition in progress"},
      {"", "", "", true, ""},
  };
  for (const Case& each : cases) {
    const auto row = rowWith(each.name, each.lineOne, each.lineTwo);
    as<UIView>(row->competitionBadgeView())->setHidden(each.badgeIsHidden);
    load(row);
    EXPECT_TRUE(isElement(row));
    EXPECT_EQ(utf8(send<id>(row, "accessibilityUserDefinedLabel")), each.label);
    EXPECT_EQ(labelOf(row->competitionBadgeView()), "Competition in progress");
    EXPECT_TRUE(isElement(row->competitionBadgeView()));
  }
}

TEST_F(FriendListTest, ARowsLabelChangesWithItsFriendAlone) {
  const auto row = makeView<CHFriendListTableViewCell>({0, 0, 390, 76});
  fill(row, "Ines");
  EXPECT_EQ(labelOf(row), "Ines, No activity today");
  row->textLabel()->setText(string("Somebody"));
  EXPECT_EQ(labelOf(row), "Ines, No activity today") << "the host's later change waits";
  EXPECT_EQ(labelOf(row->textLabel()), "Somebody") << "the name itself is read afresh";
  fill(row, "Tomek");
  EXPECT_EQ(labelOf(row), "Tomek, No activity today");
}

TEST_F(FriendListTest, TheHostGetsAllFourArguments) {
  const Name selector = "setFriend:snapshot:formattingManager:animated:";
  const auto row = rowWith("Ines", "", "");
  std::vector<id> seen;
  hostAnswers<void, const id&, const id&, const id&, bool>(
      row, selector, [&](const id& person, const id& snapshot, const id& manager, bool animated) {
        seen = {person, snapshot, manager};
        EXPECT_TRUE(animated);
      });
  const std::vector<id> sent{string("friend"), string("snapshot"), string("manager")};
  send<void>(row, selector, sent[0], sent[1], sent[2], true);
  EXPECT_EQ(seen, sent);
}

TEST_F(FriendListTest, AbsentPartsAreLeftOutAndTheRestIsRead) {
  const auto row = rowWith("Ines", "", "");
  setLabel(row, "kept");
  for (const id& notALabel : {id(), id(string("Ines")), id(makeView<UIView>())}) {
    answers(row, "textLabel", notALabel);
    load(row);
    EXPECT_EQ(labelOf(row), "kept") << "without a name label nothing changes";
  }
  answers(row, "textLabel", makeLabel("Ines"));
  answers(row, "detailLineTwoLabel", nullptr);
  answers(row, "competitionBadgeView", nullptr);
  load(row);
  EXPECT_EQ(labelOf(row), "Ines");
  answers(row, "detailLineTwoLabel", makeLabel("two"));
  answers(row, "competitionBadgeView", make<NSObject>());
  raises(row, "detailLineOneLabel");
  load(row);
  EXPECT_EQ(labelOf(row), "Ines, two, Competition in progress");
}

TEST_F(FriendListTest, ACompetitionReadsItsScoreThenItsDays) {
  const auto row = makeView<CHFriendListCompetitionTableViewCell>({0, 0, 390, 60});
  row->setCompetition("Ines", {1284, 1320, 1});
  show(row);
  EXPECT_EQ(heard(row), Utterances{"You 1,284, Ines 1,320, 1 day remaining"});
  row->setCompetition("Tomek", {455, 310.4, 6});
  row->_scoreView->setHidden(true);
  EXPECT_EQ(heard(row), Utterances{"6 days remaining"});
  row->_scoreView = nullptr;
  row->_daysRemainingLabel = nullptr;
  EXPECT_TRUE(isElement(row));
  EXPECT_EQ(heard(row), Utterances());
}

}  // namespace
}  // namespace tavro
