#include <array>
#include <memory>

#include "bench/Bench.h"
#include "bench/IcuTexts.h"
#include "host/screens/day/MoveAndExerciseChart.h"
#include "host/screens/day/StandChart.h"
#include "host/screens/trends/TrendCharts.h"
#include "plugin/core/ChartElements.h"

namespace tavro::bench {
namespace {

constexpr CalendarDay kFirstBarDay{20089};  // 2025-01-01

/// Drops the chart's element list, as a load does, and builds it.
std::function<void()> builds(const Ref<UIView>& chart, Name drop, std::size_t expected) {
  chart->layoutIfNeeded();
  return [chart, drop, expected] {
    send<void>(chart, drop);
    const auto elements = as<NSArray>(send<id>(chart, "accessibilityElements"));
    require(elements && elements->count() == expected, "a chart must hand out its elements");
  };
}

std::function<void()> buildSlices() {
  const auto chart = makeView<ActivityMoveAndExerciseChartView>({0, 0, 300, 100});
  std::vector<double> amounts;
  for (int hour = 0; hour < kHours; ++hour) {
    amounts.push_back(energyOfHour(hour));
  }
  chart->setAmounts(MoveAndExerciseChartType::activeEnergy, amounts);
  return builds(chart, "accessibilityReloadData", kSlices);
}

std::function<void()> buildHours() {
  const auto chart = makeView<ActivityStandChartView>({0, 0, 360, 100});
  std::array<bool, kHours> hours{};
  std::fill(hours.begin() + 8, hours.begin() + 20, true);
  chart->setHours(hours);
  return builds(chart, "_accessibilityLoadAccessibilityInformation", kHours);
}

std::function<void()> buildBars() {
  Trend trend;
  trend.title = "Move";
  for (int bar = 0; bar < kBars; ++bar) {
    const CalendarDay day{kFirstBarDay.number + bar};
    trend.bars.push_back({day, day, amountOfBar(bar)});
  }
  const auto chart = makeView<TrendDetailChartView>({0, 0, 360, TrendDetailChartView::height});
  chart->setTrend(trend);
  return builds(chart, "_accessibilityLoadAccessibilityInformation",
                1 + kBars);  // the title and the bars
}

/// Texts by ICU; its formatters are made at the first turn.
std::function<std::function<void()>()> formats(void (*texts)(IcuTexts&)) {
  return [texts] { return [texts, icu = std::make_shared<IcuTexts>()] { texts(*icu); }; };
}

/// Elements with texts that are there already, added to a list that goes at the end.
std::function<void()> addElements() {
  const auto chart = makeView<ActivityStandChartView>({0, 0, 360, 100});
  const Ref<NSString> text = string("Idle hour");
  chart->weakSlot();
  return [chart, text] {
    const auto elements = mutableArray(kBars);
    for (int element = 0; element < kBars; ++element) {
      addChartElement(*elements, chart, {15.0 * element, 0, 15, 100}, text, text);
    }
  };
}

}  // namespace

void addChartWork(std::vector<Work>& all) {
  all.push_back({"slices", &buildSlices});
  all.push_back({"icu:slices", formats(&formatSlices)});
  all.push_back({"hours", &buildHours});
  all.push_back({"icu:hours", formats(&formatHours)});
  all.push_back({"bars", &buildBars});
  all.push_back({"icu:bars", formats(&formatBars)});
  all.push_back({"elements", &addElements, kBars});
}

}  // namespace tavro::bench
