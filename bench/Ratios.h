#pragma once

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

/// Loads the bundle in a child process of its own each time and times opening it, installing its
/// categories, and checking its host contract. To be called before any thread starts.
std::vector<Figure> loadingFigures();

/// Keeps the benchmarks of the other files in the program, in this order.
void registerMessageBenchmarks();
void registerStorageBenchmarks();
void registerSliceBenchmarks();

}  // namespace tavro::bench
