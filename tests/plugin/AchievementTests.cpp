#include "host/screens/achievements/AchievementDetailViewController.h"
#include "host/screens/achievements/AchievementViews.h"
#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

Ref<ACHAchievement> achievementWith(const char* title, const char* progress) {
  auto achievement = make<ACHAchievement>();
  achievement->title = title;
  achievement->progress = progress;
  return achievement;
}

class AchievementTest : public PluginTest {
 protected:
  Ref<CHAchievementDetailViewController> screenOf(const Ref<ACHAchievement>& achievement) {
    const auto screen = makeController<CHAchievementDetailViewController>();
    screen->setAchievement(achievement, provider);
    return screen;
  }

  Ref<AAUIAchievementLocalizationProvider> provider = make<AAUIAchievementLocalizationProvider>();
};

TEST_F(AchievementTest, ABadgeIsHeardByItsTitleThoughItIsHidden) {
  const auto screen = screenOf(achievementWith("First Run", "Recorded\nfor the first time"));
  const Utterances spoken{"First Run badge", "Recorded, for the first time"};
  EXPECT_EQ(heard(screen->view()), spoken);
  as<UIView>(screen->badgeContainer())->setHidden(true);
  EXPECT_EQ(heard(screen->view()), spoken);
  as<UIView>(screen->badgeContainer())->setHidden(false);
  as<UIView>(screen->badgeContainer())->setAlpha(0);
  EXPECT_EQ(heard(screen->view()), spoken);
  // Either permission alone would do; both are given.
  const auto& given = *as<UIView>(screen->badgeContainer())->accessibility;
  EXPECT_EQ(given.viewIsVisible, true);
  EXPECT_TRUE(given.overridesInvisibility);
}

TEST_F(AchievementTest, AnotherAchievementIsHeardAfterTheNextLoad) {
  const auto screen = screenOf(achievementWith("First Run", "Once"));
  send<id>(screen, "view");
  screen->_achievement = achievementWith("First Ride", "Twice");
  as<UILabel>(screen->label())->setText(string("Twice\nor more"));
  EXPECT_EQ(heard(screen->view()), (Utterances{"First Run badge", "Once"}));
  load(screen);
  EXPECT_EQ(heard(screen->view()), (Utterances{"First Ride badge", "Twice, or more"}));
}

TEST_F(AchievementTest, WithoutATitleTheBadgeIsLeftAloneAndTheTextIsRead) {
  id title;
  bool raises = false;
  answers<id, const id&>(provider, "titleForAchievement:", [&](const id& /*achievement*/) {
    return raises ? throw NSException(kRangeException, "no title") : title;
  });
  const auto screen = screenOf(achievementWith("First Run", "Recorded\nonce"));
  for (const id& noTitle : {id(), id(string("")), id(number(7.0)), id(make<NSObject>())}) {
    title = noTitle;
    load(screen);
    EXPECT_EQ(heard(screen->view()), Utterances{"Recorded, once"});
  }
  raises = true;
  load(screen);
  EXPECT_EQ(heard(screen->view()), Utterances{"Recorded, once"});
  raises = false;
  title = string("T");
  load(screen);
  title = nullptr;
  load(screen);
  EXPECT_EQ(heard(screen->view()).front(), "T badge") << "it keeps what it was given before";
  screen->_locProvider = nullptr;
  EXPECT_NO_THROW(load(screen));
}

TEST_F(AchievementTest, TextIsReadLineByLine) {
  const std::pair<const char*, const char*> cases[] = {
      {"one", "one"},
      {"one\ntwo", "one, two"},
      {"one\n\ntwo\n", "one, two"},
      {"one\r\ntwo", "one, two"},
      {"one\u2028two\u2029three\u0085four", "one, two, three, four"},
      {"one, 1", "one, 1"}};
  const auto screen = screenOf(nullptr);
  send<id>(screen, "view");
  const auto content = makeView<CHAchievementsCellContentView>();
  for (const auto& [text, label] : cases) {
    as<UILabel>(screen->label())->setText(string(text));
    load(screen);
    EXPECT_EQ(heard(screen->view()), Utterances{label});
    content->_label->setText(string(text));
    EXPECT_EQ(labelOf(content), label);
  }
}

TEST_F(AchievementTest, ALabelWithoutTextIsLeftAsItIs) {
  const auto screen = screenOf(nullptr);
  send<id>(screen, "view");
  for (const Ref<NSString>& noText : {Ref<NSString>(), string("")}) {
    as<UILabel>(screen->label())->setText(noText);
    setLabel(screen->label(), "kept");
    load(screen);
    EXPECT_EQ(labelOf(screen->label()), "kept");
  }
}

TEST_F(AchievementTest, OddPartsOfAScreenDoNotSilenceTheOthers) {
  const auto screen = screenOf(achievementWith("First Run", ""));
  const auto text = makeLabel("one\ntwo");
  const auto container = makeView<UIView>();
  answers(screen, "badgeContainer", make<NSObject>());
  answers(screen, "label", text);
  load(screen);
  EXPECT_EQ(labelOf(text), "one, two");
  answers(screen, "badgeContainer", container);
  answers(screen, "label", make<NSObject>());
  load(screen);
  EXPECT_EQ(heard(container), Utterances{"First Run badge"});
}

TEST_F(AchievementTest, ACellSaysItsAchievementsTitle) {
  setAddressBookFirstName("Robin");
  const auto cell = makeView<CHAchievementCollectionViewCell>({0, 0, 130, 150});
  cell->setAchievement(achievementWith("{name}'s Record", ""), string("shown"));
  show(cell);
  EXPECT_EQ(heard(cell), Utterances{"Robin's Record"});
  for (const id& notAnAchievement : {id(), id(string("First Run")), id(make<NSObject>())}) {
    answers(cell, "achievement", notAnAchievement);
    EXPECT_TRUE(isElement(cell));
    EXPECT_EQ(send<id>(cell, "accessibilityLabel"), id());
  }
}

TEST_F(AchievementTest, ContentIsAButtonWithItsPicturesValue) {
  const auto achievement = achievementWith("First Run", "");
  const auto content = makeView<CHAchievementsCellContentView>({0, 0, 130, 150});
  content->setAchievement(*achievement, string("First\nRun"));
  EXPECT_EQ(heard(content), Utterances{"First, Run, Not earned yet, button"});
  setTraits(content, UIAccessibilityTraitSelected);
  EXPECT_EQ(traitsOf(content), UIAccessibilityTraitSelected | UIAccessibilityTraitButton);
}

TEST_F(AchievementTest, ContentWithoutTextOrPictureFallsBackToItsOwnAnswers) {
  const auto content = makeView<CHAchievementsCellContentView>({0, 0, 130, 150});
  const auto image = make<UIImage>();
  content->_badgeView->setImage(image);
  EXPECT_EQ(heard(content), Utterances{"button"});
  setLabel(content, "own label");
  setValue(content, "own value");
  const Utterances own{"own label, own value, button"};
  EXPECT_EQ(heard(content), own);
  setValue(image, "");
  EXPECT_EQ(heard(content), own) << "an empty value is none";
  send<void>(image, "setAccessibilityValue:", attributedString(string("gold")));
  EXPECT_EQ(heard(content), Utterances{"own label, gold, button"});
  content->_badgeView->setImage(nullptr);
  EXPECT_EQ(heard(content), own);
  content->_badgeView = nullptr;
  content->_label = nullptr;
  EXPECT_EQ(heard(content), own);
}

TEST_F(AchievementTest, ASectionIsOneHeading) {
  const auto header = makeView<CHAchievementsSectionHeaderView>({0, 0, 390, 40});
  header->setTitle("Move");
  show(header);
  EXPECT_EQ(heard(header), Utterances{"Move, heading"});
  header->setTitle("Stand");
  setTraits(header, UIAccessibilityTraitSelected);
  EXPECT_EQ(labelOf(header), "Stand");
  EXPECT_EQ(traitsOf(header), UIAccessibilityTraitSelected | UIAccessibilityTraitHeader);
}

}  // namespace
}  // namespace tavro
