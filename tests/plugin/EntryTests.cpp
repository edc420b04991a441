#include <cstdint>
#include <set>
#include <stdexcept>
#include <tuple>

#include "host/libraries/Achievements.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/healthkit/HKActivitySummary.h"
#include "platform/healthkit/HKUnit.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

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

TEST_F(OpenedBundleTest, EveryCategoryButTwoIsAskedForInOrderUnderTheRunsNames) {
  bundle.initialize();
  const ValidationReport& report = manager().report();
  std::set<std::string> asked;
  for (const InstallationOutcome& outcome : report.installations) {
    EXPECT_TRUE(asked.insert(outcome.category).second) << outcome.category << " twice";
  }
  // What the bundle defines and nobody asks for.
  std::set<std::string> left;
  for (Class* isa : classesOfImage(bundle.path())) {
    const std::string name(isa->name().text());
    if (respondsTo(isa, "safeCategoryTargetClassName") && !asked.contains(name)) {
      left.insert(name);
    }
  }
  EXPECT_EQ(left, (std::set<std::string>{"TavDayCellLayerAccessibility", "WeekViewAccessibility"}));
  ASSERT_EQ(report.installations.size(), 53U);
  EXPECT_EQ(report.installations[13].category, "ActivityMoveAndExerciseChartViewAccessibility");
  EXPECT_EQ(report.installations[52].category, "CHASActivitySetupViewControllerAccessibility");
  EXPECT_EQ(report.targetName, "AX Tavro");
  EXPECT_EQ(manager().processName(), "AX Tavro");
  EXPECT_FALSE(manager().isDebugBuild());
  ASSERT_GE(report.checks.size(), 3U);
  for (std::size_t index = 0; index < 3; ++index) {
    EXPECT_EQ(report.checks[index].category, "") << "the process as a whole comes first";
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

TEST_F(OpenedBundleTest, ChecksRunOnlyWhenTheRuntimeWantsThem) {
  Settings::current().performsValidationChecks = false;
  bundle.initialize();
  EXPECT_TRUE(manager().report().checks.empty());
  EXPECT_TRUE(manager().report().installations.at(13).installed);
}

using EntryTest = PluginTest;

TEST_F(EntryTest, EveryGraftIsProvenAndNoCheckFails) {
  EXPECT_EQ(manager().report().checks.size(), 153U);
  for (const CheckOutcome& check : manager().report().checks) {
    EXPECT_TRUE(check.passed) << check.category << ": " << check.className << " " << check.member
                              << ": " << check.reason;
  }
  for (const InstallationOutcome& outcome : manager().report().installations) {
    EXPECT_TRUE(outcome.installed) << outcome.category << ": " << outcome.reason;
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
  const std::pair<std::int64_t, const char*> cases[] = {
      {-1, nullptr}, {0, "kcal"},          {1, "min"},          {2, "count"}, {3, "m"},
      {4, "count"},  {5, "count"},         {6, "mL/kg·min"},    {7, "km/hr"}, {8, "km/hr"},
      {9, nullptr},  {INT64_MIN, nullptr}, {INT64_MAX, nullptr}};
  for (const auto& [type, expected] : cases) {
    const Ref<HKUnit> unit = unitOf(type);
    EXPECT_EQ(unit ? utf8(unit->unitString()) : "(nil)", expected == nullptr ? "(nil)" : expected)
        << type;
  }
}

TEST_F(EntryTest, TheCacheIndexIsTheDayOfTheGregorianCalendar) {
  auto* const indexOf = exported<std::int64_t(const Ref<NSDate>&)>(bundle, "CHCacheIndexForDate");
  Settings& settings = Settings::current();
  const std::int64_t first = indexOf(dateWithSeconds(0));
  const std::tuple<const char*, const char*, double, std::int64_t> cases[] = {
      // Days after the first of January 1970.
      {"", "UTC", 86399, 0},
      {"", "UTC", -1, -1},
      {"hebrew", "UTC", 1773242400, 20523},
      {"", "Pacific/Kiritimati", 1773223200, 20524},
      {"", "America/New_York", 18000, 0},
      {"", "America/New_York", 17999, -1},
  };
  for (const auto& [calendar, timeZone, seconds, days] : cases) {
    settings.calendar = calendar;
    settings.timeZone = timeZone;
    EXPECT_EQ(indexOf(dateWithSeconds(seconds)) - first, days) << calendar << timeZone << seconds;
  }
  EXPECT_NO_THROW(indexOf(nullptr));
}

/// A subclass of the host's.
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

TEST_F(EntryTest, WordsThatAreNotInTheTableAreTheirKeys) {
  auto* const textOf =
      exported<Ref<NSString>(const Ref<NSString>&)>(bundle, "accessibilityLocalizedString");
  const std::pair<const char*, const char*> cases[] = {
      {"no.data", "No data"}, {"no.such.key", "no.such.key"}, {"", ""}};
  for (const auto& [key, text] : cases) {
    EXPECT_EQ(utf8(textOf(string(key))), text);
  }
  EXPECT_FALSE(textOf(nullptr));
  forgetClass("AXTavroGlue");
  EXPECT_FALSE(textOf(string("today"))) << "the plug-in's bundle cannot be found";
}

}  // namespace
}  // namespace tavro
