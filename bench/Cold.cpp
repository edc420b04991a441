#include <fcntl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <ctime>

#include "bench/Bench.h"
#include "platform/accessibility/BundleLoader.h"
#include "platform/foundation/Settings.h"
#include "platform/runtime/Class.h"

namespace tavro::bench {
namespace {

constexpr int kRuns = 15;

/// The processor time of this thread, which a busy machine disturbs less than the clock.
double now() {
  timespec time{};
  clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
  return static_cast<double>(time.tv_sec) * 1e9 + static_cast<double>(time.tv_nsec);
}

double nanoseconds(const std::function<void()>& work) {
  const double start = now();
  work();
  return now() - start;
}

/// What `measure` yields in a process of its own.
double inChild(const std::function<double()>& measure) {
  int ends[2];
  require(pipe(ends) == 0, "a pipe must open");
  const pid_t child = fork();
  require(child >= 0, "a process must start");
  double value = 0;
  if (child == 0) {
    value = measure();
    _exit(write(ends[1], &value, sizeof value) == sizeof value ? 0 : 1);
  }
  require(read(ends[0], &value, sizeof value) == sizeof value, "a child process must answer");
  waitpid(child, nullptr, 0);
  close(ends[0]);
  close(ends[1]);
  return value;
}

double openBundle() {
  static_cast<void>(registrationProblems());  // the executable's own classes are there before
  return nanoseconds([] {
    static_cast<void>(openAccessibilityBundle(built("AXTavro.axbundle")));
    static_cast<void>(Class::named("AXTavroGlue"));
  });
}

double install(bool withChecks) {
  Settings::current().performsValidationChecks = withChecks;
  static_cast<void>(registrationProblems());
  const LoadedBundle bundle = openAccessibilityBundle(built("AXTavro.axbundle"));
  return nanoseconds([&] { bundle.initialize(); });
}

/// The first turn of a work in a process that has opened the bundle.
double firstTurn(std::string_view name) {
  loadPlugin();
  const std::function<void()> turn = workNamed(name).prepare();
  return nanoseconds(turn);
}

/// A whole run of a program that writes to nowhere: its processor time and its peak memory.
rusage usageOf(const std::vector<std::string>& command) {
  const pid_t child = fork();
  require(child >= 0, "a program must start");
  if (child == 0) {
    std::vector<char*> arguments;
    for (const std::string& each : command) {
      arguments.push_back(const_cast<char*>(each.c_str()));
    }
    arguments.push_back(nullptr);
    const int nowhere = open("/dev/null", O_WRONLY);
    dup2(nowhere, STDOUT_FILENO);
    execv(arguments.front(), arguments.data());
    _exit(127);
  }
  int status = 0;
  rusage usage{};
  require(wait4(child, &status, 0, &usage) == child && status == 0, "a program must succeed");
  return usage;
}

double processorTime(const rusage& usage) {
  const auto nanosecondsOf = [](const timeval& time) {
    return static_cast<double>(time.tv_sec) * 1e9 + static_cast<double>(time.tv_usec) * 1e3;
  };
  return nanosecondsOf(usage.ru_utime) + nanosecondsOf(usage.ru_stime);
}

double megabytes(const rusage& usage) { return static_cast<double>(usage.ru_maxrss) / 1024; }

}  // namespace

void sampleColdStarts(Samples& samples) {
  for (int run = 0; run < kRuns; ++run) {
    samples["open"].push_back(inChild(&openBundle));
    samples["install"].push_back(inChild([] { return install(false); }));
    samples["install, checked"].push_back(inChild([] { return install(true); }));
    for (const std::string name :
         {"slices", "icu:slices", "hours", "icu:hours", "bars", "icu:bars"}) {
      samples["cold:" + name].push_back(inChild([&] { return firstTurn(name); }));
    }
  }
}

void samplePrograms(Samples& samples) {
  for (int run = 0; run < kRuns; ++run) {
    samples["narrel day"].push_back(processorTime(usageOf({built("bin/narrel"), "read", "day"})));
    samples["icu day"].push_back(
        processorTime(usageOf({built("bin/tavro_day_bound"), built("share/diary.json")})));
    samples["tour memory"].push_back(megabytes(usageOf({built("bin/narrel"), "tour"})));
    samples["icu memory"].push_back(megabytes(usageOf({built("bin/tavro_icu_bound")})));
  }
}

}  // namespace tavro::bench
