// Prints what things cost as ratios to what bounds them, measured in one run.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>

#include "bench/Bench.h"
#include "platform/accessibility/BundleLoader.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"
#include "reader/SummaryDescription.h"

namespace tavro::bench {
namespace {

/// How a row's value comes about: what was measured alone, or divided by its bound, or less it.
enum class Kind { figure, ratio, difference };

/// A row of the table. `less` is a sample whose median is taken off the cost first.
struct Row {
  std::string_view title;
  Kind kind;
  double reach;
  std::string_view unit;
  std::string_view cost;
  std::string_view bound = {};
  std::string_view less = {};
};

constexpr std::string_view kVirtual = "virtual";
constexpr std::string_view kTime = "ns";
constexpr std::string_view kInstructions = "instr";

constexpr Row kRows[] = {
    {"message, one class", Kind::ratio, 2.0, kTime, "send", kVirtual},
    {"message, eight classes", Kind::ratio, 1.8, kTime, "send mix", "virtual mix"},
    {"each step to super", Kind::ratio, 1.2, kTime, "send+super", kVirtual, "send"},
    {"message in a safe block", Kind::ratio, 1.2, kTime, "trySend", "send"},
    {"raise and contain, ten frames", Kind::ratio, 1.2, kTime, "raise", "throw"},
    {"typed key read, variable", Kind::ratio, 5, kTime, "key:variable", kVirtual},
    {"typed key read, accessor", Kind::ratio, 8, kTime, "key:accessor", kVirtual},
    {"typed key read, absent key", Kind::ratio, 4, kTime, "key:absent", kVirtual},
    {"retained value, read", Kind::ratio, 3, kTime, "retained:read", kVirtual},
    {"retained value, write", Kind::ratio, 10, kTime, "retained:write", kVirtual},
    {"weak read", Kind::ratio, 3, kTime, "weak:read", kVirtual},
    {"open the bundle and register", Kind::figure, 1e6, kTime, "open"},
    {"install 53 categories", Kind::figure, 1e5, kTime, "install"},
    {"install with the host contract checked", Kind::figure, 0, kTime, "install, checked"},
    {"8 slices, to ICU", Kind::ratio, 1.25, kTime, "slices", "icu:slices"},
    {"24 hours, to ICU", Kind::ratio, 1.25, kTime, "hours", "icu:hours"},
    {"365 bars, to ICU", Kind::ratio, 1.25, kTime, "bars", "icu:bars"},
    {"8 slices, first time", Kind::ratio, 1.1, kTime, "cold:slices", "cold:icu:slices"},
    {"24 hours, first time", Kind::ratio, 1.1, kTime, "cold:hours", "cold:icu:hours"},
    {"365 bars, first time", Kind::ratio, 1.1, kTime, "cold:bars", "cold:icu:bars"},
    {"element without its texts", Kind::figure, 300, kTime, "elements"},
    {"allocations, element without texts", Kind::figure, 2, "", "allocations: element"},
    {"allocations, its texts", Kind::figure, 4, "", "allocations: texts"},
    {"calendar day, to ICU", Kind::ratio, 1.4, kTime, "days", "icu:days"},
    {"calendar day of 10 years, to 1 year", Kind::ratio, 1.02, kInstructions, "count:calendar:10",
     "count:calendar:1"},
    {"calendar day of 100 years, to 1 year", Kind::ratio, 1.02, kInstructions, "count:calendar:100",
     "count:calendar:1"},
    {"workout row of 100,000, to 100", Kind::ratio, 1.02, kInstructions, "count:rows:100000",
     "count:rows:100"},
    {"heart-rate slice of 200,000, to one pass", Kind::ratio, 1.2, kTime, "heart rate", "pass"},
    {"element read again of 10 years, to 1 year", Kind::ratio, 1.02, kInstructions,
     "count:again:10", "count:again:1"},
    {"all screens again: formatters created", Kind::figure, 0.5, "", "again: formatters"},
    {"all screens again: bytes read", Kind::figure, 0.5, "", "again: bytes read"},
    {"narrel read day, cold", Kind::ratio, 1.3, kTime, "narrel day", "icu day"},
    {"memory of the tour, beyond ICU's", Kind::difference, 12, "MB", "tour memory", "icu memory"},
};

/// Keeps the nanoseconds of every repetition; of a work, those of one item.
class Collector : public benchmark::BenchmarkReporter {
 public:
  explicit Collector(Samples& samples) : samples_(samples) {}
  bool ReportContext(const Context& /*context*/) override { return true; }
  void ReportRuns(const std::vector<Run>& runs) override {
    for (const Run& run : runs) {
      if (run.run_type == Run::RT_Iteration) {
        const std::string& name = run.run_name.function_name;
        const auto work = std::ranges::find(allWork(), name, &Work::name);
        samples_[name].push_back(run.GetAdjustedCPUTime() /
                                 (work == allWork().end() ? 1 : work->items));
      }
    }
  }

 private:
  Samples& samples_;
};

void runBenchmarks(int count, char** arguments, Samples& samples) {
  std::vector<std::string> texts{arguments, arguments + count};
  texts.insert(texts.begin() + 1, {"--benchmark_repetitions=9", "--benchmark_min_time=0.02",
                                   "--benchmark_enable_random_interleaving=true"});
  std::vector<char*> pointers;
  std::ranges::transform(texts, std::back_inserter(pointers),
                         [](auto& text) { return text.data(); });
  count = static_cast<int>(pointers.size());
  benchmark::Initialize(&count, pointers.data());
  registerMessageBenchmarks();
  registerStorageBenchmarks();
  for (const Work& work : allWork()) {
    if (work.isTimed) {
      benchmark::RegisterBenchmark(work.name.c_str(), [&work](benchmark::State& state) {
        const std::function<void()> turn = work.prepare();
        turn();
        for (auto _ : state) {
          turn();
        }
      });
    }
  }
  Collector collector(samples);
  benchmark::RunSpecifiedBenchmarks(&collector);
}

struct Spread {
  double low;
  double median;
  double high;
};

Spread spreadOf(const Samples& samples, std::string_view name) {
  std::vector<double> values = samples.find(name)->second;
  std::ranges::sort(values);
  return {values.front(), values[values.size() / 2], values.back()};
}

void printSpread(const Spread& spread, std::string_view unit) {
  const double scale = unit == kTime && spread.median >= 1e5 ? 1000 : 1;
  const std::string name = scale == 1 ? std::string(unit) : "us";
  const int decimals = spread.median / scale < 1000 && unit != kInstructions ? 1 : 0;
  std::printf("%.*f", decimals, spread.median / scale);
  if (spread.low != spread.high) {
    std::printf(" (%.*f to %.*f)", decimals, spread.low / scale, decimals, spread.high / scale);
  }
  std::printf("%s%s", name.empty() ? "" : " ", name.c_str());
}

nlohmann::ordered_json asJson(const Spread& spread) {
  return {{"median", spread.median}, {"low", spread.low}, {"high", spread.high}};
}

/// A row with what was measured; null where something of it was not.
nlohmann::ordered_json reportRow(const Row& row, const Samples& samples) {
  for (const std::string_view name : {row.cost, row.bound, row.less}) {
    if (!name.empty() && !samples.contains(name)) {
      std::printf("%-42s not measured\n", std::string(row.title).c_str());
      return nullptr;
    }
  }
  Spread cost = spreadOf(samples, row.cost);
  const double less = row.less.empty() ? 0 : spreadOf(samples, row.less).median;
  cost = {cost.low - less, cost.median - less, cost.high - less};
  const Spread bound = row.bound.empty() ? Spread{} : spreadOf(samples, row.bound);
  const double value = row.kind == Kind::ratio        ? cost.median / bound.median
                       : row.kind == Kind::difference ? cost.median - bound.median
                                                      : cost.median;
  const bool isReached = row.reach == 0 || value <= row.reach;
  // Large figures are times in nanoseconds.
  const bool isLong = row.kind == Kind::figure && value >= 1e4;
  std::printf("%-42s %8.*f ", std::string(row.title).c_str(), isLong ? 0 : 2, value);
  if (row.reach == 0) {
    std::printf("%8s   ", "-");
  } else {
    std::printf("%8.*f %s ", row.reach >= 100 ? 0 : 2, row.reach, isReached ? " " : "!");
  }
  printSpread(cost, row.unit);
  if (!row.bound.empty()) {
    std::printf(" / ");
    printSpread(bound, row.unit);
  }
  std::printf("\n");
  nlohmann::ordered_json json{{"row", row.title}, {"value", value},       {"reach", row.reach},
                              {"unit", row.unit}, {"reached", isReached}, {"cost", asJson(cost)}};
  if (!row.bound.empty()) {
    json["bound"] = asJson(bound);
  }
  return json;
}

void report(const Samples& samples) {
  nlohmann::ordered_json all = nlohmann::ordered_json::array();
  std::printf("%-42s %8s %8s   %s\n", "ROW", "VALUE", "REACH", "MEDIANS (SPREAD): COST / BOUND");
  for (const Row& row : kRows) {
    if (nlohmann::ordered_json json = reportRow(row, samples); !json.is_null()) {
      all.push_back(std::move(json));
    }
  }
  std::filesystem::create_directories(built("bench"));
  std::ofstream(built("bench/bench.json")) << all.dump(2) << "\n";
}

std::vector<std::string> countedNames() {
  std::vector<std::string> names;
  for (const Work& work : allWork()) {
    const std::string sample = "count:" + work.name;
    if (std::ranges::any_of(
            kRows, [&](const Row& row) { return row.cost == sample || row.bound == sample; })) {
      names.push_back(work.name);
    }
  }
  return names;
}

/// With arguments, the benchmarks alone, which take them; the whole table without.
void measure(int count, char** arguments) {
  Samples samples;
  if (count == 1) {
    sampleColdStarts(samples);
    samplePrograms(samples);
  }
  loadPlugin();
  runBenchmarks(count, arguments, samples);
  if (count == 1) {
    sampleCounts(samples);
    countInstructions(countedNames(), samples);
  }
  report(samples);
}

}  // namespace

const std::vector<Work>& allWork() {
  static const auto* const all = [] {
    auto* const made = new std::vector<Work>;
    addMessageWork(*made);
    addChartWork(*made);
    addCalendarWork(*made);
    addWorkoutsWork(*made);
    addHeartRateWork(*made);
    return made;
  }();
  return *all;
}

const Work& workNamed(std::string_view name) {
  const auto found = std::ranges::find(allWork(), name, &Work::name);
  require(found != allWork().end(), "a work must have this name");
  return *found;
}

void require(bool isRight, const char* what) {
  if (!isRight) {
    std::fprintf(stderr, "bench: %s\n", what);
    std::_Exit(1);
  }
}

void loadPlugin() { letSummariesDescribeRings(loadAccessibilityBundle(built("AXTavro.axbundle"))); }

std::string built(std::string_view path) { return TAVRO_BUILD "/" + std::string(path); }

}  // namespace tavro::bench

int main(int count, char** arguments) {
  using namespace tavro::bench;
  const std::string command = count > 1 ? arguments[1] : "";
  tavro::Settings& settings = tavro::Settings::current();
  settings.timeZone = "America/New_York";
  settings.now = tavro::secondsFromIso("2026-03-11T15:20Z").value();
  if (command == "--check" || command == "--record") {
    require(count == 3, "the file of recorded counts is missing");
    return command == "--check" ? checkCounts(arguments[2]) : recordCounts(arguments[2]);
  }
  if (command == "--count") {
    loadPlugin();
    runCounted({arguments + 2, arguments + count});
    return 0;
  }
  measure(count, arguments);
  return 0;
}
