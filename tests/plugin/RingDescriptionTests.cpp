#include <limits>

#include "platform/runtime/Dispatch.h"
#include "tests/support/Rings.h"

namespace tavro {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// A summary that answers any fractions, or raises where one is asked for.
class OddSummary : public HKActivitySummary {
 public:
  static constexpr Name className = "OddSummary";
  double fractions[3] = {0, 0, 0};
  int raisesAt = -1;

  double move() { return at(0); }
  double exercise() { return at(1); }
  double stand() { return at(2); }

 private:
  double at(int index) {
    if (index == raisesAt) {
      raise("Odd", "raises on purpose");
    }
    return fractions[index];
  }
};

const Registered oddSummary =
    defineClass<OddSummary, HKActivitySummary>()
        .method<&OddSummary::move>("_activeEnergyCompletionPercentage")
        .method<&OddSummary::exercise>("_exerciseTimeCompletionPercentage")
        .method<&OddSummary::stand>("_standHoursCompletionPercentage");

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

TEST_F(RingDescriptionTest, PerCentsFollowTheLocale) {
  struct Case {
    const char* locale;
    const char* expected;
  };
  const Case cases[] = {
      {"de_DE",
       "Verbrannte Kalorien, 50\u00a0%, Trainingsminuten, 0\u00a0%, Stehstunden, 12\u00a0%"},
      {"he_IL", "קלוריות שנשרפו, 50%, דקות אימון, 0%, שעות עמידה, 12%"},
      {"ar_EG", "السعرات المحروقة, ٥٠٪\u061c, دقائق التمرين, ٠٪\u061c, ساعات الوقوف, ١٢٪\u061c"},
  };
  for (const Case& each : cases) {
    Settings::current().locale = each.locale;
    EXPECT_EQ(describe(0.5, 0, 0.12), each.expected) << each.locale;
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
  const auto summary = make<OddSummary>();
  ActivitySummaryCache::sharedInstance()->setSummary(daysFromCivil(2026, 3, 10), summary);
  for (const Case& each : cases) {
    std::copy_n(each.fractions, 3, summary->fractions);
    summary->raisesAt = each.raisesAt;
    EXPECT_EQ(heardAt("2026-03-10T18:00"), each.expected);
  }
}

TEST_F(RingDescriptionTest, TheDayIsGregorianAndBeginsInTheUsersTimeZone) {
  record(daysFromCivil(2026, 3, 10), 0.1, 0, 0);
  record(daysFromCivil(2026, 3, 11), 0.2, 0, 0);
  struct Case {
    const char* calendar;
    const char* timeZone;
    const char* moment;
    const char* start;
  };
  const Case cases[] = {
      {"", "UTC", "2026-03-10T23:59", "Calories burned, 10%"},
      {"hebrew", "UTC", "2026-03-10T23:59", "Calories burned, 10%"},
      {"japanese", "UTC", "2026-03-11T00:00", "Calories burned, 20%"},
      {"", "America/New_York", "2026-03-11T03:59Z", "Calories burned, 10%"},
      {"islamic", "Asia/Tokyo", "2026-03-10T15:00Z", "Calories burned, 20%"},
  };
  for (const Case& each : cases) {
    Settings::current().calendar = each.calendar;
    Settings::current().timeZone = each.timeZone;
    EXPECT_TRUE(heardAt(each.moment).starts_with(each.start))
        << each.calendar << " " << each.timeZone << ": " << heardAt(each.moment);
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

TEST_F(RingDescriptionTest, WheelchairWordingFollowsTheSettingInTheBackground) {
  const std::string stand = "Calories burned, 0%, Exercise minutes, 0%, Stand hours, 0%";
  const std::string roll = "Calories burned, 0%, Exercise minutes, 0%, Roll hours, 0%";
  Settings& settings = Settings::current();
  GlobalQueue& queue = GlobalQueue::shared();
  settings.wheelchairUse = 1;
  EXPECT_EQ(describe(0, 0, 0), stand);
  EXPECT_EQ(settings.wheelchairQueries, 1) << "the first query is waited for";

  settings.wheelchairUse = 2;
  queue.hold();
  EXPECT_EQ(describe(0, 0, 0), stand) << "a later query is not";
  EXPECT_EQ(describe(1, 1, 1), "All goals completed");
  EXPECT_EQ(queue.queuedCount(), 1U) << "what names no ring asks nothing";
  queue.release();
  queue.drain();
  EXPECT_EQ(describe(0, 0, 0), roll);

  queue.drain();
  settings.wheelchairUseFails = true;
  settings.wheelchairUse = 1;
  static_cast<void>(describe(0, 0, 0));
  queue.drain();
  EXPECT_EQ(describe(0, 0, 0), roll) << "a store that fails leaves what was known";
  queue.drain();

  settings.screenReaderRuns = false;
  const std::int64_t queries = settings.wheelchairQueries;
  EXPECT_EQ(describe(0, 0, 0), roll);
  queue.drain();
  EXPECT_EQ(settings.wheelchairQueries, queries) << "nobody listens, nothing is asked";
}

TEST_F(RingDescriptionTest, WheelchairUserIsKnownAtTheFirstWord) {
  Settings::current().wheelchairUse = 2;
  EXPECT_EQ(describe(0, 0, 0), "Calories burned, 0%, Exercise minutes, 0%, Roll hours, 0%");
}

}  // namespace
}  // namespace tavro
