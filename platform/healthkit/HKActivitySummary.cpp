#include "platform/healthkit/HKActivitySummary.h"

#include <cmath>

#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

constexpr double kNoData = -1;

Ref<NSCalendar> gregorianCalendarWithUTCTimeZone(Class* /*isa*/) {
  Ref<NSCalendar> calendar = calendarWithIdentifier(NSCalendarIdentifierGregorian);
  calendar->timeZone = "UTC";
  return calendar;
}

const Registered kSummary = defineClass<HKActivitySummary, NSObject>()
                                .method<&HKActivitySummary::activeEnergyCompletionPercentage>(
                                    "_activeEnergyCompletionPercentage")
                                .method<&HKActivitySummary::exerciseTimeCompletionPercentage>(
                                    "_exerciseTimeCompletionPercentage")
                                .method<&HKActivitySummary::standHoursCompletionPercentage>(
                                    "_standHoursCompletionPercentage");

const Registered kCalendarAdditions =
    extendClass(NSCalendar::className)
        .classMethod<&gregorianCalendarWithUTCTimeZone>("hk_gregorianCalendarWithUTCTimeZone");

}  // namespace

double HKActivitySummary::Ring::completion() const {
  if (!amount || !std::isfinite(*amount) || *amount < 0) {
    return kNoData;
  }
  return goal > 0 ? *amount / goal : 0;
}

double HKActivitySummary::activeEnergyCompletionPercentage() const {
  return activeEnergy.completion();
}
double HKActivitySummary::exerciseTimeCompletionPercentage() const {
  return exerciseTime.completion();
}
double HKActivitySummary::standHoursCompletionPercentage() const { return standHours.completion(); }

Ref<NSDateComponents> _HKActivityCacheDateComponentsFromDate(const Ref<NSDate>& date,
                                                             const Ref<NSCalendar>& calendar) {
  return calendar ? calendar->componentsFromDate(date) : nullptr;
}

std::int64_t _HKCacheIndexFromDateComponents(const Ref<NSDateComponents>& components) {
  if (!components) {
    return kNoCacheIndex;
  }
  // Era 0 counts its years backwards from 1, which is the year before year 1 of era 1.
  const std::int64_t year = components->era == 0 ? 1 - components->year : components->year;
  return daysFromCivil(year, components->month, components->day);
}

std::int64_t HKFirstDayOfWeekForWeeklyGoalCalculations() {
  return Settings::current().firstWeekday;
}

}  // namespace tavro
