#include <benchmark/benchmark.h>

#include <cstdio>
#include <map>
#include <string>

#include "bench/Ratios.h"
#include "host/libraries/ActivitySummaryCache.h"
#include "host/screens/calendar/MonthScrollViewController.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Traversal.h"

namespace tavro::bench {
namespace {

constexpr std::int64_t kLastYear = 2025;
constexpr std::int64_t kMostYears = 40;

/// Every day that a calendar here may show has rings; the same ones whatever is measured.
void recordRings() {
  const auto cache = ActivitySummaryCache::sharedInstance();
  const std::int64_t first = daysFromCivil(kLastYear - kMostYears, 1, 1);
  for (std::int64_t day = first; day <= daysFromCivil(kLastYear, 12, 31); ++day) {
    const auto summary = make<HKActivitySummary>();
    summary->activeEnergy = {static_cast<double>(day % 9), 8};
    summary->exerciseTime = {static_cast<double>(day % 5), 4};
    summary->standHours = {static_cast<double>(day % 13), 12};
    cache->setSummary(day, summary);
  }
}

struct Calendar {
  Ref<MonthScrollView> months;
  std::size_t days = 0;
};

/// A calendar of the days from `first` to the end of the last year, all of them on screen.
Calendar calendarFrom(std::int64_t first) {
  const std::int64_t last = daysFromCivil(kLastYear, 12, 31);
  CalendarSpan span{{first}, {last}, {last}, {}};
  for (std::int64_t day = first; day <= last; day += 3) {
    span.workoutDays.push_back({day});
  }
  Calendar calendar{makeView<MonthScrollView>(), static_cast<std::size_t>(last - first) + 1};
  calendar.months->setSpan(span);
  calendar.months->setFrame({0, 0, 390, calendar.months->contentHeight()});
  calendar.months->layoutIfNeeded();
  return calendar;
}

Calendar calendarOf(std::int64_t years) {
  return calendarFrom(daysFromCivil(kLastYear - years + 1, 1, 1));
}

/// Reads every day: its label, its value and its frame. How many days that were.
std::size_t readDays(const Calendar& calendar) {
  std::size_t days = 0;
  for (const AccessibleElement& each : accessibleElements(calendar.months)) {
    if (as<MonthDayCellLayer>(each.element)) {
      ++days;
      benchmark::DoNotOptimize(send<id>(each.element, "accessibilityLabel"));
      benchmark::DoNotOptimize(send<id>(each.element, "accessibilityValue"));
      benchmark::DoNotOptimize(send<CGRect>(each.element, "accessibilityFrame"));
    }
  }
  return days;
}

void readCalendar(benchmark::State& state, std::int64_t years) {
  static std::map<std::int64_t, Calendar> calendars;
  if (calendars.empty()) {
    recordRings();
  }
  if (!calendars.contains(years)) {
    calendars[years] = calendarOf(years);
  }
  const Calendar& calendar = calendars.at(years);
  setItems(state, calendar.days);
  for (auto _ : state) {
    if (readDays(calendar) != calendar.days) {
      state.SkipWithError("days are missing from the calendar");
      break;
    }
  }
}

}  // namespace

void registerCalendarBenchmarks() {
  for (const std::int64_t years : {1, 10}) {
    benchmark::RegisterBenchmark(("calendar:" + std::to_string(years)).c_str(),
                                 [years](benchmark::State& state) { readCalendar(state, years); });
  }
}

int countCalendar(std::int64_t years) {
  if (years < 0 || years > kMostYears) {
    std::fprintf(stderr, "tavro_bench: a calendar has 0 to %d years\n",
                 static_cast<int>(kMostYears));
    return 2;
  }
  recordRings();
  // What is made once a process belongs to every run, so that subtracting a run of no years leaves
  // the days alone.
  readDays(calendarFrom(daysFromCivil(kLastYear, 12, 1)));
  std::size_t days = 0;
  if (years > 0) {
    const Calendar calendar = calendarOf(years);
    days = readDays(calendar);
    if (days != calendar.days) {
      std::fprintf(stderr, "tavro_bench: days are missing from the calendar\n");
      return 1;
    }
  }
  std::printf("%zu\n", days);
  return 0;
}

}  // namespace tavro::bench
