#include <atomic>

#include "platform/accessibility/KeyAccess.h"
#include "platform/healthkit/HKHealthStore.h"
#include "platform/runtime/Dispatch.h"
#include "platform/uikit/UIAccessibility.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

constexpr std::int64_t kWheelchairUseYes = 2;

/// One byte, written whole by each query that succeeds; a reader sees the old or the new answer.
std::atomic<bool> usesWheelchair = false;

/// Runs on whichever thread asks: everything it touches it makes itself. A store that raises counts
/// as one that answers with an error.
void query() {
  AXPerformSafeBlock([] {
    const id store = send<id>(Class::named("HKHealthStore"), "new");
    id error;
    const id answer = send<id>(store, "wheelchairUseWithError:", &error);
    if (!error) {
      usesWheelchair = send<std::int64_t>(answer, "wheelchairUse") == kWheelchairUseYes;
    }
  });
}

}  // namespace

bool _userIsWheelchairUserWithNarrelOn() {
  if (!UIAccessibilityIsScreenReaderRunning()) {
    return usesWheelchair;
  }
  static OnceToken token;
  bool queriedNow = false;
  dispatchOnce(token, [&] {
    query();
    queriedNow = true;
  });
  // Read before the refresh starts: however soon it ends, it is the next call's answer.
  const bool answer = usesWheelchair;
  if (!queriedNow) {
    GlobalQueue::shared().async(&query);
  }
  return answer;
}

}  // namespace tavro
