// Prints what things cost as ratios to what bounds them, measured in one run.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <map>
#include <string>

#include "bench/Ratios.h"
#include "platform/accessibility/BundleLoader.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"

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
};

/// Keeps the nanoseconds of every repetition.
class Collector : public benchmark::BenchmarkReporter {
 public:
  bool ReportContext(const Context& /*context*/) override { return true; }
  void ReportRuns(const std::vector<Run>& runs) override {
    for (const Run& run : runs) {
      if (run.run_type == Run::RT_Iteration) {
        times[run.run_name.function_name].push_back(run.GetAdjustedCPUTime());
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
  const std::vector<bench::Figure> figures = bench::loadingFigures();
  static_cast<void>(loadAccessibilityBundle(std::string(TAVRO_BUILD) + "/AXTavro.axbundle"));

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
  bench::Collector collector;
  benchmark::RunSpecifiedBenchmarks(&collector);
  bench::printRatios(collector);
  bench::printFigures(figures);
  return 0;
}
