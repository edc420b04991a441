#include "plugin/core/Exports.h"

using namespace tavro;

namespace {

Ref<HKUnit> kilometersPerHour() {
  return HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::kilo)
      ->unitDividedByUnit(HKUnit::hourUnit());
}

Ref<HKUnit> millilitersPerKilogramMinute() {
  return HKUnit::literUnitWithMetricPrefix(HKMetricPrefix::milli)
      ->unitDividedByUnit(HKUnit::gramUnitWithMetricPrefix(HKMetricPrefix::kilo))
      ->unitDividedByUnit(HKUnit::minuteUnit());
}

/// By trend type.
constexpr Ref<HKUnit> (*kUnits[])() = {&HKUnit::kilocalorieUnit,
                                       &HKUnit::minuteUnit,
                                       &HKUnit::countUnit,
                                       &HKUnit::meterUnit,
                                       &HKUnit::countUnit,
                                       &HKUnit::countUnit,
                                       &millilitersPerKilogramMinute,
                                       &kilometersPerHour,
                                       &kilometersPerHour};

}  // namespace

Ref<HKUnit> accessibilityHKUnitForTrendType(std::int64_t trendType) {
  return trendType >= 0 && trendType < std::ssize(kUnits) ? kUnits[trendType]() : nullptr;
}
