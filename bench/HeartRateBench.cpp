#include <benchmark/benchmark.h>

#include <map>
#include <string>

#include "bench/Ratios.h"
#include "host/screens/workouts/HeartRateChart.h"
#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSValue.h"

namespace tavro::bench {
namespace {

constexpr double kDuration = 4 * 3600;
constexpr std::uint64_t kSlice = 3;
constexpr double kSlices = 8;

/// A chart of that many readings, spread evenly over a workout of four hours.
const Ref<CHWorkoutDetailHeartRateChartView>& chartOf(std::size_t readings) {
  static std::map<std::size_t, Ref<CHWorkoutDetailHeartRateChartView>> charts;
  Ref<CHWorkoutDetailHeartRateChartView>& chart = charts[readings];
  if (!chart) {
    Workout workout;
    workout.start.iso = "2026-03-11T07:00";
    workout.duration = kDuration;
    for (std::size_t index = 0; index < readings; ++index) {
      const double part = static_cast<double>(index) / static_cast<double>(readings);
      workout.heartRate.push_back({part * kDuration, 90 + static_cast<double>(index % 70)});
    }
    chart = makeView<CHWorkoutDetailHeartRateChartView>({0, 0, 390, 180});
    chart->setWorkout(workout);
  }
  return chart;
}

void readSlice(benchmark::State& state, std::size_t readings) {
  const auto& chart = chartOf(readings);
  setItems(state, readings);
  for (auto _ : state) {
    if (!send<id>(chart, "_accessibilityQuantityForSliceAtIndex:", kSlice)) {
      state.SkipWithError("the slice has no range");
      break;
    }
  }
}

/// One pass that reads of every reading what the slice reads of it.
void passReadings(benchmark::State& state, std::size_t readings) {
  const auto& chart = chartOf(readings);
  const double start = as<NSDateInterval>(chart->dateInterval())->startDate->seconds;
  const double from = start + kDuration * kSlice / kSlices;
  const double to = from + kDuration / kSlices;
  setItems(state, readings);
  for (auto _ : state) {
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
    benchmark::DoNotOptimize(sum);
  }
}

}  // namespace

void registerHeartRateBenchmarks() {
  for (const std::size_t readings : {10'000U, 200'000U}) {
    const std::string count = std::to_string(readings);
    benchmark::RegisterBenchmark(("slice:" + count).c_str(), [readings](benchmark::State& state) {
      readSlice(state, readings);
    });
    benchmark::RegisterBenchmark(("pass:" + count).c_str(), [readings](benchmark::State& state) {
      passReadings(state, readings);
    });
  }
}

}  // namespace tavro::bench
