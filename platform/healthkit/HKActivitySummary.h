#pragma once

#include <limits>
#include <optional>

#include "platform/foundation/NSDate.h"

namespace tavro {

/// One day's three rings.
///
/// Messages, each "d", a fraction where 1.0 is the goal: `_activeEnergyCompletionPercentage`,
/// `_exerciseTimeCompletionPercentage`, `_standHoursCompletionPercentage`. A fraction is negative
/// when there is no data, is not capped at 1.0, and is 0 where there is no goal.
class HKActivitySummary : public NSObject {
 public:
  static constexpr Name className = "HKActivitySummary";

  /// What was reached and what was to be reached, in one unit; no amount means no data.
  struct Ring {
    std::optional<double> amount;
    double goal = 0;

    [[nodiscard]] double completion() const;
  };

  Ring activeEnergy;  ///< kilocalories
  Ring exerciseTime;  ///< minutes
  Ring standHours;    ///< hours

  [[nodiscard]] double activeEnergyCompletionPercentage() const;
  [[nodiscard]] double exerciseTimeCompletionPercentage() const;
  [[nodiscard]] double standHoursCompletionPercentage() const;
};

/// The index that no day has.
inline constexpr std::int64_t kNoCacheIndex = std::numeric_limits<std::int64_t>::min();

/// The day that the calendar sees in a moment, for `_HKCacheIndexFromDateComponents`. Give it a
/// Gregorian calendar: its time zone decides where a day begins. nil for a nil date or calendar.
Ref<NSDateComponents> _HKActivityCacheDateComponentsFromDate(const Ref<NSDate>& date,
                                                             const Ref<NSCalendar>& calendar);
/// The index of a Gregorian day in the activity summary cache: days since 1970-01-01, so that
/// consecutive days differ by 1. `kNoCacheIndex` for nil.
std::int64_t _HKCacheIndexFromDateComponents(const Ref<NSDateComponents>& components);

/// The first day of weekly goals: 1 is Sunday ... 7 is Saturday.
std::int64_t HKFirstDayOfWeekForWeeklyGoalCalculations();

}  // namespace tavro
