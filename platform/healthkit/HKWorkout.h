#pragma once

#include "platform/foundation/NSDate.h"
#include "platform/healthkit/HKQuantity.h"
#include "platform/healthkit/HKTypes.h"

namespace tavro {

// Plain records: filled once by whoever makes them, then read by message. Every object may be nil.

/// What recorded data. Messages: `name`, `_isOrlamWatch` ("B").
class HKSource : public NSObject {
 public:
  static constexpr Name className = "HKSource";

  /// An application's or a device's display name; may be empty.
  Ref<NSString> sourceName;
  /// Whether it is the companion watch.
  bool isWatch = false;

  [[nodiscard]] Ref<NSString> name() const { return sourceName; }
  [[nodiscard]] bool isOrlamWatch() const { return isWatch; }
};

/// One state of a source's software. Message: `source`.
class HKSourceRevision : public NSObject {
 public:
  static constexpr Name className = "HKSourceRevision";

  Ref<HKSource> recorder;

  [[nodiscard]] Ref<HKSource> source() const { return recorder; }
};

/// One workout. Messages: `workoutActivityType` ("q"), `startDate`, `endDate`, `duration` ("d",
/// seconds), `totalEnergyBurned`, `totalDistance` (nil where there is none), `sourceRevision`.
class HKWorkout : public NSObject {
 public:
  static constexpr Name className = "HKWorkout";

  struct Record {
    HKWorkoutActivityType activityType = HKWorkoutActivityType::walking;
    Ref<NSDate> startDate;
    Ref<NSDate> endDate;
    double duration = 0;  ///< seconds; less than from start to end where there were pauses
    Ref<HKQuantity> totalEnergyBurned;
    Ref<HKQuantity> totalDistance;
    Ref<HKSourceRevision> sourceRevision;
  };
  Record record;

  [[nodiscard]] HKWorkoutActivityType workoutActivityType() const { return record.activityType; }
  [[nodiscard]] Ref<NSDate> startDate() const { return record.startDate; }
  [[nodiscard]] Ref<NSDate> endDate() const { return record.endDate; }
  [[nodiscard]] double duration() const { return record.duration; }
  [[nodiscard]] Ref<HKQuantity> totalEnergyBurned() const { return record.totalEnergyBurned; }
  [[nodiscard]] Ref<HKQuantity> totalDistance() const { return record.totalDistance; }
  [[nodiscard]] Ref<HKSourceRevision> sourceRevision() const { return record.sourceRevision; }
};

/// A heart rate at a moment. Messages: `date`, `quantity` (counts by time).
class HKHeartRateSummaryReading : public NSObject {
 public:
  static constexpr Name className = "HKHeartRateSummaryReading";

  Ref<NSDate> moment;
  Ref<HKQuantity> heartRate;

  [[nodiscard]] Ref<NSDate> date() const { return moment; }
  [[nodiscard]] Ref<HKQuantity> quantity() const { return heartRate; }
};

}  // namespace tavro
