// Prints what things cost as ratios to what bounds them, measured in one run.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>

#include "bench/Ratios.h"
#include "platform/accessibility/BundleLoader.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"
#include "reader/SummaryDescription.h"

namespace tavro::bench {
namespace {

constexpr Ratio kRatios[] = {
    {"checked message send, to a virtual call", "send", "virtual", 2.5},
    {"a std::function call, to a virtual call", "function", "virtual", 0},
    {"each step to super, to a virtual call", "send+super", "virtual", 1.5, "send"},
    {"send inside a safe block, to a send", "trySend", "send", 1.2},
    {"typed key read, instance variable, to a virtual call", "key:variable", "virtual", 6},
    {"typed key read, accessor, to a virtual call", "key:accessor", "virtual", 10},
    {"typed key read, absent key, to a virtual call", "key:absent", "virtual", 4},
    {"weak read, to a virtual call", "weak:read", "virtual", 3},
    {"retained value, read, to a virtual call", "retained:read", "virtual", 4},
    {"retained value, write, to a virtual call", "retained:write", "virtual", 10},
    {"eight slices, to ICU formatting their labels", "slices", "icu:labels", 1.3},
    {"eight slices, to ICU formatting all their texts", "slices", "icu:texts", 1.25},
    {"24 stand hours, to ICU formatting their texts", "hours", "icu:hours", 0},
    {"365 trend bars, to ICU formatting their texts", "bars", "icu:bars", 1.4},
    {"heart-rate slice of 10,000, to one pass; a reading", "slice:10000", "pass:10000", 0},
    {"heart-rate slice of 200,000, to one pass; a reading", "slice:200000", "pass:200000", 1.2},
    {"a reading of 200,000, to one of 10,000", "slice:200000", "slice:10000", 0},
    {"a calendar day of 10 years, to one of 1 year", "calendar:10", "calendar:1", 0},
    {"a workout row of 100,000, to one of 100", "workouts:100000", "workouts:100", 0},
};

/// Keeps the nanoseconds of every repetition, divided by the items of a turn where it has any.
class Collector : public benchmark::BenchmarkReporter {
 public:
  bool ReportContext(const Context& /*context*/) override { return true; }
  void ReportRuns(const std::vector<Run>& runs) override {
    for (const Run& run : runs) {
      if (run.error_occurred) {
        std::fprintf(stderr, "%s: %s\n", run.benchmark_name().c_str(), run.error_message.c_str());
      } else if (run.run_type == Run::RT_Iteration) {
        const auto items = run.counters.find(kItems);
        times[run.run_name.function_name].push_back(
            run.GetAdjustedCPUTime() / (items == run.counters.end() ? 1 : items->second.value));
      }
    }
  }
  std::map<std::string, std::vector<double>, std::less<>> times;
};

struct Spread {
  double low;
  double median;
  double high;
};

Spread spreadOf(std::vector<double> values) {
  std::ranges::sort(values);
  return {values.front(), values[values.size() / 2], values.back()};
}

void printRatios(const Collector& collector) {
  std::printf("%-56s %8s %8s  %s\n", "RATIO", "MEDIAN", "REACH", "MEDIANS IN NANOSECONDS (SPREAD)");
  for (const Ratio& ratio : kRatios) {
    if (!collector.times.contains(ratio.cost) || !collector.times.contains(ratio.bound)) {
      continue;  // left out by a filter
    }
    const Spread cost = spreadOf(collector.times.at(std::string(ratio.cost)));
    const Spread bound = spreadOf(collector.times.at(std::string(ratio.bound)));
    const double less =
        ratio.less.empty() ? 0 : spreadOf(collector.times.at(std::string(ratio.less))).median;
    std::string reach = "-";
    if (ratio.reach > 0) {
      reach = std::to_string(ratio.reach).substr(0, 4);
    }
    std::printf("%-56.*s %8.2f %8s  %.1f (%.1f to %.1f) / %.1f (%.1f to %.1f)\n",
                static_cast<int>(ratio.title.size()), ratio.title.data(),
                (cost.median - less) / bound.median, reach.c_str(), cost.median - less,
                cost.low - less, cost.high - less, bound.median, bound.low, bound.high);
  }
}

void printFigures(const std::vector<Figure>& figures) {
  std::printf("\n%-56s %8s %8s  %s\n", "FIGURE", "MEDIAN", "AIM", "MICROSECONDS (SPREAD)");
  for (const Figure& figure : figures) {
    const Spread spread = spreadOf(figure.microseconds);
    std::printf("%-56.*s %8.0f %8s  (%.0f to %.0f)\n", static_cast<int>(figure.title.size()),
                figure.title.data(), spread.median,
                figure.aim > 0 ? std::to_string(static_cast<int>(figure.aim)).c_str() : "-",
                spread.low, spread.high);
  }
}

}  // namespace
}  // namespace tavro::bench

int main(int argumentCount, char** arguments) {
  using namespace tavro;
  Settings::current().now = secondsFromIso("2026-03-11T15:20Z").value();
  const std::string bundlePath = std::string(TAVRO_BUILD) + "/AXTavro.axbundle";
  if (argumentCount == 4 && std::string_view(arguments[1]) == "--count" &&
      std::string_view(arguments[2]) == "calendar") {
    letSummariesDescribeRings(loadAccessibilityBundle(bundlePath));
    return bench::countCalendar(std::atoi(arguments[3]));
  }
  const std::vector<bench::Figure> figures = bench::loadingFigures();
  letSummariesDescribeRings(loadAccessibilityBundle(bundlePath));

  std::vector<std::string> texts(arguments, arguments + argumentCount);
  texts.insert(texts.begin() + 1, {"--benchmark_repetitions=9", "--benchmark_min_time=0.02",
                                   "--benchmark_enable_random_interleaving=true"});
  std::vector<char*> pointers;
  std::ranges::transform(texts, std::back_inserter(pointers),
                         [](auto& text) { return text.data(); });
  int count = static_cast<int>(pointers.size());
  benchmark::Initialize(&count, pointers.data());
  bench::registerMessageBenchmarks();
  bench::registerStorageBenchmarks();
  bench::registerSliceBenchmarks();
  bench::registerElementListBenchmarks();
  bench::registerHeartRateBenchmarks();
  bench::registerCalendarBenchmarks();
  bench::registerWorkoutsBenchmarks();
  bench::Collector collector;
  benchmark::RunSpecifiedBenchmarks(&collector);
  bench::printRatios(collector);
  bench::printFigures(figures);
  return 0;
}
