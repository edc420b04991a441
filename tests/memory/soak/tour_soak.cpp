// Hears the whole tour many times in one process and fails when the process holds more for it.
//   tour_soak [COUNT]

#include <algorithm>
#include <chrono>
#include <fstream>
#include <iostream>

#include "tests/memory/Use.h"

namespace tavro {
namespace {

constexpr long kWarmUp = 5;
constexpr long kMostBytes = 4096;  // the allocator rounds up the same request by more or by less

/// What the process has in memory, in kilobytes.
long residentKilobytes() {
  constexpr long kilobytesPerPage = 4;
  long pages = 0;
  long resident = 0;
  std::ifstream("/proc/self/statm") >> pages >> resident;
  return resident * kilobytesPerPage;
}

int soak(long count) {
  Session session(memoryOptions());
  const auto hear = [&](long times) {
    for (long time = 0; time < times; ++time) {
      static_cast<void>(tour(session));
    }
    session.application().window().setRootViewController(nullptr);
    GlobalQueue::shared().drain();
  };
  hear(kWarmUp);
  const LiveMemory before = LiveMemory::now();
  const long resident = residentKilobytes();
  const auto start = std::chrono::steady_clock::now();
  hear(count);
  const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - start;
  const LiveMemory after = LiveMemory::now();
  const auto more = [](std::size_t now, std::size_t then) {
    return static_cast<long>(now) - static_cast<long>(then);
  };
  const long blocks = more(after.blocks, before.blocks);
  const long bytes = more(after.bytes, before.bytes);
  std::cout << count << " tours in " << seconds.count() << " s; grown by " << blocks << " blocks, "
            << bytes << " bytes, " << residentKilobytes() - resident << " KB resident\n";
  if (blocks > 0 || bytes > kMostBytes) {
    std::cerr << "tour_soak: the process holds more after " << count << " tours than before\n";
    return 1;
  }
  return 0;
}

}  // namespace
}  // namespace tavro

int main(int argumentCount, char** arguments) {
  constexpr long usual = 50;
  return tavro::soak(argumentCount > 1 ? std::max(1L, std::atol(arguments[1])) : usual);
}
