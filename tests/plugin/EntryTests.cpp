#include <cstdint>
#include <stdexcept>

#include "host/libraries/Achievements.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSBundle.h"
#include "platform/healthkit/HKActivitySummary.h"
#include "platform/healthkit/HKUnit.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

constexpr const char* kInstallationOrder[] = {
    "CHListSummaryTableViewCellAccessibility",
    "CHAchievementsCellContentViewAccessibility",
    "TrendPairTableViewCellAccessibility",
    "DayViewActivityRingsTableViewCellAccessibility",
    "TrendDetailDailyAverageViewAccessibility",
    "TrendDetailChartViewAccessibility",
    "TrendDetailSummaryViewAccessibility",
    "TrendListHeaderViewAccessibility",
    "TrendingDownTableViewCellAccessibility",
    "TrendListMetricViewAccessibility",
    "DayViewStandChartTableViewCellAccessibility",
    "ActivityStandChartViewAccessibility",
    "DayViewMoveAndExerciseChartTableViewCellAccessibility",
    "ActivityMoveAndExerciseChartViewAccessibility",
    "CHFriendListCompetitionTableViewCellAccessibility",
    "CHNoHeartRateDataViewControllerAccessibility",
    "CHFriendInboxTableViewControllerAccessibility",
    "CHFriendListViewControllerAccessibility",
    "CHWorkoutDetailHeartRateChartTableViewCellAccessibility",
    "CHWorkoutDetailHeartRateChartViewAccessibility",
    "CHFriendListTableViewCellAccessibility",
    "CHAchievementsSectionHeaderViewAccessibility",
    "CHWorkoutsListTableViewCellAccessibility",
    "CHFriendInboxBarButtonViewAccessibility",
    "CHFriendDetailCollectionViewControllerAccessibility",
    "CHFriendDetailActionCellAccessibility",
    "CHFriendDetailGoalCellAccessibility",
    "CHAchievementCollectionViewCellAccessibility",
    "_CHWorkoutDetailWeatherViewAccessibility",
    "CHWorkoutDetailMapViewAccessibility",
    "CHWorkoutDetailExpandingHeaderViewAccessibility",
    "CHListTableHeaderViewAccessibility",
    "_CHWorkoutSummaryTabbedLabelContainerAccessibility",
    "PaletteViewControllerAccessibility",
    "CHWorkoutDetailMapAndWeatherTableViewCellAccessibility",
    "CHWorkoutDetailTwoValueTableViewCellAccessibility",
    "CHWorkoutDetailPaceTableViewCellAccessibility",
    "CHWorkoutDetailSplitTableViewCellAccessibility",
    "CHWorkoutFormattingManagerAccessibility",
    "_TavroMonthTitleLabelAccessibility",
    "TavroUIScrollViewAccessibility",
    "MonthScrollViewControllerAccessibility",
    "LoadingViewAccessibility",
    "CHAchievementDetailViewControllerAccessibility",
    "TavroUIButtonAccessibility",
    "MonthViewControllerAccessibility",
    "MonthDayCellLayerAccessibility",
    "MonthWeekViewAccessibility",
    "PaletteWeekdayHeaderViewAccessibility",
    "WeekPaletteTappableDayAccessibility",
    "AX_TavroNSStringAccessibility",
    "CHASActivitySetupGoalViewAccessibility",
    "CHASActivitySetupViewControllerAccessibility",
};

const AXValidationManager& manager() { return *AXValidationManager::sharedInstance(); }

/// The bundle is open but nothing of it ran.
class OpenedBundleTest : public ::testing::Test {
 protected:
  LoadedBundle bundle = openAccessibilityBundle(bundlePath());
};

TEST_F(OpenedBundleTest, NothingIsInstalledBeforeTheEntryIsCalled) {
  EXPECT_TRUE(bundle.problems().empty());
  EXPECT_TRUE(manager().report().installations.empty());
  EXPECT_TRUE(manager().report().checks.empty());
  Class* const glue = Class::named("AXTavroGlue");
  ASSERT_NE(glue, nullptr);
  EXPECT_EQ(glue->image(), bundle.path());
  EXPECT_FALSE(send<id>(glue, "accessibilityBundles"));
}

TEST_F(OpenedBundleTest, TheCategoriesAreAskedForInTheirOrderUnderTheRunsNames) {
  bundle.initialize();
  const ValidationReport& report = manager().report();
  ASSERT_EQ(report.installations.size(), std::size(kInstallationOrder));
  for (std::size_t index = 0; index < std::size(kInstallationOrder); ++index) {
    EXPECT_EQ(report.installations[index].category, kInstallationOrder[index]) << index + 1;
  }
  EXPECT_EQ(report.targetName, "AX Tavro");
  EXPECT_EQ(manager().processName(), "AX Tavro");
  EXPECT_FALSE(manager().isDebugBuild());
  ASSERT_GE(report.checks.size(), 3U);
  const char* const first[][2] = {{"NSCalendar", "hk_gregorianCalendarWithUTCTimeZone"},
                                  {"ActivitySummaryCache", "activitySummaryForCacheIndex:"},
                                  {"HKActivitySummary", "_exerciseTimeCompletionPercentage"}};
  for (std::size_t index = 0; index < std::size(first); ++index) {
    const CheckOutcome& check = report.checks[index];
    EXPECT_EQ(check.className, first[index][0]);
    EXPECT_EQ(check.member, first[index][1]);
    EXPECT_EQ(check.category, "");
    EXPECT_TRUE(check.passed) << check.reason;
  }
}

TEST_F(OpenedBundleTest, ASecondCallNeitherValidatesNorInstalls) {
  AXValidationManager::sharedInstance()->setDebugBuild(true);
  bundle.initialize();
  EXPECT_FALSE(manager().isDebugBuild()) << "the run switches it off";
  const ValidationReport first = manager().report();
  const Method* const grafted =
      Class::named("TavroApp.ActivityMoveAndExerciseChartView")->method("accessibilityElements");
  bundle.initialize();
  openAccessibilityBundle(bundlePath()).initialize();
  EXPECT_EQ(manager().report().checks.size(), first.checks.size());
  EXPECT_EQ(manager().report().installations.size(), first.installations.size());
  EXPECT_EQ(
      Class::named("TavroApp.ActivityMoveAndExerciseChartView")->method("accessibilityElements"),
      grafted);
}

TEST_F(OpenedBundleTest, SkippedCategoriesAreReportedAndTheOthersInstalled) {
  forgetClass("DayViewActivityRingsTableViewCellAccessibility");
  forgetClass("TavroApp.DayViewMoveAndExerciseChartTableViewCell");
  bundle.initialize();
  const std::vector<InstallationOutcome>& outcomes = manager().report().installations;
  ASSERT_EQ(outcomes.size(), std::size(kInstallationOrder));
  EXPECT_EQ(outcomes[3].reason, "the category's class is not loaded");
  EXPECT_EQ(outcomes[12].target, "TavroApp.DayViewMoveAndExerciseChartTableViewCell");
  EXPECT_EQ(outcomes[12].reason, "the target class is not loaded");
  EXPECT_FALSE(outcomes[3].installed || outcomes[12].installed);
  EXPECT_TRUE(outcomes[13].installed) << "one that fails does not stop the next";
}

TEST_F(OpenedBundleTest, ChecksRunOnlyWhenTheRuntimeWantsThem) {
  Settings::current().performsValidationChecks = false;
  bundle.initialize();
  EXPECT_TRUE(manager().report().checks.empty());
  EXPECT_TRUE(manager().report().installations.at(13).installed);
}

using EntryTest = PluginTest;

TEST_F(EntryTest, EveryGraftIsProvenAndNoCheckFails) {
  for (const CheckOutcome& check : manager().report().checks) {
    EXPECT_TRUE(check.passed) << check.category << ": " << check.className << " " << check.member
                              << ": " << check.reason;
  }
  for (const InstallationOutcome& outcome : manager().report().installations) {
    for (const GraftOutcome& method : outcome.methods) {
      EXPECT_TRUE(method.intercepts)
          << outcome.category << " " << method.selector << ": " << method.reason;
    }
  }
}

// What the host raises, in the ways in which hosts raise.

id unknownSelector(Object* self) { return send<id>(self, "noSuchSelector"); }
id outOfRange(Object* /*self*/) { return send<id>(arrayWithObjects({}), "objectAtIndex:", 7); }
id standard(Object* /*self*/) { throw std::out_of_range("no such element"); }
id integer(Object* /*self*/) { throw 42; }

TEST_F(EntryTest, WhatTheHostRaisesIsContainedInThePlugin) {
  Class* const cell = Class::named("TavroApp.DayViewMoveAndExerciseChartTableViewCell");
  ASSERT_NE(cell, nullptr);
  const Method raising[] = {methodOf<&unknownSelector>("chartView"),
                            methodOf<&outOfRange>("chartView"), methodOf<&standard>("chartView"),
                            methodOf<&integer>("chartView")};
  for (const Method& method : raising) {
    cell->setMethod(method);
    const id object = send<id>(cell, "new");
    EXPECT_ANY_THROW(send<id>(object, "chartView")) << "the host does raise";
    Ref<NSArray> elements;
    ASSERT_NO_THROW(elements = elementsOf(object));
    ASSERT_TRUE(elements);
    EXPECT_EQ(elements->count(), 2U) << "the pair and the auxiliary label still speak";
  }
}

// Exported functions, found as a host process finds them.

template <class Function>
Function* exported(const LoadedBundle& bundle, const char* name) {
  void* const found = bundle.symbol(name);
  EXPECT_NE(found, nullptr) << name;
  return reinterpret_cast<Function*>(found);
}

TEST_F(EntryTest, TrendTypesHaveTheirUnits) {
  auto* const unitOf =
      exported<Ref<HKUnit>(std::int64_t)>(bundle, "accessibilityHKUnitForTrendType");
  const struct {
    std::int64_t type;
    const char* unit;  // null: none
  } cases[] = {{-1, nullptr}, {0, "kcal"},          {1, "min"},          {2, "count"}, {3, "m"},
               {4, "count"},  {5, "count"},         {6, "mL/kg·min"},    {7, "km/hr"}, {8, "km/hr"},
               {9, nullptr},  {INT64_MIN, nullptr}, {INT64_MAX, nullptr}};
  for (const auto& each : cases) {
    const Ref<HKUnit> unit = unitOf(each.type);
    EXPECT_EQ(unit ? utf8(unit->unitString()) : "(nil)", each.unit == nullptr ? "(nil)" : each.unit)
        << each.type;
  }
}

TEST_F(EntryTest, TheCacheIndexIsTheDayOfTheGregorianCalendar) {
  auto* const indexOf = exported<std::int64_t(const Ref<NSDate>&)>(bundle, "CHCacheIndexForDate");
  Settings& settings = Settings::current();
  const std::int64_t first = indexOf(dateWithSeconds(0));
  const struct {
    const char* calendar;
    const char* locale;
    const char* timeZone;
    double seconds;
    std::int64_t days;  // after the first of January 1970
  } cases[] = {
      {"", "en_US", "UTC", 86399, 0},
      {"", "en_US", "UTC", 86400, 1},
      {"", "en_US", "UTC", -1, -1},
      {"hebrew", "en_US", "UTC", 1773242400, 20523},
      {"islamic", "en_US", "UTC", 1773242400, 20523},
      {"buddhist", "en_US", "UTC", 1773242400, 20523},
      {"", "fa_IR", "UTC", 1773242400, 20523},
      {"", "en_US", "Pacific/Kiritimati", 1773223200, 20524},
      {"", "en_US", "Pacific/Kiritimati", 1773223199, 20523},
      {"", "en_US", "America/New_York", 18000, 0},
      {"", "en_US", "America/New_York", 17999, -1},
  };
  for (const auto& each : cases) {
    settings.calendar = each.calendar;
    settings.locale = each.locale;
    settings.timeZone = each.timeZone;
    EXPECT_EQ(indexOf(dateWithSeconds(each.seconds)) - first, each.days)
        << each.calendar << each.locale << each.timeZone << " " << each.seconds;
  }
  EXPECT_NO_THROW(indexOf(nullptr));
}

class SpecialAchievement : public ACHAchievement {
 public:
  static constexpr Name className = "EntryTestSpecialAchievement";
};
const Registered specialAchievement = defineClass<SpecialAchievement, ACHAchievement>();

template <class T>
Ref<T> achievement() {
  const Ref<T> made = make<T>();
  made->title = "{name} walked";
  made->wheelchairTitle = "{name} rolled";
  return made;
}

TEST_F(EntryTest, AchievementsAreTitledForTheUserOfTheFirstCall) {
  auto* const titleOf =
      exported<Ref<NSString>(const id&)>(bundle, "accessibilityLocalizedStringForAchievement");
  Settings& settings = Settings::current();
  setAddressBookFirstName("Ida");
  settings.wheelchairUse = 2;
  EXPECT_EQ(utf8(titleOf(achievement<ACHAchievement>())), "Ida rolled");
  setAddressBookFirstName("Otto");
  settings.wheelchairUse = 1;
  EXPECT_EQ(utf8(titleOf(achievement<SpecialAchievement>())), "Ida rolled");
  EXPECT_EQ(settings.wheelchairQueries, 1) << "asked for once, not refreshed";
  for (const id& other : {id(), id(string("text")), id(classOf<ACHAchievement>())}) {
    EXPECT_FALSE(titleOf(other));
  }
  forgetClass("ACHAchievement");
  EXPECT_FALSE(titleOf(achievement<SpecialAchievement>())) << "the class is not loaded";
}

TEST_F(EntryTest, AnotherObjectMayBeTheFirstToSettleTheUser) {
  auto* const titleOf =
      exported<Ref<NSString>(const id&)>(bundle, "accessibilityLocalizedStringForAchievement");
  setAddressBookFirstName("");
  Settings::current().screenReaderRuns = false;
  Settings::current().wheelchairUse = 2;
  EXPECT_FALSE(titleOf(string("no achievement")));
  setAddressBookFirstName("Ida");
  Settings::current().screenReaderRuns = true;
  EXPECT_EQ(utf8(titleOf(achievement<ACHAchievement>())), " walked");
}

TEST_F(EntryTest, EveryWordIsInTheTable) {
  const char* const keys[] = {"today",
                              "no.data",
                              "worked.out",
                              "today.indicator",
                              "lifestyle.all.goals.completed",
                              "lifestyle.goal.completed",
                              "lifestyle.calories.burned",
                              "lifestyle.active.minutes",
                              "lifestyle.active.hours",
                              "lifestyle.active.hours.wheelchair.roll",
                              "calories.format",
                              "minutes.format",
                              "stand.goal.active",
                              "stand.goal.inactive",
                              "summary.cell.header.total",
                              "summary.cell.header.average",
                              "heart.rate.graph.single",
                              "heart.rate.graph.range",
                              "workout.detail.map.hint",
                              "trends.value.with.unit",
                              "trends.365.day.average",
                              "trends.90.day.average",
                              "sort.by.options",
                              "competition.in.progress",
                              "messages",
                              "messages.hint",
                              "friend.list",
                              "badge.format",
                              "achievement.badge.format"};
  auto* const textOf =
      exported<Ref<NSString>(const Ref<NSString>&)>(bundle, "accessibilityLocalizedString");
  const Ref<NSBundle> resources = NSBundle::bundleWithPath(bundle.path());
  const StringTable& table = resources->table("Accessibility");
  EXPECT_EQ(table.size(), std::size(keys)) << "nothing is translated that nobody says";
  for (const char* const key : keys) {
    EXPECT_TRUE(table.contains(key)) << key;
    const std::string text = utf8(textOf(string(key)));
    EXPECT_NE(text, key);
    EXPECT_NE(text, "") << key;
  }
  EXPECT_EQ(utf8(textOf(string("no.such.key"))), "no.such.key");
  EXPECT_EQ(utf8(textOf(string(""))), "");
  EXPECT_FALSE(textOf(nullptr));
  forgetClass("AXTavroGlue");
  EXPECT_FALSE(textOf(string("today"))) << "the plug-in's bundle cannot be found";
}

}  // namespace
}  // namespace tavro
