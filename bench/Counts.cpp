#include <gnu/libc-version.h>
#include <unicode/uversion.h>
#include <unistd.h>
#include <valgrind/callgrind.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <sstream>

#include "bench/Bench.h"
#include "platform/foundation/IcuCache.h"
#include "reader/Session.h"

namespace tavro::bench {
namespace {

using Json = nlohmann::ordered_json;

double allocationsOf(const std::function<void()>& work) {
  work();  // what is kept from the first time on
  const std::size_t before = allocationCount();
  work();
  return static_cast<double>(allocationCount() - before);
}

double allocationsOfOne(std::string_view name) {
  const Work& work = workNamed(name);
  return allocationsOf(work.prepare()) / work.items;
}

/// How many bytes the process has read from files.
double bytesRead() {
  std::ifstream file("/proc/self/io");
  std::string name;
  double bytes = 0;
  file >> name >> bytes;
  return bytes;
}

/// What a second reading of every screen of the sample creates and reads.
void countSecondReadings(Samples& samples) {
  Application application(Diary::read(optionsBesideProgram().diary));
  double created = 0;
  double read = 0;
  for (const std::string_view screen : Application::screenNames()) {
    application.showScreen(screen);
    const id window(&application.window());
    const std::size_t elements = readElements(window).size();
    const std::size_t createdBefore = icuFormattersCreated();
    const double first = bytesRead();
    const double second = bytesRead();
    require(readElements(window).size() == elements, "a screen must be the same again");
    read += bytesRead() - second - (second - first);  // less what asking takes
    created += static_cast<double>(icuFormattersCreated() - createdBefore);
  }
  samples["again: formatters"].push_back(created);
  samples["again: bytes read"].push_back(read);
}

std::string quoted(const std::string& text) { return "'" + text + "'"; }

/// The name and the count of one of callgrind's files; nothing of a file without a name.
void readCount(const std::filesystem::path& path, Samples& samples) {
  constexpr std::string_view kNameLine = "desc: Trigger: Client Request: ";
  constexpr std::string_view kCountLine = "totals: ";
  std::ifstream file(path);
  std::string name;
  for (std::string line; std::getline(file, line);) {
    if (line.starts_with(kNameLine)) {
      name = line.substr(kNameLine.size());
    } else if (line.starts_with(kCountLine) && !name.empty()) {
      samples["count:" + name] = {std::stod(line.substr(kCountLine.size())) /
                                  workNamed(name).items};
    }
  }
}

const std::vector<std::string> kChecked = {"messages", "slices", "bars", "days", "again:1"};
constexpr double kTolerance = 0.03;

/// Counts depend on these too.
Json surroundings() {
  return {{"compiler", __VERSION__}, {"icu", U_ICU_VERSION}, {"libc", gnu_get_libc_version()}};
}

Json currentCounts() {
  Samples samples;
  countInstructions(kChecked, samples);
  Json counts;
  for (const std::string& name : kChecked) {
    require(samples.contains("count:" + name), "valgrind must count the instructions");
    counts[name] = std::round(10 * samples.at("count:" + name).front()) / 10;
  }
  return counts;
}

}  // namespace

void sampleCounts(Samples& samples) {
  // Hundredths are the growth of the list that holds them.
  samples["allocations: element"].push_back(std::floor(10 * allocationsOfOne("elements")) / 10);
  // Eight elements with a label and a value each, and the list that holds them.
  samples["allocations: texts"].push_back(allocationsOfOne("slices") / 8 -
                                          samples["allocations: element"].front());
  countSecondReadings(samples);
}

void runCounted(const std::vector<std::string>& names) {
  for (const std::string& name : names) {
    const Work& work = workNamed(name);
    const std::function<void()> turn = work.prepare();
    // ICU's number formatters are compiled in the first turns; what is long enough has that within.
    for (int warming = work.isTimed ? 4 : 1; warming > 0; --warming) {
      turn();
    }
    CALLGRIND_START_INSTRUMENTATION;
    CALLGRIND_ZERO_STATS;
    turn();
    CALLGRIND_DUMP_STATS_AT(name.c_str());
    CALLGRIND_STOP_INSTRUMENTATION;
  }
}

void countInstructions(const std::vector<std::string>& names, Samples& samples) {
  const std::string folder = built("bench/counts");
  std::filesystem::remove_all(folder);
  std::filesystem::create_directories(folder);
  std::ostringstream command;
  command << "valgrind --tool=callgrind --instr-atstart=no --callgrind-out-file="
          << quoted(folder + "/out") << ' ' << quoted(built("bin/tavro_bench")) << " --count";
  for (const std::string& name : names) {
    command << ' ' << quoted(name);
  }
  command << " >" << quoted(folder + "/log") << " 2>&1";
  std::fprintf(stderr, "bench: counting instructions under callgrind\n");
  if (std::system(command.str().c_str()) != 0) {  // NOLINT(cert-env33-c): the paths are the build's
    std::fprintf(stderr, "bench: valgrind failed; see %s/log\n", folder.c_str());
    return;
  }
  for (const auto& file : std::filesystem::directory_iterator(folder)) {
    readCount(file.path(), samples);
  }
}

int recordCounts(const std::string& recorded) {
  const Json all{{"surroundings", surroundings()}, {"instructions", currentCounts()}};
  std::ofstream(recorded) << all.dump(2) << "\n";
  return 0;
}

int checkCounts(const std::string& recorded) {
  std::ifstream file(recorded);
  const Json all = Json::parse(file);
  const Json here = surroundings();
  if (all.at("surroundings") != here) {
    std::printf("The counts were recorded with %s, and here is %s: nothing is compared.\n",
                all.at("surroundings").dump().c_str(), here.dump().c_str());
    return 0;
  }
  bool isSame = true;
  const Json counts = currentCounts();
  std::printf("%-12s %12s %12s %8s\n", "CALL", "RECORDED", "NOW", "RATIO");
  for (const std::string& name : kChecked) {
    const double before = all.at("instructions").value(name, 0.0);
    const double now = counts.at(name);
    const double ratio = now / before;
    const bool isNear = std::abs(ratio - 1) <= kTolerance;
    std::printf("%-12s %12.1f %12.1f %8.3f%s\n", name.c_str(), before, now, ratio,
                isNear ? "" : "  differs");
    isSame = isSame && isNear;
  }
  if (!isSame) {
    std::printf(
        "Instruction counts differ by more than 3 per cent. Where that is meant, record\n"
        "them anew: ./dev bench --record\n");
  }
  return isSame ? 0 : 1;
}

}  // namespace tavro::bench
