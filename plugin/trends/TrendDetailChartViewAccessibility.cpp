#include "platform/healthkit/HKQuantity.h"
#include "plugin/trends/TrendChart.h"

namespace tavro {
namespace {

/// A trend's bar chart hands out its title and its bars. A bar for which nothing was recorded, or
/// whose amount is not in the chart's unit, is left out.
class TrendDetailChartViewAccessibility
    : public TrendChartCategory<TrendDetailChartViewAccessibility> {
 public:
  static constexpr Name className = "TrendDetailChartViewAccessibility";
  static constexpr Name target = "TavroApp.TrendDetailChartView";
  static constexpr Name kStops = "barStops";
  static constexpr Name kGraphElements = "kAXTrendDetailGraphElements";

  id accessibilityElements() {
    return elementsBuiltOnce(self, 0, [this](NSMutableArray& elements) { build(elements); });
  }

 private:
  void build(NSMutableArray& elements) {
    const Ref<NSArray> stops = this->stops();
    const std::size_t bars = stops ? stops->count() : 0;
    TrendChart chart(self, elements, bars);
    if (!chart.view() || bars == 0) {
      return;
    }
    const auto formatter = make<NSDateIntervalFormatter>();
    formatter->setTimeStyle(NSDateFormatterStyle::none);
    formatter->setDateTemplate("MMMMdyyyy");
    const ValueWithUnitSpeech speech;
    const double width = chart.view()->frame().size.width / static_cast<double>(bars);
    for (std::size_t bar = 0; bar < bars; ++bar) {
      const auto index = static_cast<std::int64_t>(bar);
      const auto quantity =
          as<HKQuantity>(trySend<id>(self, "accessibilityQuantityForIndex:", index));
      const auto interval =
          as<NSDateInterval>(trySend<id>(self, "accessibilityDateIntervalForIndex:", index));
      const auto unit = typedRead<HKUnit>(self, "accessibilityUnit");
      if (!quantity || !interval || !quantity->isCompatibleWithUnit(unit)) {
        continue;
      }
      // The host draws a bar one column to the right of its stop.
      chart.addColumn(width + stopAt(*stops, bar), width,
                      formatter->stringFromDateInterval(interval),
                      speech.text(quantity->doubleValueForUnit(unit), unit));
    }
  }
};

constexpr Name kHost = "TavroApp.TrendDetailChartView";
constexpr HostCheck kHostContract[] = {
    instanceMethod(kHost, "accessibilityDateIntervalForIndex:", "@", "q"),
    instanceMethod(kHost, "accessibilityQuantityForIndex:", "@", "q"),
    instanceMethod(kHost, "layoutSubviews", "v"),
    instanceMethod(kHost, "titleLabel", "@"),
    instanceMethod(kHost, "chartMaxLabel", "@"),
    instanceMethod(kHost, "accessibilityUnit", "@"),
    instanceMethod(kHost, "barStops", "@"),
};

using Category = TrendDetailChartViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::accessibilityElements>("accessibilityElements")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation")
        .method<&Category::layoutSubviews>("layoutSubviews")
        .method<&Category::_accessibilityGraphData>("_accessibilityGraphData");

}  // namespace
}  // namespace tavro
