#include <benchmark/benchmark.h>
#include <unicode/dtitvfmt.h>
#include <unicode/numberformatter.h>

#include <memory>

#include "bench/Ratios.h"
#include "host/screens/day/MoveAndExerciseChart.h"
#include "platform/accessibility/BundleLoader.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSValue.h"
#include "platform/foundation/Settings.h"

namespace tavro::bench {
namespace {

constexpr int kSlices = 8;
constexpr double kMilliseconds = 1000;

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
  UErrorCode status = U_ZERO_ERROR;
  const icu::Locale locale("en_US");
  const auto formatter = [&](const char16_t* skeleton) {
    std::unique_ptr<icu::DateIntervalFormat> made(
        icu::DateIntervalFormat::createInstance(skeleton, locale, status));
    made->setTimeZone(*icu::TimeZone::getGMT());
    return made;
  };
  const auto hours = formatter(u"hxa");
  const auto minutes = formatter(u"h:mma");
  const auto numbers = icu::number::NumberFormatter::withLocale(locale).precision(
      icu::number::Precision::maxFraction(1));
  const double midnight = currentCalendar()->startOfDayForDate(dateNow())->seconds * kMilliseconds;
  for (auto _ : state) {
    for (int slice = 0; slice < kSlices; ++slice) {
      const bool isLast = slice == kSlices - 1;
      const double start = midnight + slice * 10800 * kMilliseconds;
      const icu::DateInterval span(start, start + (isLast ? 10799 : 10800) * kMilliseconds);
      icu::UnicodeString text;
      icu::FieldPosition position;
      (isLast ? minutes : hours)->format(&span, text, position, status);
      benchmark::DoNotOptimize(text);
      if (withAmounts) {
        icu::UnicodeString amount =
            numbers.formatDouble(slice * 65.7 + 21.9, status).toString(status);
        benchmark::DoNotOptimize(amount);
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
