#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <functional>

#include "bench/Ratios.h"
#include "platform/accessibility/BundleLoader.h"
#include "platform/accessibility/Validation.h"
#include "platform/foundation/Settings.h"

namespace tavro::bench {
namespace {

constexpr int kRuns = 15;
enum Phase : std::size_t { kOpen, kInstall, kInstallWithChecks, kPhases };
using Times = std::array<double, kPhases>;

double microseconds(const std::function<void()>& work) {
  const auto start = std::chrono::steady_clock::now();
  work();
  return std::chrono::duration<double, std::micro>(std::chrono::steady_clock::now() - start)
      .count();
}

Times loadOnce(bool withChecks) {
  Times times{};
  Settings::current().performsValidationChecks = withChecks;
  static_cast<void>(registrationProblems());  // the executable's own classes are there before
  LoadedBundle bundle;
  times[kOpen] = microseconds([&] {
    bundle = openAccessibilityBundle(std::string(TAVRO_BUILD) + "/AXTavro.axbundle");
    static_cast<void>(Class::named("AXTavroGlue"));
  });
  times[withChecks ? kInstallWithChecks : kInstall] = microseconds([&] { bundle.initialize(); });
  return times;
}

/// Runs in a process of its own, since a plug-in is loaded once a process.
Times loadInChild(bool withChecks) {
  int pipeEnds[2];
  Times times{};
  if (pipe(pipeEnds) != 0) {
    return times;
  }
  const pid_t child = fork();
  if (child == 0) {
    times = loadOnce(withChecks);
    const bool written = write(pipeEnds[1], &times, sizeof times) == sizeof times;
    _exit(written ? 0 : 1);
  }
  if (read(pipeEnds[0], &times, sizeof times) != sizeof times) {
    times = {};
  }
  waitpid(child, nullptr, 0);
  close(pipeEnds[0]);
  close(pipeEnds[1]);
  return times;
}

}  // namespace

std::vector<Figure> loadingFigures() {
  std::vector<Figure> figures{{"open the bundle and register its classes", 1000, {}},
                              {"install all categories", 100, {}},
                              {"install, with the host contract checked", 0, {}}};
  for (int run = 0; run < kRuns; ++run) {
    const Times plain = loadInChild(false);
    const Times checked = loadInChild(true);
    figures[kOpen].microseconds.push_back(plain[kOpen]);
    figures[kInstall].microseconds.push_back(plain[kInstall]);
    figures[kInstallWithChecks].microseconds.push_back(checked[kInstallWithChecks]);
  }
  return figures;
}

}  // namespace tavro::bench
