#include "bench/Bench.h"
#include "host/screens/workouts/HeartRateChart.h"
#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSValue.h"

namespace tavro::bench {
namespace {

constexpr std::size_t kReadings = 200'000;
constexpr double kDuration = 4 * 3600;
constexpr std::uint64_t kSlice = 3;
constexpr double kSlices = 8;

/// A chart of readings that are spread evenly over a workout of four hours.
const Ref<CHWorkoutDetailHeartRateChartView>& chart() {
  static const auto* const shared = [] {
    Workout workout;
    workout.start.iso = "2026-03-11T07:00";
    workout.duration = kDuration;
    for (std::size_t index = 0; index < kReadings; ++index) {
      const double part = static_cast<double>(index) / static_cast<double>(kReadings);
      workout.heartRate.push_back({part * kDuration, 90 + static_cast<double>(index % 70)});
    }
    auto* const made = new auto(makeView<CHWorkoutDetailHeartRateChartView>({0, 0, 390, 180}));
    (*made)->setWorkout(workout);
    return made;
  }();
  return *shared;
}

std::function<void()> readSlice() {
  return [chart = chart()] {
    require(send<id>(chart, "_accessibilityQuantityForSliceAtIndex:", kSlice).get() != nullptr,
            "a slice must have a range");
  };
}

/// One pass that reads of every reading what the slice reads of it.
std::function<void()> passReadings() {
  const double start = as<NSDateInterval>(chart()->dateInterval())->startDate->seconds;
  const double from = start + kDuration * kSlice / kSlices;
  const double to = from + kDuration / kSlices;
  return [chart = chart(), from, to] {
    double sum = 0;
    Class* const readingClass = AXSafeClassFromString("HKHeartRateSummaryReading");
    for (const id& reading : *chart->_heartRateReadings) {
      if (!isKindOf(reading.get(), readingClass)) {
        continue;
      }
      const auto date = as<NSDate>(trySend<id>(reading, "date"));
      if (date && date->seconds >= from && date->seconds <= to) {
        sum += typedRead<NSNumber>(trySend<id>(reading, "quantity"), "ch_beatsPerMinute")
                   ->doubleValue();
      }
    }
    require(sum > 0, "a pass must meet readings");
  };
}

}  // namespace

void addHeartRateWork(std::vector<Work>& all) {
  all.push_back({"heart rate", &readSlice, kReadings});
  all.push_back({"pass", &passReadings, kReadings});
}

}  // namespace tavro::bench
