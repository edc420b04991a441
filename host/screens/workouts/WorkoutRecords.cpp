#include "host/screens/workouts/WorkoutRecords.h"

#include <algorithm>
#include <utility>

#include "platform/foundation/NSDate.h"

namespace tavro {
namespace {

double startOf(const Workout& workout) { return secondsFromIso(workout.start.iso).value_or(0); }

}  // namespace

std::vector<const Workout*> latestWorkouts(const Diary& diary, std::size_t most) {
  struct Started {
    std::pair<bool, double> rank;  // imported first, then by the moment of its start
    const Workout* workout;
  };
  const double now = dateNow()->seconds;
  std::vector<Started> started;
  for (const Workout& workout : diary.workouts) {
    const double seconds = startOf(workout);
    if (workout.isImported || seconds <= now) {
      started.push_back({{workout.isImported, seconds}, &workout});
    }
  }
  std::ranges::stable_sort(started, std::ranges::greater(), &Started::rank);
  started.resize(std::min(most, started.size()));
  std::vector<const Workout*> workouts;
  std::ranges::transform(started, std::back_inserter(workouts), &Started::workout);
  return workouts;
}

Ref<HKWorkout> workoutRecord(const Workout& workout) {
  const auto source = make<HKSource>();
  source->sourceName = string(workout.source.name);
  source->isWatch = workout.source.isWatch;
  const auto revision = make<HKSourceRevision>();
  revision->recorder = source;
  auto made = make<HKWorkout>();
  const double start = startOf(workout);
  made->record = {
      .activityType = workout.type,
      .startDate = dateWithSeconds(start),
      .endDate = dateWithSeconds(start + workout.duration),
      .duration = workout.duration,
      .totalEnergyBurned = HKQuantity::quantityWithUnit(HKUnit::kilocalorieUnit(), workout.energy),
      .totalDistance = workout.distance
                           ? HKQuantity::quantityWithUnit(HKUnit::meterUnit(), *workout.distance)
                           : nullptr,
      .sourceRevision = revision,
  };
  return made;
}

std::string_view activityName(HKWorkoutActivityType type) {
  switch (type) {
    case HKWorkoutActivityType::cycling:
      return "Outdoor Cycle";
    case HKWorkoutActivityType::hiking:
      return "Hiking";
    case HKWorkoutActivityType::running:
      return "Outdoor Run";
    case HKWorkoutActivityType::swimming:
      return "Pool Swim";
    case HKWorkoutActivityType::walking:
      return "Outdoor Walk";
    case HKWorkoutActivityType::yoga:
      return "Yoga";
    case HKWorkoutActivityType::other:
      break;
  }
  return "Workout";
}

}  // namespace tavro
