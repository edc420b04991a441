#include "host/screens/achievements/AchievementDetailViewController.h"
#include "host/screens/achievements/AchievementViews.h"
#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Utterances = std::vector<std::string>;

/// Gives the title that a test wants it to give, or raises.
class OddProvider : public AAUIAchievementLocalizationProvider {
 public:
  static constexpr Name className = "OddProvider";
  id title;
  bool raises = false;

  id oddTitle(const id& /*achievement*/) {
    return raises ? throw NSException(kRangeException, "no title") : title;
  }
};
const Registered oddProvider =
    defineClass<OddProvider, AAUIAchievementLocalizationProvider>().method<&OddProvider::oddTitle>(
        "titleForAchievement:");

/// A screen without the parts that it should have.
class OddDetail : public CHAchievementDetailViewController {
 public:
  static constexpr Name className = "OddDetail";
  id container;
  id text;

  id oddContainer() { return container; }
  id oddText() { return text; }
};
const Registered oddDetail = defineClass<OddDetail, CHAchievementDetailViewController>()
                                 .method<&OddDetail::oddContainer>("badgeContainer")
                                 .method<&OddDetail::oddText>("label");

class OddCell : public CHAchievementCollectionViewCell {
 public:
  static constexpr Name className = "OddCell";
  id shown;
  id oddAchievement() { return shown; }
};
const Registered oddCell =
    defineClass<OddCell, CHAchievementCollectionViewCell>().method<&OddCell::oddAchievement>(
        "achievement");

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

  static void load(const id& object) {
    send<void>(object, "_accessibilityLoadAccessibilityInformation");
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
  const auto odd = make<OddProvider>();
  provider = odd;
  const auto screen = screenOf(achievementWith("First Run", "Recorded\nonce"));
  for (const id& noTitle : {id(), id(string("")), id(number(7.0)), id(make<NSObject>())}) {
    odd->title = noTitle;
    load(screen);
    EXPECT_EQ(heard(screen->view()), Utterances{"Recorded, once"});
  }
  odd->raises = true;
  load(screen);
  EXPECT_EQ(heard(screen->view()), Utterances{"Recorded, once"});
  odd->raises = false;
  odd->title = string("T");
  load(screen);
  odd->title = nullptr;
  load(screen);
  EXPECT_EQ(heard(screen->view()).front(), "T badge") << "it keeps what it was given before";
  screen->_locProvider = nullptr;
  EXPECT_NO_THROW(load(screen));
}

TEST_F(AchievementTest, TextIsReadLineByLine) {
  struct Case {
    const char* text;
    const char* label;
  };
  const Case cases[] = {
      {"one", "one"},
      {"one\ntwo", "one, two"},
      {"one\n\ntwo\n", "one, two"},
      {"one\r\ntwo", "one, two"},
      {"one\u2028two\u2029three\u0085four", "one, two, three, four"},
      {"one, 1", "one, 1"},
  };
  const auto screen = screenOf(nullptr);
  send<id>(screen, "view");
  const auto content = makeView<CHAchievementsCellContentView>();
  for (const Case& each : cases) {
    as<UILabel>(screen->label())->setText(string(each.text));
    load(screen);
    EXPECT_EQ(heard(screen->view()), Utterances{each.label});
    content->_label->setText(string(each.text));
    EXPECT_EQ(labelOf(content), each.label);
  }
}

TEST_F(AchievementTest, ALabelWithoutTextIsLeftAsItIs) {
  const auto screen = screenOf(nullptr);
  send<id>(screen, "view");
  for (const Ref<NSString>& noText : {Ref<NSString>(), string("")}) {
    as<UILabel>(screen->label())->setText(noText);
    send<void>(screen->label(), "setAccessibilityLabel:", string("kept"));
    load(screen);
    EXPECT_EQ(labelOf(screen->label()), "kept");
  }
}

TEST_F(AchievementTest, OddPartsOfAScreenDoNotSilenceTheOthers) {
  const auto screen = makeController<OddDetail>();
  screen->setAchievement(achievementWith("First Run", ""), provider);
  const auto text = makeLabel("one\ntwo");
  const auto container = makeView<UIView>();
  screen->container = make<NSObject>();
  screen->text = text;
  load(screen);
  EXPECT_EQ(labelOf(text), "one, two");
  screen->container = container;
  screen->text = make<NSObject>();
  load(screen);
  EXPECT_EQ(heard(container), Utterances{"First Run badge"});
}

TEST_F(AchievementTest, ACellSaysItsAchievementsTitle) {
  setAddressBookFirstName("Robin");
  const auto cell = makeView<CHAchievementCollectionViewCell>({0, 0, 130, 150});
  cell->setAchievement(achievementWith("{name}'s Record", ""), string("shown"));
  show(cell);
  EXPECT_EQ(heard(cell), Utterances{"Robin's Record"});
  const auto odd = makeView<OddCell>({0, 0, 130, 150});
  for (const id& notAnAchievement : {id(), id(string("First Run")), id(make<NSObject>())}) {
    odd->shown = notAnAchievement;
    EXPECT_TRUE(send<bool>(odd, "isAccessibilityElement"));
    EXPECT_EQ(send<id>(odd, "accessibilityLabel"), id());
  }
}

TEST_F(AchievementTest, ContentIsAButtonWithItsPicturesValue) {
  const auto achievement = achievementWith("First Run", "");
  const auto content = makeView<CHAchievementsCellContentView>({0, 0, 130, 150});
  content->setAchievement(*achievement, string("First\nRun"));
  EXPECT_EQ(heard(content), Utterances{"First, Run, Not earned yet, button"});
  send<void>(content, "setAccessibilityTraits:", UIAccessibilityTraitSelected);
  EXPECT_EQ(send<UIAccessibilityTraits>(content, "accessibilityTraits"),
            UIAccessibilityTraitSelected | UIAccessibilityTraitButton);
}

TEST_F(AchievementTest, ContentWithoutTextOrPictureFallsBackToItsOwnAnswers) {
  const auto content = makeView<CHAchievementsCellContentView>({0, 0, 130, 150});
  const auto image = make<UIImage>();
  content->_badgeView->setImage(image);
  EXPECT_EQ(heard(content), Utterances{"button"});
  send<void>(content, "setAccessibilityLabel:", string("own label"));
  send<void>(content, "setAccessibilityValue:", string("own value"));
  const Utterances own{"own label, own value, button"};
  EXPECT_EQ(heard(content), own);
  send<void>(image, "setAccessibilityValue:", string(""));
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
  send<void>(header, "setAccessibilityTraits:", UIAccessibilityTraitSelected);
  EXPECT_EQ(labelOf(header), "Stand");
  EXPECT_EQ(send<UIAccessibilityTraits>(header, "accessibilityTraits"),
            UIAccessibilityTraitSelected | UIAccessibilityTraitHeader);
}

}  // namespace
}  // namespace tavro
