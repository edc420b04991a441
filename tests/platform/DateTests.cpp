#include <cmath>
#include <limits>
#include <tuple>

#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using testing::at;
using testing::FoundationTest;
using testing::utc;

class DateTest : public FoundationTest {};

constexpr double kDay = 86400;

TEST_F(DateTest, NowIsTheSettingsMoment) {
  settings_.now = 1234.5;
  EXPECT_EQ(dateNow()->seconds, 1234.5);
  EXPECT_EQ(dateByAddingTimeInterval(dateNow(), -34.5)->seconds, 1200);
  EXPECT_FALSE(dateByAddingTimeInterval(nullptr, 1));
}

TEST_F(DateTest, MomentsAreReadInExactlyThreeForms) {
  const std::pair<std::string_view, std::string_view> cases[] = {
      {"2026-03-02", "2026-03-02 05:00:00 +0000"},
      {"2026-03-02T08:15", "2026-03-02 13:15:00 +0000"},
      {"2026-07-02T08:15:30", "2026-07-02 12:15:30 +0000"},
      {"2026-03-02T08:15Z", "2026-03-02 08:15:00 +0000"},
      {"2024-02-29Z", "2024-02-29 00:00:00 +0000"},
      {"2000-02-29T23:59:59Z", "2000-02-29 23:59:59 +0000"},
      {"1969-12-31T23:59:59Z", "1969-12-31 23:59:59 +0000"},
      {"0001-01-01Z", "0001-01-01 00:00:00 +0000"},
      // Proleptic: these days fell out of the Julian reckoning.
      {"1582-10-10T00:00Z", "1582-10-10 00:00:00 +0000"},
      // The clocks skip 02:30, and show 01:30 twice.
      {"2026-03-08T02:30", "2026-03-08 07:00:00 +0000"},
      {"2026-11-01T01:30", "2026-11-01 05:30:00 +0000"},
  };
  for (const auto& [text, expected] : cases) {
    EXPECT_EQ(utc(at(text)), expected) << text;
  }
  for (const char* const text : {"",
                                 "Z",
                                 "2026-3-2",
                                 "2026-02-29",
                                 "1900-02-29",
                                 "2026-13-01",
                                 "2026-00-01",
                                 "2026-04-31",
                                 "2026-01-00",
                                 "2026-03-02T24:00",
                                 "2026-03-02T08:60",
                                 "2026-03-02T08:15:60",
                                 "2026-03-02 08:15",
                                 "2026-03-02T08",
                                 "2026-03-02ZZ",
                                 "2026-03-02z",
                                 " 026-03-02",
                                 "+026-03-02",
                                 "2026-03-dd",
                                 "9999-12-31Td3:59:59Z",
                                 "2026-03-02T08:15+01"}) {
    EXPECT_FALSE(secondsFromIso(text)) << text;
  }
}

TEST_F(DateTest, CivilDaysCountThroughLeapYears) {
  EXPECT_EQ(daysFromCivil(1970, 1, 1), 0);
  EXPECT_EQ(daysFromCivil(1969, 12, 31), -1);
  EXPECT_EQ(daysFromCivil(2000, 3, 1), 11017);
  EXPECT_EQ(daysFromCivil(0, 3, 1), -719468);
  EXPECT_EQ(daysFromCivil(-400, 3, 1), -719468 - 146097);
}

TEST_F(DateTest, IntervalsHoldBothEnds) {
  const Ref<NSDate> start = dateWithSeconds(100);
  const Ref<NSDate> end = dateWithSeconds(160);
  const Ref<NSDateInterval> interval = dateInterval(start, end);
  EXPECT_EQ(send<double>(interval, "duration"), 60);
  EXPECT_EQ(send<id>(interval, "startDate"), start);
  EXPECT_EQ(send<id>(interval, "endDate"), end);
  EXPECT_TRUE(interval->containsDate(start));
  EXPECT_TRUE(interval->containsDate(end));
  EXPECT_FALSE(interval->containsDate(dateWithSeconds(99.9)));
  EXPECT_FALSE(interval->containsDate(dateWithSeconds(160.1)));
  EXPECT_FALSE(interval->containsDate(nullptr));
  EXPECT_EQ(dateInterval(start, start)->duration(), 0);
}

TEST_F(DateTest, IntervalsNeedTheirEndsInOrder) {
  const Ref<NSDate> date = dateWithSeconds(100);
  EXPECT_THROW(dateInterval(date, dateWithSeconds(99)), NSException);
  EXPECT_THROW(dateInterval(nullptr, date), NSException);
  EXPECT_THROW(dateInterval(date, nullptr), NSException);
  EXPECT_THROW(dateInterval(date, dateWithSeconds(std::nan(""))), NSException);
}

TEST_F(DateTest, ComponentsAreThoseOfTheUsersZoneAndCalendar) {
  const Ref<NSDate> date = at("2026-03-01T23:04:05");
  const struct {
    std::string timeZone;
    std::string calendar;
    std::int64_t year, month, day, hour, weekday;
  } cases[] = {
      {"America/New_York", "", 2026, 3, 1, 23, 1},    {"Asia/Tokyo", "", 2026, 3, 2, 13, 2},
      {"UTC", "hebrew", 5786, 7, 13, 4, 2},           {"UTC", "buddhist", 2569, 3, 2, 4, 2},
      {"UTC", "islamic-umalqura", 1447, 9, 13, 4, 2},
  };
  for (const auto& each : cases) {
    SCOPED_TRACE(each.timeZone + each.calendar);
    settings_.timeZone = each.timeZone;
    settings_.calendar = each.calendar;
    const id parts = currentCalendar()->componentsFromDate(date);
    EXPECT_EQ(send<std::int64_t>(parts, "year"), each.year);
    EXPECT_EQ(send<std::int64_t>(parts, "month"), each.month);
    EXPECT_EQ(send<std::int64_t>(parts, "day"), each.day);
    EXPECT_EQ(send<std::int64_t>(parts, "hour"), each.hour);
    EXPECT_EQ(send<std::int64_t>(parts, "minute"), 4);
    EXPECT_EQ(send<std::int64_t>(parts, "second"), 5);
    EXPECT_EQ(send<std::int64_t>(parts, "weekday"), each.weekday);
    const Ref<NSDateComponents> components = as<NSDateComponents>(parts);
    EXPECT_EQ(currentCalendar()->dateFromComponents(*components)->seconds, date->seconds);
  }
}

TEST_F(DateTest, TheGregorianCalendarIgnoresTheUsersCalendar) {
  settings_.calendar = "hebrew";
  const Ref<NSCalendar> calendar = calendarWithIdentifier(NSCalendarIdentifierGregorian);
  ASSERT_TRUE(calendar);
  EXPECT_EQ(calendar->componentsFromDate(at("2026-03-02"))->year, 2026);
  calendar->timeZone = "Asia/Tokyo";
  EXPECT_EQ(calendar->componentsFromDate(at("2026-03-02T12:00"))->day, 3);
  EXPECT_FALSE(calendarWithIdentifier("no-such-calendar"));
  EXPECT_FALSE(calendarWithIdentifier(""));
}

TEST_F(DateTest, PartsOutOfRangeCarryOver) {
  const Ref<NSCalendar> calendar = currentCalendar();
  const Ref<NSDateComponents> parts = calendar->componentsFromDate(at("2026-12-31T23:59:59"));
  parts->second = 60;
  EXPECT_EQ(utc(calendar->dateFromComponents(*parts)), "2027-01-01 05:00:00 +0000");
  parts->second = 0;
  parts->month = 14;
  parts->day = 0;
  EXPECT_EQ(utc(calendar->dateFromComponents(*parts)), "2027-02-01 04:59:00 +0000");
}

// Asked of every day of a year in zones that change their clocks at, before and after midnight.
TEST_F(DateTest, ADayBeginsWithItsFirstMoment) {
  for (const char* const zone :
       {"America/New_York", "America/Sao_Paulo", "America/Havana", "Asia/Beirut", "Atlantic/Azores",
        "Australia/Lord_Howe", "Pacific/Apia"}) {
    settings_.timeZone = zone;
    const Ref<NSCalendar> calendar = currentCalendar();
    const double first = *secondsFromIso("2018-01-01T12:00");
    for (int day = 0; day < 366; ++day) {
      SCOPED_TRACE(zone + std::to_string(day));
      const Ref<NSDate> noon = dateWithSeconds(first + day * kDay);
      const Ref<NSDate> start = calendar->startOfDayForDate(noon);
      const std::int64_t today = calendar->componentsFromDate(noon)->day;
      ASSERT_LE(start->seconds, noon->seconds);
      ASSERT_EQ(calendar->componentsFromDate(start)->day, today);
      const Ref<NSDate> before = dateWithSeconds(start->seconds - 1);
      ASSERT_NE(calendar->componentsFromDate(before)->day, today);
      ASSERT_EQ(calendar->startOfDayForDate(start)->seconds, start->seconds);
    }
  }
}

TEST_F(DateTest, AddedDaysKeepTheTimeOfDay) {
  const std::tuple<std::string_view, std::int64_t, std::string_view> cases[] = {
      {"2026-03-07T08:00", 1, "2026-03-08T08:00"},  // a day of 23 hours
      {"2026-10-31T08:00", 2, "2026-11-02T08:00"},  // a day of 25 hours
      {"2026-03-09T08:00", -2, "2026-03-07T08:00"}, {"2024-02-28T00:00", 366, "2025-02-28T00:00"},
      {"2026-03-07T02:30", 1, "2026-03-08T03:00"},  // 02:30 is skipped
  };
  for (const auto& [from, days, to] : cases) {
    EXPECT_EQ(utc(currentCalendar()->dateByAddingDays(at(from), days)), utc(at(to))) << from;
  }
  EXPECT_FALSE(currentCalendar()->dateByAddingDays(nullptr, 1));
  EXPECT_FALSE(currentCalendar()->componentsFromDate(nullptr));
  EXPECT_FALSE(currentCalendar()->startOfDayForDate(nullptr));
}

TEST_F(DateTest, AbsurdMomentsAndPartsAreHarmless) {
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  constexpr auto kMost = std::numeric_limits<std::int64_t>::max();
  constexpr auto kLeast = std::numeric_limits<std::int64_t>::min();
  for (const char* const calendar : {"", "hebrew", "islamic", "chinese", "japanese", "persian"}) {
    settings_.calendar = calendar;
    const Ref<NSCalendar> user = currentCalendar();
    for (const double seconds : {std::nan(""), kInfinity, -kInfinity, 1e300, -1e300, 1e13}) {
      const Ref<NSDate> date = dateWithSeconds(seconds);
      const Ref<NSDateComponents> parts = user->componentsFromDate(date);
      EXPECT_TRUE(parts->weekday >= 1 && parts->weekday <= 7) << calendar << seconds;
      EXPECT_TRUE(std::isfinite(user->startOfDayForDate(date)->seconds));
      for (const std::int64_t most : {kMost, kLeast}) {
        EXPECT_TRUE(std::isfinite(user->dateByAddingDays(date, most)->seconds));
        parts->year = parts->day = parts->second = most;
        EXPECT_TRUE(std::isfinite(user->dateFromComponents(*parts)->seconds));
      }
    }
  }
}

}  // namespace
}  // namespace tavro
