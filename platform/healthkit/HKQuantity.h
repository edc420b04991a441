#pragma once

#include "platform/healthkit/HKUnit.h"

namespace tavro {

/// An immutable amount with its unit.
///
/// Class message: `quantityWithUnit:doubleValue:`.
/// Messages: `isCompatibleWithUnit:` ("B"), `doubleValueForUnit:` ("d"), `description` (the number
/// and the unit string, for people who debug).
class HKQuantity : public NSObject {
 public:
  static constexpr Name className = "HKQuantity";

  /// Raises for a nil unit.
  static Ref<HKQuantity> quantityWithUnit(const Ref<HKUnit>& unit, double value);

  /// Whether the amount can be expressed in that unit; no unit at all is NO.
  [[nodiscard]] bool isCompatibleWithUnit(const Ref<HKUnit>& unit) const;
  /// The amount in that unit. Raises when the unit is incompatible or nil.
  [[nodiscard]] double doubleValueForUnit(const Ref<HKUnit>& unit) const;
  [[nodiscard]] Ref<NSString> description() const;

 private:
  Ref<HKUnit> unit_;
  double value_ = 0;
};

}  // namespace tavro
