#include <cmath>

#include "platform/accessibility/Labels.h"
#include "platform/healthkit/HKQuantity.h"
#include "plugin/core/Exports.h"
#include "plugin/trends/TrendChart.h"

namespace tavro {
namespace {

constexpr std::size_t kWeekdays = 7;

/// The amount to two decimals, half up. What was not recorded counts as 0, and so does an amount
/// that cannot be expressed in the unit: the column's other average is still worth hearing.
double roundedAmount(const id& answer, const Ref<HKUnit>& unit) {
  const auto quantity = as<HKQuantity>(answer);
  if (!quantity || !quantity->isCompatibleWithUnit(unit)) {
    return 0;
  }
  return std::floor(quantity->doubleValueForUnit(unit) * 100 + 0.5) / 100;
}

/// A trend's week chart hands out its title and seven columns. A column says its weekday and that
/// day's average over a year and over three months.
class TrendDetailDailyAverageViewAccessibility
    : public TrendChartCategory<TrendDetailDailyAverageViewAccessibility> {
 public:
  static constexpr Name className = "TrendDetailDailyAverageViewAccessibility";
  static constexpr Name target = "TavroApp.TrendDetailDailyAverageView";
  static constexpr Name kStops = "dayStops";
  static constexpr Name kGraphElements = "kAXTrendDetailDailyAveragesGraphElements";

  id accessibilityElements() {
    return elementsBuiltOnce(self, 0, [this](NSMutableArray& elements) { build(elements); });
  }

  /// nil when the chart has no unit.
  id _axLabelForIndex(std::int64_t index, Ref<NSDateFormatter> formatter) {
    const auto unit = typedRead<HKUnit>(self, "accessibilityUnit");
    if (!unit) {
      return nullptr;
    }
    const id day = send<id>(self, "_axDayStringForIndex:withFormatter:", index, formatter);
    const id average90 = trySend<id>(self, "accessibiliytQuantity90ForIndex:", index);
    const id average365 = trySend<id>(self, "accessibiliytQuantity365ForIndex:", index);
    const ValueWithUnitSpeech speech;
    return __UIAXStringForVariables({day, localized("trends.365.day.average"),
                                     speech.text(roundedAmount(average365, unit), unit),
                                     localized("trends.90.day.average"),
                                     speech.text(roundedAmount(average90, unit), unit)});
  }

  /// nil when the host's number is that of no weekday.
  id _axDayStringForIndex(std::int64_t index, Ref<NSDateFormatter> formatter) {
    const id answer = trySend<id>(self, "accessibilityDayForStopIndex:", index);
    const auto day = trySend<std::int32_t>(answer, "intValue");
    if (day < 1 || !formatter) {
      return nullptr;
    }
    const Ref<NSArray> names = formatter->weekdaySymbols();
    const auto position = static_cast<std::size_t>(day) - 1;
    return position < names->count() ? (*names)[position] : id();
  }

 private:
  void build(NSMutableArray& elements) {
    const Ref<NSArray> stops = this->stops();
    TrendChart chart(self, elements, kWeekdays);
    if (!chart.view() || !stops || stops->count() != kWeekdays) {
      return;
    }
    const auto formatter = make<NSDateFormatter>();
    const float width = stopAt(*stops, 1) - stopAt(*stops, 0);
    for (std::size_t column = 0; column < kWeekdays; ++column) {
      const id label = send<id>(
          self, "_axLabelForIndex:withFormatter:", static_cast<std::int64_t>(column), formatter);
      if (label) {
        chart.addColumn(stopAt(*stops, column), width, label, nullptr);
      }
    }
  }
};

constexpr Name kHost = "TavroApp.TrendDetailDailyAverageView";
constexpr HostCheck kHostContract[] = {
    instanceMethod(kHost, "accessibiliytQuantity365ForIndex:", "@", "q"),
    instanceMethod(kHost, "accessibiliytQuantity90ForIndex:", "@", "q"),
    instanceMethod(kHost, "accessibilityDayForStopIndex:", "@", "q"),
    instanceMethod(kHost, "layoutSubviews", "v"),
    instanceMethod(kHost, "titleLabel", "@"),
    instanceMethod(kHost, "dayStops", "@"),
    instanceMethod(kHost, "accessibilityUnit", "@"),
};

using Category = TrendDetailDailyAverageViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::accessibilityElements>("accessibilityElements")
        .method<&Category::_axLabelForIndex>("_axLabelForIndex:withFormatter:")
        .method<&Category::_axDayStringForIndex>("_axDayStringForIndex:withFormatter:")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation")
        .method<&Category::layoutSubviews>("layoutSubviews")
        .method<&Category::_accessibilityGraphData>("_accessibilityGraphData");

}  // namespace
}  // namespace tavro
