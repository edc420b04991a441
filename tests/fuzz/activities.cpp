// Recorded activities: what can be read is a workout whose parts agree; what cannot is one
// sentence.

#include <algorithm>
#include <cmath>

#include "host/ActivityFile.h"
#include "platform/foundation/NSDate.h"
#include "tests/fuzz/Fuzz.h"
#include "tests/support/Process.h"

namespace tavro::fuzz {
namespace {

bool isAmount(double amount) { return std::isfinite(amount) && amount >= 0; }

void requireSplits(const Workout& workout) {
  double distance = 0;
  double duration = 0;
  for (const Split& split : workout.splits) {
    require(isAmount(split.distance) && isAmount(split.duration), "a split is an amount");
    distance += split.distance;
    duration += split.duration;
  }
  if (!workout.splits.empty()) {
    const double total = workout.distance.value_or(0);
    require(std::abs(distance - total) <= 1e-6 * (1 + total), "the splits are the distance");
    require(std::abs(duration - workout.duration) <= 1e-6 * (1 + workout.duration),
            "the splits are the duration");
  }
}

void requireConsistent(const Workout& workout) {
  require(secondsFromIso(workout.start.iso).has_value(), "the start is a time", workout.start.iso);
  require(isAmount(workout.duration) && isAmount(workout.energy) &&
              isAmount(workout.distance.value_or(0)),
          "duration, energy and distance are amounts");
  double last = -1;
  for (const HeartRateReading& reading : workout.heartRate) {
    require(reading.offset > last && reading.offset <= workout.duration &&
                reading.beatsPerMinute > 0 && isAmount(reading.beatsPerMinute),
            "readings follow each other within the workout");
    last = reading.offset;
  }
  requireSplits(workout);
  if (workout.route) {
    require(!workout.route->points.empty() && !workout.route->title.empty() &&
                std::ranges::all_of(workout.route->points,
                                    [](const RoutePoint& point) {
                                      return std::isfinite(point.east) &&
                                             std::isfinite(point.north);
                                    }),
            "a route has a title and places");
  }
}

}  // namespace
}  // namespace tavro::fuzz

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using namespace tavro;
  static const TemporaryFolder temporary;
  const std::string path = temporary.path() + "/activity";
  fuzz::write(path, fuzz::textOf(data, size));
  try {
    fuzz::requireConsistent(readActivityFile(path));
  } catch (const FileError& error) {
    fuzz::requireOneSentence(error.what(), path + ":");
  }
  return 0;
}
