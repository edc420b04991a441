#include "bench/IcuTexts.h"
#include "bench/Ratios.h"
#include "host/screens/day/MoveAndExerciseChart.h"
#include "platform/accessibility/BundleLoader.h"
#include "platform/foundation/NSValue.h"

namespace tavro::bench {
namespace {

constexpr int kSlices = 8;
constexpr double kSecondsPerSlice = 10800;

std::vector<double> hourlyAmounts() {
  std::vector<double> amounts;
  for (int hour = 0; hour < 24; ++hour) {
    amounts.push_back(hour * 7.3);
  }
  return amounts;
}

void buildSlices(benchmark::State& state) {
  const auto chart = makeView<ActivityMoveAndExerciseChartView>({0, 0, 300, 100});
  chart->setAmounts(MoveAndExerciseChartType::activeEnergy, hourlyAmounts());
  for (auto _ : state) {
    send<void>(chart, "accessibilityReloadData");
    benchmark::DoNotOptimize(send<id>(chart, "accessibilityElements"));
  }
}

/// Formats the eight slices' spans, and their amounts when asked, with ICU alone.
void formatSlices(benchmark::State& state, bool withAmounts) {
  IcuTexts icu;
  const auto hours = icu.intervalFormat(u"hxa");
  const auto minutes = icu.intervalFormat(u"h:mma");
  const double start = midnight();
  for (auto _ : state) {
    for (int slice = 0; slice < kSlices; ++slice) {
      const bool isLast = slice == kSlices - 1;
      const double from = start + slice * kSecondsPerSlice;
      icu.formatInterval(isLast ? minutes : hours, from,
                         from + (isLast ? kSecondsPerSlice - 1 : kSecondsPerSlice));
      if (withAmounts) {
        icu.formatNumber(slice * 65.7 + 21.9);
      }
    }
  }
}

void formatLabels(benchmark::State& state) { formatSlices(state, false); }
void formatTexts(benchmark::State& state) { formatSlices(state, true); }

}  // namespace

void registerSliceBenchmarks() {
  benchmark::RegisterBenchmark("slices", &buildSlices);
  benchmark::RegisterBenchmark("icu:labels", &formatLabels);
  benchmark::RegisterBenchmark("icu:texts", &formatTexts);
}

}  // namespace tavro::bench
