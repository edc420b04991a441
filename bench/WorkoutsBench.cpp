#include <memory>

#include "bench/Bench.h"
#include "host/screens/workouts/WorkoutRecords.h"
#include "host/screens/workouts/WorkoutsListCells.h"

namespace tavro::bench {
namespace {

constexpr std::size_t kDaysOfDates = 28;

/// That many rows, which all stay alive, each with a workout that another application recorded.
std::function<void()> configureRows(std::size_t count) {
  const auto rows = std::make_shared<std::vector<Ref<CHWorkoutsListTableViewCell>>>();
  while (rows->size() < count) {
    Workout workout;
    workout.type = HKWorkoutActivityType::running;
    workout.start.iso =
        "2026-02-" + std::to_string(101 + rows->size() % kDaysOfDates).substr(1) + "T07:10";
    workout.duration = 1800;
    workout.energy = 300;
    workout.distance = 5000 + static_cast<double>(rows->size() % 100);
    workout.source = {"Pedal Notes", false};
    rows->push_back(
        makeView<CHWorkoutsListTableViewCell>({0, 0, 390, CHWorkoutsListTableViewCell::height}));
    rows->back()->setWorkout(workoutRecord(workout));
  }
  return [rows] {
    for (const Ref<CHWorkoutsListTableViewCell>& row : *rows) {
      send<void>(row, "configureWithCurrentWorkout");
      require(send<id>(row, "accessibilityLabel").get() != nullptr, "a row must have a label");
    }
  };
}

}  // namespace

void addWorkoutsWork(std::vector<Work>& all) {
  for (const std::size_t count : {100U, 100'000U}) {
    all.push_back({"rows:" + std::to_string(count), [count] { return configureRows(count); },
                   static_cast<double>(count), false});
  }
}

}  // namespace tavro::bench
