#include "host/screens/trends/TrendUnits.h"

#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

Ref<HKUnit> milliliterPerKilogramMinute() {
  return HKUnit::literUnitWithMetricPrefix(HKMetricPrefix::milli)
      ->unitDividedByUnit(HKUnit::gramUnitWithMetricPrefix(HKMetricPrefix::kilo))
      ->unitDividedByUnit(HKUnit::minuteUnit());
}

Ref<HKUnit> kilometerPerHour() {
  return HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::kilo)
      ->unitDividedByUnit(HKUnit::hourUnit());
}

struct Metric {
  Ref<HKUnit> (*unit)();
  std::string_view shown;
  int decimals;
};

/// By trend type.
constexpr Metric kMetrics[] = {
    {&HKUnit::kilocalorieUnit, "KCAL", 0},
    {&HKUnit::minuteUnit, "MIN", 0},
    {&HKUnit::countUnit, "HR", 1},
    {&HKUnit::meterUnit, "M", 0},
    {&HKUnit::countUnit, "STEPS", 0},
    {&HKUnit::countUnit, "FLIGHTS", 1},
    {&milliliterPerKilogramMinute, "VO₂ MAX", 1},
    {&kilometerPerHour, "KM/H", 2},
    {&kilometerPerHour, "KM/H", 2},
};

const Metric* metricOf(std::int64_t type) {
  return type >= 0 && type < std::ssize(kMetrics) ? &kMetrics[type] : nullptr;
}

}  // namespace

Ref<HKUnit> unitOfTrend(std::int64_t type) {
  const Metric* const metric = metricOf(type);
  return metric == nullptr ? nullptr : metric->unit();
}

std::string shownAmount(std::int64_t type, std::optional<double> amount) {
  const Metric* const metric = metricOf(type);
  if (metric == nullptr || !amount) {
    return "--";
  }
  return utf8(decimalString(*amount, metric->decimals)) + " " + std::string(metric->shown);
}

}  // namespace tavro
