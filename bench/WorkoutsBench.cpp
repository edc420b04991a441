#include <benchmark/benchmark.h>

#include <map>
#include <string>
#include <vector>

#include "bench/Ratios.h"
#include "host/screens/workouts/WorkoutRecords.h"
#include "host/screens/workouts/WorkoutsListCells.h"

namespace tavro::bench {
namespace {

using Rows = std::vector<Ref<CHWorkoutsListTableViewCell>>;

constexpr std::size_t kDaysOfDates = 28;

/// That many rows, which all stay alive, each with a workout that another application recorded.
const Rows& rowsOf(std::size_t count) {
  static std::map<std::size_t, Rows> made;
  Rows& rows = made[count];
  while (rows.size() < count) {
    Workout workout;
    workout.type = HKWorkoutActivityType::running;
    workout.start.iso =
        "2026-02-" + std::to_string(101 + rows.size() % kDaysOfDates).substr(1) + "T07:10";
    workout.duration = 1800;
    workout.energy = 300;
    workout.distance = 5000 + static_cast<double>(rows.size() % 1000);
    workout.source = {"Pedal Notes", false};
    rows.push_back(
        makeView<CHWorkoutsListTableViewCell>({0, 0, 390, CHWorkoutsListTableViewCell::height}));
    rows.back()->setWorkout(workoutRecord(workout));
  }
  return rows;
}

void configureRows(benchmark::State& state, std::size_t count) {
  const Rows& rows = rowsOf(count);
  setItems(state, count);
  for (auto _ : state) {
    for (const Ref<CHWorkoutsListTableViewCell>& row : rows) {
      send<void>(row, "configureWithCurrentWorkout");
      benchmark::DoNotOptimize(send<id>(row, "accessibilityLabel"));
    }
  }
}

}  // namespace

void registerWorkoutsBenchmarks() {
  for (const std::size_t count : {100U, 100'000U}) {
    benchmark::RegisterBenchmark(("workouts:" + std::to_string(count)).c_str(),
                                 [count](benchmark::State& state) { configureRows(state, count); });
  }
}

}  // namespace tavro::bench
