#include "platform/accessibility/KeyAccess.h"
#include "platform/runtime/Dispatch.h"
#include "platform/runtime/Function.h"
#include "plugin/core/Exports.h"

using namespace tavro;

namespace {

/// The host library's provider, set up for this user; nil when the library is not there.
id makeProvider() {
  id provider;
  AXPerformSafeBlock([&] {
    provider = send<id>(
        send<id>(AXSafeClassFromString("AAUIAchievementLocalizationProvider"), "alloc"), "init");
  });
  id name;
  AXPerformSafeBlock([&] { name = callFunction<id>("TVUICopyUserFirstNameFromAddressBook"); });
  trySend<void>(provider, "setName:", name);
  trySend<void>(provider, "setWheelchairUser:", _userIsWheelchairUserWithNarrelOn());
  return provider;
}

}  // namespace

Ref<NSString> accessibilityLocalizedStringForAchievement(const id& achievement) {
  static OnceToken token;
  static id provider;
  dispatchOnce(token, [] { provider = makeProvider(); });
  if (!isKindOf(achievement.get(), AXSafeClassFromString("ACHAchievement"))) {
    return nullptr;
  }
  return as<NSString>(trySend<id>(provider, "titleForAchievement:", achievement));
}
