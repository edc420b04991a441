#pragma once

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace tavro::bench {

/// A piece of work that is timed by the benchmarks, counted in instructions, or both. `prepare`
/// makes what it works on, and yields what is measured; its costs are those of one of its items.
struct Work {
  std::string name;
  std::function<std::function<void()>()> prepare;
  double items = 1;
  bool isTimed = true;
};

/// All of it, in the order of the table.
const std::vector<Work>& allWork();
const Work& workNamed(std::string_view name);

// What the files of this folder add to it.
void addChartWork(std::vector<Work>& all);
void addHeartRateWork(std::vector<Work>& all);
void addCalendarWork(std::vector<Work>& all);
void addWorkoutsWork(std::vector<Work>& all);
void addMessageWork(std::vector<Work>& all);

/// What is as short as a message is timed by benchmarks of its own.
void registerMessageBenchmarks();
void registerStorageBenchmarks();

/// Ends the program when something did not work as it must for the figures to mean anything.
void require(bool isRight, const char* what);

/// The measured values by what they were measured of.
using Samples = std::map<std::string, std::vector<double>, std::less<>>;

/// What happens once a process, each time in a child process of its own. To be called before
/// anything else was done, while there is one thread.
void sampleColdStarts(Samples& samples);
/// Whole runs of programs: their processor time and the memory they reach.
void samplePrograms(Samples& samples);
/// Counts of allocations, of formatters created and of bytes read.
void sampleCounts(Samples& samples);

/// How many objects the process has allocated, ICU's own left out.
std::size_t allocationCount();

/// Counts, under callgrind, the instructions of one item of each work, under "count:<name>".
void countInstructions(const std::vector<std::string>& names, Samples& samples);
/// The counted program's side of it.
void runCounted(const std::vector<std::string>& names);

/// Compares the instructions of a few representative calls with the recorded ones, or records
/// them. Returns the exit status.
int checkCounts(const std::string& recorded);
int recordCounts(const std::string& recorded);

/// Opens the bundle and installs its categories.
void loadPlugin();

/// The place of a file below the build folder.
std::string built(std::string_view path);

}  // namespace tavro::bench
