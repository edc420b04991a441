#include <memory>

#include "bench/Bench.h"
#include "bench/IcuTexts.h"
#include "host/libraries/ActivitySummaryCache.h"
#include "host/screens/calendar/MonthScrollViewController.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"
#include "reader/Model.h"

namespace tavro::bench {
namespace {

constexpr std::int64_t kLastYear = 2025;
constexpr std::int64_t kMostYears = 100;

// The fractions are never exactly 1, which would be said without a per cent.
constexpr double kMoveGoal = 9.5;
constexpr double kExerciseGoal = 5.5;
constexpr double kStandGoal = 12.5;
/// From 0 to `limit`, without it, before 1970 too.
double cycle(std::int64_t day, std::int64_t limit) {
  return static_cast<double>(((day % limit) + limit) % limit);
}
double moveOf(std::int64_t day) { return cycle(day, 9); }
double exerciseOf(std::int64_t day) { return cycle(day, 5); }
double standOf(std::int64_t day) { return cycle(day, 13); }

std::int64_t firstDayOf(std::int64_t years) { return daysFromCivil(kLastYear - years + 1, 1, 1); }
std::int64_t lastDay() { return daysFromCivil(kLastYear, 12, 31); }
std::size_t daysOf(std::int64_t years) {
  return static_cast<std::size_t>(lastDay() - firstDayOf(years)) + 1;
}

/// Every day that a calendar here may show has rings; the same ones whatever is measured.
void recordRings() {
  const auto cache = ActivitySummaryCache::sharedInstance();
  for (std::int64_t day = firstDayOf(kMostYears); day <= lastDay(); ++day) {
    const auto summary = make<HKActivitySummary>();
    summary->activeEnergy = {moveOf(day), kMoveGoal};
    summary->exerciseTime = {exerciseOf(day), kExerciseGoal};
    summary->standHours = {standOf(day), kStandGoal};
    cache->setSummary(day, summary);
  }
}

/// The last years up to the last one, all of them on screen.
Ref<MonthScrollView> calendarOf(std::int64_t years) {
  static const bool recorded = (recordRings(), true);
  require(recorded, "rings must be recorded");
  CalendarSpan span{{firstDayOf(years)}, {lastDay()}, {lastDay()}, {}};
  const auto months = makeView<MonthScrollView>();
  months->setSpan(span);
  months->setFrame({0, 0, 390, months->contentHeight()});
  months->layoutIfNeeded();
  return months;
}

std::vector<id> daysIn(const Ref<MonthScrollView>& months) {
  std::vector<id> days;
  for (const AccessibleElement& each : accessibleElements(months)) {
    if (as<MonthDayCellLayer>(each.element)) {
      days.push_back(each.element);
    }
  }
  return days;
}

void readDays(const std::vector<id>& days, std::size_t expected) {
  std::size_t whole = 0;
  for (const id& day : days) {
    const id label = send<id>(day, "accessibilityLabel");
    const id value = send<id>(day, "accessibilityValue");
    const bool hasFrame = send<CGRect>(day, "accessibilityFrame").size.width > 0;
    whole += label && value && hasFrame ? 1 : 0;
  }
  require(whole == expected, "every day of a calendar must be read");
}

/// The label, the value and the frame of days that were found before.
std::function<void()> readYear() {
  const auto months = calendarOf(1);
  return [months, days = daysIn(months)] { readDays(days, daysOf(1)); };
}

/// The dates and the percentages of the same days.
std::function<void()> formatYear() {
  return [icu = std::make_shared<IcuTexts>()] {
    for (std::int64_t day = firstDayOf(1); day <= lastDay(); ++day) {
      icu->date(u"dMMMM", (static_cast<double>(day) + 0.7) * kSecondsPerDay);
      icu->percent(static_cast<float>(moveOf(day) / kMoveGoal));
      icu->percent(static_cast<float>(exerciseOf(day) / kExerciseGoal));
      icu->percent(static_cast<float>(standOf(day) / kStandGoal));
    }
  };
}

/// A zone without history: ICU looks through a zone's changes from the latest on, so that days of
/// long ago cost more, whatever the length of the calendar.
void useZoneWithoutHistory() { Settings::current().timeZone = "UTC"; }

Work buildingYears(std::int64_t years) {
  return {"calendar:" + std::to_string(years),
          [years] {
            useZoneWithoutHistory();
            calendarOf(1);
            return [years] {
              const auto months = calendarOf(years);
              readDays(daysIn(months), daysOf(years));
            };
          },
          static_cast<double>(daysOf(years)), false};
}

/// A reader's whole reading of a screen that it has read before.
Work readingYearsAgain(std::int64_t years) {
  return {"again:" + std::to_string(years),
          [years] {
            useZoneWithoutHistory();
            const auto months = calendarOf(years);
            const std::size_t elements = readElements(months).size();
            return [months, elements] {
              require(readElements(months).size() == elements, "a reading must find all elements");
            };
          },
          static_cast<double>(daysOf(years)), false};
}

}  // namespace

void addCalendarWork(std::vector<Work>& all) {
  all.push_back({"days", &readYear, static_cast<double>(daysOf(1))});
  all.push_back({"icu:days", &formatYear, static_cast<double>(daysOf(1))});
  for (const std::int64_t years : {1, 10, 100}) {
    all.push_back(buildingYears(years));
  }
  for (const std::int64_t years : {1, 10}) {
    all.push_back(readingYearsAgain(years));
  }
}

}  // namespace tavro::bench
