#pragma once

#include <benchmark/benchmark.h>

#include <cstdint>
#include <string_view>
#include <vector>

namespace tavro::bench {

/// One row of the table: what a benchmark costs in units of what bounds it, both measured in the
/// same run. With `less`, the cost of that benchmark is taken off first.
struct Ratio {
  std::string_view title;
  std::string_view cost;
  std::string_view bound;
  double reach;
  std::string_view less = {};
};

/// A figure without a bound: seconds in units of `unit`, to stay below `aim`.
struct Figure {
  std::string_view title;
  double aim;  ///< microseconds; 0 where there is none
  std::vector<double> microseconds;
};

/// What one turn of a benchmark works through. Its times are those of one item then.
inline constexpr char kItems[] = "items";
inline void setItems(benchmark::State& state, std::size_t items) {
  state.counters[kItems] = static_cast<double>(items);
}

/// Loads the bundle in a child process of its own each time and times opening it, installing its
/// categories, and checking its host contract. To be called before any thread starts.
std::vector<Figure> loadingFigures();

/// Keeps the benchmarks of the other files in the program, in this order.
void registerMessageBenchmarks();
void registerStorageBenchmarks();
void registerSliceBenchmarks();
void registerElementListBenchmarks();
void registerHeartRateBenchmarks();
void registerCalendarBenchmarks();
void registerWorkoutsBenchmarks();

/// Builds and reads a calendar of that many years once, for a program that counts instructions.
/// Prints how many days were read. Returns the exit status.
int countCalendar(std::int64_t years);

}  // namespace tavro::bench
