#pragma once

#include <optional>
#include <string>

#include "platform/foundation/NSAttributedString.h"
#include "platform/healthkit/HKWorkout.h"

namespace tavro {

/// A unit as it is shown ("KM") and as it is called ("kilometers").
struct DisplayUnit {
  std::string_view symbol;
  std::string_view name;
};
inline constexpr DisplayUnit kKilometers{"KM", "kilometers"};
inline constexpr DisplayUnit kMeters{"M", "meters"};
inline constexpr DisplayUnit kKilocalories{"KCAL", "kilocalories"};
inline constexpr DisplayUnit kBeatsPerMinute{"BPM", "beats per minute"};

/// An amount with its unit as an attributed string, or "--" when there is no amount. Goes through
/// the string class's message `attrStringWithValue:unit:`, whose unit carries its name as its
/// accessibility label.
id valueWithUnit(std::optional<double> amount, const DisplayUnit& unit, int decimals = 0);

/// Minutes and seconds ("6'05''"), rounded to whole seconds.
std::string paceText(double seconds);

/// Derives figures from workouts. Message: `averagePaceForWorkout:` ("d,@"; seconds a metre, 0
/// where there is no distance).
class CHWorkoutDataCalculator : public NSObject {
 public:
  static constexpr Name className = "CHWorkoutDataCalculator";

  double averagePaceForWorkout(const Ref<HKWorkout>& workout);
};

/// Writes the figures of workouts as attributed strings. Messages, each with a workout, one of its
/// activities and the screen that asks: `formattedDurationForWorkout:workoutActivity:context:`,
/// `formattedDistanceForWorkout:workoutActivity:context:`,
/// `formattedEnergyForWorkout:workoutActivity:context:`. The activity and the context may be nil,
/// for the whole workout and for any screen.
class CHWorkoutFormattingManager : public NSObject {
 public:
  static constexpr Name className = "CHWorkoutFormattingManager";

  /// Clock text ("1:02:03"); without an hour "40:53". nil for a nil workout.
  id formattedDuration(const Ref<HKWorkout>& workout, const id& activity, const id& context);
  /// "--" where there is none.
  id formattedDistance(const Ref<HKWorkout>& workout, const id& activity, const id& context);
  id formattedEnergy(const Ref<HKWorkout>& workout, const id& activity, const id& context);
};

}  // namespace tavro
