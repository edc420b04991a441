#pragma once

#include "host/Diary.h"
#include "platform/healthkit/HKWorkout.h"

namespace tavro {

/// The workouts that had begun by the settings' present moment, latest first, at most that many. An
/// imported one comes before all others, whenever it was: it is what the person wants to hear of.
/// They belong to the diary.
std::vector<const Workout*> latestWorkouts(const Diary& diary, std::size_t most);

/// A workout as the health library carries it. Energy is in kilocalories, distance in metres.
Ref<HKWorkout> workoutRecord(const Workout& workout);

/// "Outdoor Run"
std::string_view activityName(HKWorkoutActivityType type);

}  // namespace tavro
