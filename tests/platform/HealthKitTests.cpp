#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <tuple>

#include "platform/foundation/Settings.h"
#include "platform/healthkit/HKActivitySummary.h"
#include "platform/healthkit/HKHealthStore.h"
#include "platform/healthkit/HKQuantity.h"

namespace tavro {
namespace {

Ref<HKUnit> per(const Ref<HKUnit>& unit, const Ref<HKUnit>& other) {
  return unit->unitDividedByUnit(other);
}
Ref<HKUnit> millilitersPerKilogramMinute() {
  return per(per(HKUnit::literUnitWithMetricPrefix(HKMetricPrefix::milli),
                 HKUnit::gramUnitWithMetricPrefix(HKMetricPrefix::kilo)),
             HKUnit::minuteUnit());
}
Ref<HKUnit> kilometersPerHour() {
  return per(HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::kilo), HKUnit::hourUnit());
}
Ref<HKUnit> metersPerSecond() { return per(HKUnit::meterUnit(), HKUnit::secondUnit()); }
Ref<HKUnit> countsPerMinute() { return per(HKUnit::countUnit(), HKUnit::minuteUnit()); }
Ref<HKUnit> countsPerSecond() { return per(HKUnit::countUnit(), HKUnit::secondUnit()); }

TEST(HKUnit, PrintsItsFactors) {
  const std::pair<Ref<HKUnit>, const char*> cases[] = {
      {HKUnit::kilocalorieUnit(), "kcal"},
      {HKUnit::minuteUnit(), "min"},
      {HKUnit::countUnit(), "count"},
      {HKUnit::meterUnit(), "m"},
      {HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::none), "m"},
      {HKUnit::gramUnitWithMetricPrefix(HKMetricPrefix::micro), "µg"},
      {HKUnit::literUnitWithMetricPrefix(HKMetricPrefix::deca), "daL"},
      {kilometersPerHour(), "km/hr"},
      {countsPerMinute(), "count/min"},
      {millilitersPerKilogramMinute(), "mL/kg·min"},
      {metersPerSecond()->unitDividedByUnit(HKUnit::secondUnit()), "m/s^2"},
      {HKUnit::minuteUnit()->unitDividedByUnit(HKUnit::minuteUnit()), "1"},
      {HKUnit::countUnit()->unitDividedByUnit(countsPerMinute()), "min"},
      {per(per(HKUnit::hourUnit(), kilometersPerHour()), HKUnit::hourUnit()), "hr/km"},
  };
  for (const auto& [unit, text] : cases) {
    EXPECT_EQ(utf8(unit->unitString()), text);
    EXPECT_EQ(utf8(send<id>(unit, "description")), text);
  }
}

TEST(HKUnit, RefusesPrefixesAndUnitsThatAreNone) {
  Class* const unit = Class::named("HKUnit");
  EXPECT_THROW(send<id>(unit, "meterUnitWithMetricPrefix:", 13), NSException);
  EXPECT_THROW(send<id>(unit, "meterUnitWithMetricPrefix:", -1), NSException);
  EXPECT_THROW(send<id>(HKUnit::meterUnit(), "unitDividedByUnit:", id()), NSException);
}

TEST(HKQuantity, ConvertsBetweenUnitsOfOneDimension) {
  const Ref<HKUnit> kilometer = HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::kilo);
  const Ref<HKUnit> kilogram = HKUnit::gramUnitWithMetricPrefix(HKMetricPrefix::kilo);
  const Ref<HKUnit> centimeter = HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::centi);
  const Ref<HKUnit> milliliter = HKUnit::literUnitWithMetricPrefix(HKMetricPrefix::milli);
  const Ref<HKUnit> literPerGramHour =
      per(per(HKUnit::literUnit(), HKUnit::gramUnit()), HKUnit::hourUnit());
  const std::tuple<double, Ref<HKUnit>, double, Ref<HKUnit>> cases[] = {
      {5000, HKUnit::meterUnit(), 5, kilometer},
      {1.5, HKUnit::hourUnit(), 90, HKUnit::minuteUnit()},
      {36, kilometersPerHour(), 10, metersPerSecond()},
      {90, countsPerMinute(), 1.5, countsPerSecond()},
      {2, HKUnit::literUnit(), 2000, milliliter},
      {2.5, kilogram, 2500, HKUnit::gramUnit()},
      {-3, HKUnit::meterUnit(), -300, centimeter},
      {1000, millilitersPerKilogramMinute(), 0.06, literPerGramHour},
  };
  for (const auto& [value, unit, converted, other] : cases) {
    const Ref<HKQuantity> quantity = HKQuantity::quantityWithUnit(unit, value);
    SCOPED_TRACE(utf8(quantity->description()));
    ASSERT_TRUE(send<bool>(quantity, "isCompatibleWithUnit:", other));
    EXPECT_NEAR(send<double>(quantity, "doubleValueForUnit:", other), converted, 1e-9);
    EXPECT_NEAR(HKQuantity::quantityWithUnit(other, converted)->doubleValueForUnit(unit), value,
                1e-9);
  }
  // What is not converted comes back unchanged, to the last bit.
  EXPECT_EQ(HKQuantity::quantityWithUnit(kilometersPerHour(), 0.1)
                ->doubleValueForUnit(kilometersPerHour()),
            0.1);
}

TEST(HKQuantity, OtherDimensionsAreIncompatibleAndRaise) {
  const Ref<HKUnit> units[] = {
      HKUnit::kilocalorieUnit(), HKUnit::minuteUnit(), HKUnit::countUnit(),
      HKUnit::meterUnit(),       HKUnit::literUnit(),  HKUnit::gramUnit(),
      kilometersPerHour(),       countsPerMinute(),    millilitersPerKilogramMinute(),
  };
  for (const Ref<HKUnit>& unit : units) {
    const Ref<HKQuantity> quantity = HKQuantity::quantityWithUnit(unit, 1);
    for (const Ref<HKUnit>& other : units) {
      SCOPED_TRACE(utf8(unit->unitString()) + " to " + utf8(other->unitString()));
      const bool isSame = unit == other;
      EXPECT_EQ(quantity->isCompatibleWithUnit(other), isSame);
      if (!isSame) {
        EXPECT_THROW(send<double>(quantity, "doubleValueForUnit:", other), NSException);
      }
    }
    EXPECT_FALSE(quantity->isCompatibleWithUnit(nullptr));
    EXPECT_THROW((void)quantity->doubleValueForUnit(nullptr), NSException);
  }
  EXPECT_THROW(send<id>(Class::named("HKQuantity"), "quantityWithUnit:doubleValue:", id(), 1.0),
               NSException);
  // Something that is no unit is refused as an argument, not misread.
  EXPECT_THROW(send<bool>(HKQuantity::quantityWithUnit(units[0], 1),
                          "isCompatibleWithUnit:", string("kcal")),
               NSException);
}

TEST(HKActivitySummary, FractionsOfTheGoals) {
  const double notANumber = std::nan("");
  const std::pair<HKActivitySummary::Ring, double> cases[] = {
      {{250, 500}, 0.5},
      {{500, 500}, 1.0},
      {{685, 500}, 1.37},
      {{0, 500}, 0},
      {{std::nullopt, 500}, -1},
      {{notANumber, 500}, -1},
      {{-4, 500}, -1},
      {{300, 0}, 0},
      {{0, 0}, 0},
      {{300, notANumber}, 0},
      {{std::nullopt, 0}, -1},
  };
  // Each ring in turn holds the case while the others hold something else.
  const struct {
    HKActivitySummary::Ring HKActivitySummary::*member;
    Name selector;
  } rings[] = {
      {&HKActivitySummary::activeEnergy, "_activeEnergyCompletionPercentage"},
      {&HKActivitySummary::exerciseTime, "_exerciseTimeCompletionPercentage"},
      {&HKActivitySummary::standHours, "_standHoursCompletionPercentage"},
  };
  for (const auto& [member, selector] : rings) {
    for (const auto& [ring, fraction] : cases) {
      const Ref<HKActivitySummary> summary = make<HKActivitySummary>();
      for (const auto& other : rings) {
        (*summary).*other.member = {3, 4};
      }
      (*summary).*member = ring;
      EXPECT_DOUBLE_EQ(send<double>(summary, selector), fraction) << selector.text();
    }
  }
}

/// Tests that change the settings put them back.
class HealthKitSettings : public testing::Test {
 protected:
  void TearDown() override {
    settings.timeZone = "UTC";
    settings.calendar.clear();
    settings.wheelchairUse = 0;
    settings.wheelchairUseFails = false;
    settings.wheelchairQueries = 0;
  }
  Settings& settings = Settings::current();
};

std::int64_t cacheIndex(const Ref<NSDate>& date) {
  return _HKCacheIndexFromDateComponents(_HKActivityCacheDateComponentsFromDate(
      date, calendarWithIdentifier(NSCalendarIdentifierGregorian)));
}

TEST_F(HealthKitSettings, CacheIndexGrowsByOneADay) {
  const char* const calendars[] = {"gregorian", "hebrew", "buddhist", "islamic"};
  const char* const timeZones[] = {"UTC", "America/New_York", "Asia/Kathmandu",
                                   "Pacific/Kiritimati"};
  const std::pair<const char*, const char*> followingDays[] = {
      {"1969-12-31", "1970-01-01"}, {"2025-12-31", "2026-01-01"}, {"2024-02-28", "2024-02-29"},
      {"2024-02-29", "2024-03-01"}, {"2026-02-28", "2026-03-01"}, {"2000-02-29", "2000-03-01"},
      {"2100-02-28", "2100-03-01"}, {"2026-03-08", "2026-03-09"}, {"2026-11-01", "2026-11-02"},
  };
  const char* const timesOfDay[] = {"T00:00", "T12:00", "T23:59:59"};
  for (const char* const calendar : calendars) {
    for (const char* const timeZone : timeZones) {
      settings.calendar = calendar;
      settings.timeZone = timeZone;
      for (const auto& [day, next] : followingDays) {
        SCOPED_TRACE(std::string(calendar) + ' ' + timeZone + ' ' + day);
        const std::int64_t index = cacheIndex(dateWithSeconds(*secondsFromIso(day)));
        for (const char* const time : timesOfDay) {
          const std::string within = std::string(day) + time;
          const std::string tomorrow = std::string(next) + time;
          EXPECT_EQ(cacheIndex(dateWithSeconds(*secondsFromIso(within))), index);
          EXPECT_EQ(cacheIndex(dateWithSeconds(*secondsFromIso(tomorrow))), index + 1);
        }
      }
    }
  }
}

TEST_F(HealthKitSettings, CacheIndexBelongsToTheDayOfThePlace) {
  const Ref<NSDate> moment = dateWithSeconds(*secondsFromIso("2026-03-11T23:30Z"));
  const std::int64_t inLondon = cacheIndex(moment);
  EXPECT_EQ(inLondon, daysFromCivil(2026, 3, 11));
  settings.timeZone = "Asia/Tokyo";
  EXPECT_EQ(cacheIndex(moment), inLondon + 1);
  const Ref<NSCalendar> utc =
      as<NSCalendar>(send<id>(Class::named("NSCalendar"), "hk_gregorianCalendarWithUTCTimeZone"));
  ASSERT_TRUE(utc);
  EXPECT_EQ(_HKCacheIndexFromDateComponents(_HKActivityCacheDateComponentsFromDate(moment, utc)),
            inLondon);
}

TEST(HKActivityCache, IndexOfYearsBeforeYearOne) {
  // 0001-01-01 and the day before it, which is in era 0.
  Ref<NSDateComponents> before = make<NSDateComponents>();
  before->era = 0;
  before->year = 1;
  before->month = 12;
  before->day = 31;
  Ref<NSDateComponents> first = make<NSDateComponents>();
  first->era = 1;
  first->year = 1;
  first->month = 1;
  first->day = 1;
  EXPECT_EQ(_HKCacheIndexFromDateComponents(before) + 1, _HKCacheIndexFromDateComponents(first));
  EXPECT_EQ(_HKCacheIndexFromDateComponents(first), -719162);
}

TEST(HKActivityCache, NothingHasNoIndex) {
  const Ref<NSCalendar> calendar = calendarWithIdentifier(NSCalendarIdentifierGregorian);
  EXPECT_FALSE(_HKActivityCacheDateComponentsFromDate(nullptr, calendar));
  EXPECT_FALSE(_HKActivityCacheDateComponentsFromDate(dateWithSeconds(0), nullptr));
  EXPECT_EQ(_HKCacheIndexFromDateComponents(nullptr), kNoCacheIndex);
}

TEST_F(HealthKitSettings, WheelchairQueryAnswersOrReports) {
  const id store = make<HKHealthStore>();
  for (const std::int64_t use : {0, 1, 2}) {
    settings.wheelchairUse = use;
    id error;
    const id answer = send<id>(store, "wheelchairUseWithError:", &error);
    EXPECT_TRUE(isKindOf(answer.get(), Class::named("HKWheelchairUseObject")));
    EXPECT_EQ(send<std::int64_t>(answer, "wheelchairUse"), use);
    EXPECT_FALSE(error);
  }
  settings.wheelchairUseFails = true;
  id error;
  EXPECT_FALSE(send<id>(store, "wheelchairUseWithError:", &error));
  EXPECT_TRUE(as<NSError>(error));
  EXPECT_FALSE(send<id>(store, "wheelchairUseWithError:", static_cast<id*>(nullptr)));
  EXPECT_EQ(settings.wheelchairQueries, 5);
}

}  // namespace
}  // namespace tavro
