#include <limits>
#include <tuple>

#include "tests/support/Rings.h"

namespace tavro {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

id raiseAnyway(Object* /*self*/, double, double, double, bool) { raise("Odd", "on purpose"); }
id stringForIndex(Object* /*self*/, std::int64_t) { return string("no summary"); }
id raiseForIndex(Object* /*self*/, std::int64_t) { raise("Odd", "on purpose"); }

constexpr Name kAnswer =
    "accessibilityDescriptionForPercentages:exercisingPercentage:standingPercentage:"
    "arePercentagesCapped:";
constexpr Name kGuardedAnswer =
    "_tavroUIAccessibilityDescriptionForPercentages:exercisingPercentage:standingPercentage:"
    "arePercentagesCapped:";

class RingDescriptionTest : public RingsTest {
 protected:
  void SetUp() override {
    RingsTest::SetUp();
    describe_ = reinterpret_cast<decltype(describe_)>(
        bundle.symbol("accessibilityDescriptionForPercentages"));
    forDate_ =
        reinterpret_cast<decltype(forDate_)>(bundle.symbol("accessibilityTavroStringForDate"));
    ASSERT_NE(describe_, nullptr);
    ASSERT_NE(forDate_, nullptr);
  }

  std::string describe(double move, double exercise, double stand, bool isCapped = true) const {
    return utf8(describe_(move, exercise, stand, isCapped));
  }
  /// "(nil)" for nothing.
  std::string heardAt(const char* moment, bool isCapped = true) const {
    const Ref<NSString> text = forDate_(at(moment), isCapped);
    return text ? text->utf8() : "(nil)";
  }

 private:
  Ref<NSString> (*describe_)(double, double, double, bool) = nullptr;
  Ref<NSString> (*forDate_)(const Ref<NSDate>&, bool) = nullptr;
};

TEST_F(RingDescriptionTest, FractionsAreSpokenRingByRing) {
  struct Case {
    double move, exercise, stand;
    bool isCapped;
    const char* expected;
  };
  const Case cases[] = {
      {1, 1, 1, true, "All goals completed"},
      {1, 1, 1, false, "Calories burned, 100%, Exercise minutes, 100%, Stand hours, 100%"},
      {1, 1, 0.4, true,
       "Calories burned, Goal completed, Exercise minutes, Goal completed, Stand hours, 40%"},
      {1, 0.4, 1, true,
       "Calories burned, Goal completed, Exercise minutes, 40%, Stand hours, Goal completed"},
      {1.2, 0, 0, true, "Calories burned, 120%, Exercise minutes, 0%, Stand hours, 0%"},
      {1.37, 0.5, 12.34, false,
       "Calories burned, 137%, Exercise minutes, 50%, Stand hours, 1,234%"},
      {-0.5, -kInfinity, -0.0, false, "Calories burned, 0%, Exercise minutes, 0%, Stand hours, 0%"},
      {-1, kNaN, 1, true, "Calories burned, 0%, Exercise minutes, 0%, Stand hours, Goal completed"},
      // Only exactly 1 is a goal that is met, though these round to one hundred per cent.
      {0.9999999999, 1.0000000001, 1, true,
       "Calories burned, 100%, Exercise minutes, 100%, Stand hours, Goal completed"},
      {kInfinity, 0, 0, false, "Calories burned, Exercise minutes, 0%, Stand hours, 0%"},
  };
  for (const Case& each : cases) {
    EXPECT_EQ(describe(each.move, each.exercise, each.stand, each.isCapped), each.expected);
  }
}

TEST_F(RingDescriptionTest, ADayIsSilentUnlessAllItsFractionsAreRecorded) {
  struct Case {
    double fractions[3];
    int raisesAt;
    const char* expected;
  };
  const Case cases[] = {
      {{0.5, 0.25, 1},
       -1,
       "Calories burned, 50%, Exercise minutes, 25%, Stand hours, Goal completed"},
      {{0, 0, 0}, -1, "Calories burned, 0%, Exercise minutes, 0%, Stand hours, 0%"},
      {{-0.01, 0.25, 1}, -1, "(nil)"},
      {{0.5, -1, 1}, -1, "(nil)"},
      {{0.5, 0.25, -1}, -1, "(nil)"},
      {{kNaN, 0.25, 1}, -1, "(nil)"},
      {{0.5, kNaN, 1}, -1, "(nil)"},
      {{0.5, 0.25, kNaN}, -1, "(nil)"},
      {{0.5, 0.25, 1}, 0, "(nil)"},
      // Safe key access reads an accessor that raises as 0.
      {{0.5, 0.25, 1},
       1,
       "Calories burned, 50%, Exercise minutes, 0%, Stand hours, Goal completed"},
      {{0.5, 0.25, 1}, 2, "(nil)"},
  };
  const Name selectors[] = {"_activeEnergyCompletionPercentage",
                            "_exerciseTimeCompletionPercentage", "_standHoursCompletionPercentage"};
  const auto summary = make<HKActivitySummary>();
  ActivitySummaryCache::sharedInstance()->setSummary(daysFromCivil(2026, 3, 10), summary);
  for (const Case& each : cases) {
    for (int ring = 0; ring < 3; ++ring) {
      answers<double>(summary, selectors[ring], [ring, &each] {
        return ring == each.raisesAt ? throw NSException("Odd", "on purpose")
                                     : each.fractions[ring];
      });
    }
    EXPECT_EQ(heardAt("2026-03-10T18:00"), each.expected);
  }
}

TEST_F(RingDescriptionTest, CappedIsHandedOn) {
  record(daysFromCivil(2026, 3, 10), 1, 1, 1);
  EXPECT_EQ(heardAt("2026-03-10", true), "All goals completed");
  EXPECT_EQ(heardAt("2026-03-10", false),
            "Calories burned, 100%, Exercise minutes, 100%, Stand hours, 100%");
}

TEST_F(RingDescriptionTest, ACacheThatCannotAnswerLeavesTheDaySilent) {
  record(daysFromCivil(2026, 3, 10), 1, 1, 1);
  EXPECT_EQ(heardAt("2026-03-09"), "(nil)") << "a day without a summary";
  Class* const cache = classOf<ActivitySummaryCache>();
  cache->setMethod(methodOf<&stringForIndex>("activitySummaryForCacheIndex:"));
  EXPECT_EQ(heardAt("2026-03-10"), "(nil)") << "an object that is no summary";
  cache->setMethod(methodOf<&raiseForIndex>("activitySummaryForCacheIndex:"));
  EXPECT_EQ(heardAt("2026-03-10"), "(nil)");
  forgetClass("ActivitySummaryCache");
  EXPECT_EQ(heardAt("2026-03-10"), "(nil)");
}

TEST_F(RingDescriptionTest, AnAnswerThatRaisesIsContained) {
  record(daysFromCivil(2026, 3, 10), 1, 1, 1);
  classOf<HKActivitySummary>()->setMethod(methodOf<&raiseAnyway>(kAnswer));
  EXPECT_EQ(heardAt("2026-03-10"), "(nil)");
}

TEST_F(PluginTest, WithoutAnAnswerForSummariesTheDayIsSilent) {
  const auto summary = make<HKActivitySummary>();
  summary->activeEnergy = summary->exerciseTime = summary->standHours = {1.0, 1.0};
  ActivitySummaryCache::sharedInstance()->setSummary(daysFromCivil(2026, 3, 10), summary);
  using ForDate = Ref<NSString> (*)(const Ref<NSDate>&, bool);
  const auto forDate = reinterpret_cast<ForDate>(bundle.symbol("accessibilityTavroStringForDate"));
  EXPECT_FALSE(respondsTo(summary.get(), kAnswer)) << "the plug-in adds no answer of its own";
  EXPECT_FALSE(forDate(dateWithSeconds(secondsFromIso("2026-03-10").value()), true));
  EXPECT_FALSE(trySend<id>(summary, kGuardedAnswer, 1.0, 1.0, 1.0, true));
}

TEST(RingCategoryTest, EveryObjectKeepsARingsDescriptionAsSoonAsTheBundleIsOpen) {
  openAccessibilityBundle(bundlePath());  // not initialised: nothing is installed
  const auto object = make<NSObject>();
  const auto other = make<NSObject>();
  ASSERT_TRUE(respondsTo(object.get(), kGuardedAnswer));
  EXPECT_FALSE(send<id>(object, kGuardedAnswer, 0.0, 0.0, 0.0, false));
  EXPECT_FALSE(send<id>(object, "_accessibilityRingsDescription"));
  send<void>(object, "_accessibilitySetRingsDescription:", string("Half way"));
  EXPECT_EQ(utf8(send<id>(object, "_accessibilityRingsDescription")), "Half way");
  EXPECT_FALSE(send<id>(other, "_accessibilityRingsDescription"));
  send<void>(object, "_accessibilitySetRingsDescription:", nullptr);
  EXPECT_FALSE(send<id>(object, "_accessibilityRingsDescription"));
}

TEST_F(RingDescriptionTest, WheelchairWordingFollowsTheSetting) {
  Settings::current().wheelchairUse = 2;
  EXPECT_EQ(describe(1, 1, 1), "All goals completed");
  EXPECT_EQ(Settings::current().wheelchairQueries, 0) << "what names no ring asks nothing";
  EXPECT_EQ(describe(0, 0, 0), "Calories burned, 0%, Exercise minutes, 0%, Roll hours, 0%");
}

}  // namespace
}  // namespace tavro
