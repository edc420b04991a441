#include <array>

#include "bench/IcuTexts.h"
#include "bench/Ratios.h"
#include "host/screens/day/StandChart.h"
#include "host/screens/trends/TrendCharts.h"
#include "platform/accessibility/BundleLoader.h"

namespace tavro::bench {
namespace {

constexpr int kHours = 24;
constexpr int kBars = 365;
constexpr double kSecondsPerHour = 3600;
constexpr double kSecondsPerDay = 86400;
constexpr CalendarDay kFirstBar{20089};  // 2025-01-01

double amountOf(int bar) { return 312.25 + bar * 1.37; }

/// Drops the chart's element list, as a load does, and builds it.
void buildElements(benchmark::State& state, const Ref<UIView>& chart, std::size_t expected) {
  chart->layoutIfNeeded();
  for (auto _ : state) {
    send<void>(chart, "_accessibilityLoadAccessibilityInformation");
    const auto elements = as<NSArray>(send<id>(chart, "accessibilityElements"));
    if (!elements || elements->count() != expected) {
      state.SkipWithError("the chart did not hand out its elements");
      break;
    }
  }
}

void buildHours(benchmark::State& state) {
  const auto chart = makeView<ActivityStandChartView>({0, 0, 360, 100});
  std::array<bool, kHours> hours{};
  for (std::size_t hour = 8; hour < 20; ++hour) {
    hours.at(hour) = true;
  }
  chart->setHours(hours);
  buildElements(state, chart, kHours);
}

void formatHours(benchmark::State& state) {
  IcuTexts icu;
  const auto hours = icu.intervalFormat(u"ha");
  const auto minutes = icu.intervalFormat(u"h:mma");
  const double start = midnight();
  for (auto _ : state) {
    for (int hour = 0; hour < kHours - 1; ++hour) {
      icu.formatInterval(hours, start + hour * kSecondsPerHour,
                         start + (hour + 1) * kSecondsPerHour);
    }
    icu.formatInterval(minutes, start + (kHours - 1) * kSecondsPerHour, start + kSecondsPerDay - 1);
  }
}

void buildBars(benchmark::State& state) {
  Trend trend;
  trend.title = "Move";
  for (int bar = 0; bar < kBars; ++bar) {
    const CalendarDay day{kFirstBar.number + bar};
    trend.bars.push_back({day, day, amountOf(bar)});
  }
  const auto chart = makeView<TrendDetailChartView>({0, 0, 360, TrendDetailChartView::height});
  chart->setTrend(trend);
  buildElements(state, chart, 1 + kBars);  // the title and the bars
}

void formatBars(benchmark::State& state) {
  IcuTexts icu;
  const auto days = icu.intervalFormat(u"MMMMdyyyy");
  for (auto _ : state) {
    for (int bar = 0; bar < kBars; ++bar) {
      const double noon = (static_cast<double>(kFirstBar.number + bar) + 0.5) * kSecondsPerDay;
      icu.formatInterval(days, noon, noon);
      icu.formatNumber(amountOf(bar));
    }
  }
}

}  // namespace

void registerElementListBenchmarks() {
  benchmark::RegisterBenchmark("hours", &buildHours);
  benchmark::RegisterBenchmark("icu:hours", &formatHours);
  benchmark::RegisterBenchmark("bars", &buildBars);
  benchmark::RegisterBenchmark("icu:bars", &formatBars);
}

}  // namespace tavro::bench
