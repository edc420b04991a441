#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

// Categories that fail, each in its own way, before one that does not.

/// Its checks raise.
class RaisingChecks : public SafeCategory {
 public:
  static constexpr Name className = "DemandingRaisingChecks";
  static constexpr Name target = "UILabel";
  id accessibilityHint() { return string("still installed"); }
};
void raise(Class* /*self*/, const id& /*manager*/) { throw 1; }
const Registered raisingChecks = safeCategory<RaisingChecks, kNoHostContract>()
                                     .method<&RaisingChecks::accessibilityHint>("accessibilityHint")
                                     .classMethod<&raise>("_accessibilityPerformValidations:");

/// Asking for its target raises.
id raiseForTarget(Class* /*self*/) { throw 2; }
const Registered raisingTarget =
    ClassBuilder({.name = "DemandingRaisingTarget", .superclass = "UIAccessibilitySafeCategory"})
        .classMethod<&raiseForTarget>("safeCategoryTargetClassName");

/// Cannot be registered.
const Registered unregistered =
    ClassBuilder({.name = "DemandingUnregistered", .superclass = "NoSuchSuperclass"});

class MissingTarget : public SafeCategory {
 public:
  static constexpr Name className = "DemandingMissingTarget";
  static constexpr Name target = "NoClassOfTheApplication";
};
const Registered missingTarget = safeCategory<MissingTarget, kNoHostContract>();

/// Would change what callers get.
class WrongType : public SafeCategory {
 public:
  static constexpr Name className = "DemandingWrongType";
  static constexpr Name target = "UILabel";
  std::int64_t accessibilityLabel() { return 1; }
};
const Registered wrongType =
    safeCategory<WrongType, kNoHostContract>().method<&WrongType::accessibilityLabel>(
        "accessibilityLabel");

class Sound : public SafeCategory {
 public:
  static constexpr Name className = "DemandingSound";
  static constexpr Name target = "UILabel";
  id accessibilityValue() { return string("sound"); }
};
const Registered sound =
    safeCategory<Sound, kNoHostContract>().method<&Sound::accessibilityValue>("accessibilityValue");

constexpr std::string_view kCategories[] = {"DemandingRaisingChecks", "DemandingRaisingTarget",
                                            "DemandingUnregistered",  "DemandingMissingTarget",
                                            "DemandingWrongType",     "DemandingSound"};

void install(const id& installer) {
  for (const std::string_view category : kCategories) {
    send<void>(installer, "installSafeCategory:canInteractWithTargetClass:", string(category),
               true);
  }
}

/// A plug-in that needs a class which the application does not have.
class DemandingPlugin : public NSObject {
 public:
  static constexpr Name className = "DemandingPlugin";

  static void initialize(Class* /*self*/) {
    const auto check = [](const id&) {
      return AXValidationManager::sharedInstance()->validate(
          classExists("NoClassOfTheApplication"));
    };
    AXValidationManager::sharedInstance()->performValidations(
        check, [](const id&) { return true; }, {}, &install);
  }
};

const Registered plugin =
    defineClass<DemandingPlugin, NSObject>().classMethod<&DemandingPlugin::initialize>(
        "accessibilityInitializeBundle");

}  // namespace
}  // namespace tavro
