#pragma once

#include <cstdint>

namespace tavro {

/// What a workout was. The numbers are the platform's and are read by number.
enum class HKWorkoutActivityType : std::int64_t {
  cycling = 13,
  hiking = 24,
  running = 37,
  swimming = 46,
  walking = 52,
  yoga = 57,
  other = 3000,
};

/// The user's answer to whether they use a wheelchair.
enum class HKWheelchairUse : std::int64_t { notSet = 0, no = 1, yes = 2 };

}  // namespace tavro
