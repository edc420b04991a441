#pragma once

#include <array>
#include <string>
#include <utility>
#include <vector>

#include "platform/foundation/NSString.h"

namespace tavro {

/// What scales a unit, by the platform's numbers.
enum class HKMetricPrefix : std::int64_t {
  none = 0,
  pico,
  nano,
  micro,
  milli,
  centi,
  deci,
  deca,
  hecto,
  kilo,
  mega,
  giga,
  tera,
};

/// The powers of metre, kilogram and second that a unit consists of. Counts have none.
using HKDimension = std::array<int, 3>;

/// An immutable unit of measurement. Two units are convertible when their dimensions agree.
///
/// Class messages, each yielding a unit: `kilocalorieUnit`, `minuteUnit`, `hourUnit`, `secondUnit`,
/// `countUnit`, `meterUnit`, `literUnit`, `gramUnit`; `meterUnitWithMetricPrefix:`,
/// `literUnitWithMetricPrefix:`, `gramUnitWithMetricPrefix:` (argument "q"; raise for a number that
/// is no prefix).
/// Messages: `unitDividedByUnit:`, `unitString`, `description` (the unit string).
class HKUnit : public NSObject {
 public:
  static constexpr Name className = "HKUnit";

  /// A symbol as it prints ("mL") and the power it is raised to.
  using Factor = std::pair<std::string, int>;

  static Ref<HKUnit> kilocalorieUnit();
  static Ref<HKUnit> minuteUnit();
  static Ref<HKUnit> hourUnit();
  static Ref<HKUnit> secondUnit();
  static Ref<HKUnit> countUnit();
  static Ref<HKUnit> meterUnit();
  static Ref<HKUnit> literUnit();
  static Ref<HKUnit> gramUnit();
  /// Each raises for a number that is no prefix.
  static Ref<HKUnit> meterUnitWithMetricPrefix(HKMetricPrefix prefix);
  static Ref<HKUnit> literUnitWithMetricPrefix(HKMetricPrefix prefix);
  static Ref<HKUnit> gramUnitWithMetricPrefix(HKMetricPrefix prefix);

  /// Raises for nil.
  [[nodiscard]] Ref<HKUnit> unitDividedByUnit(const Ref<HKUnit>& divisor) const;
  /// The factors in the order in which they were multiplied, then those divided by after one
  /// slash: "kcal", "km/hr", "mL/kg·min". A unit divided by itself is "1".
  [[nodiscard]] Ref<NSString> unitString() const;

  [[nodiscard]] const HKDimension& dimension() const { return dimension_; }
  /// How many of the metre, kilogram and second units of its dimension one of this unit is.
  [[nodiscard]] double scale() const { return scale_; }

  /// Set once, right after allocation.
  void initWithFactors(std::vector<Factor> factors, const HKDimension& dimension, double scale);

 private:
  std::vector<Factor> factors_;
  HKDimension dimension_{};
  double scale_ = 1;
  mutable Ref<NSString> unitString_;  // made when it is first asked for
};

}  // namespace tavro
