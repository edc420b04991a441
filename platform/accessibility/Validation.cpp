#include "platform/accessibility/Validation.h"

#include <algorithm>

#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/Settings.h"
#include "platform/uikit/UIAccessibility.h"

namespace tavro {
namespace {

/// Takes down the categories that a plug-in wants installed.
class AXSafeCategoryInstaller : public NSObject {
 public:
  static constexpr Name className = "AXSafeCategoryInstaller";

  void install(const Ref<NSString>& category, bool /*canInteractWithTargetClass*/) {
    categories.push_back(Name::make(utf8(category)));
  }

  std::vector<Name> categories;
};

const Registered installerClass =
    defineClass<AXSafeCategoryInstaller, NSObject>().method<&AXSafeCategoryInstaller::install>(
        "installSafeCategory:canInteractWithTargetClass:");

id sharedManager(Class* /*self*/) { return AXValidationManager::sharedInstance(); }

const Registered managerClass =
    defineClass<AXValidationManager, NSObject>()
        .classMethod<&sharedManager>("sharedInstance")
        .method<&AXValidationManager::performValidations>(
            "performValidations:withPreValidationHandler:postValidationHandler:"
            "safeCategoryInstallationHandler:")
        .method<&AXValidationManager::setValidationTargetName>("setValidationTargetName:")
        .method<&AXValidationManager::setOverrideProcessName>("setOverrideProcessName:")
        .method<&AXValidationManager::setDebugBuild>("setDebugBuild:");

std::string joinedEncodings(const HostCheck& check, std::string_view separator) {
  std::string joined;
  for (const std::string_view encoding : check.encodings) {
    if (!encoding.empty()) {
      joined += (joined.empty() ? "" : std::string(separator)) + std::string(encoding);
    }
  }
  return joined;
}

Name withoutBlanks(Name selector) {
  if (selector.text().find(' ') == std::string_view::npos) {
    return selector;
  }
  std::string text(selector.text());
  std::erase(text, ' ');
  return Name::make(text);
}

std::string reasonForMethod(Class* isa, const HostCheck& check) {
  const Method* const method = isa->method(withoutBlanks(check.member));
  if (method == nullptr) {
    return "there is no such method";
  }
  return method->signature.encodings == joinedEncodings(check, ",")
             ? std::string()
             : "its signature is " + std::string(method->signature.encodings);
}

/// Why a check fails; empty when it passes.
std::string reasonFor(const HostCheck& check) {
  Class* const isa = Class::named(check.className);
  if (isa == nullptr) {
    return "the class is not loaded";
  }
  switch (check.kind) {
    case HostCheck::Kind::classExists:
      return {};
    case HostCheck::Kind::kindOfClass: {
      const Class* const other = Class::named(check.member);
      return other != nullptr && isa->isSubclassOf(other) ? "" : "it is not a kind of that class";
    }
    case HostCheck::Kind::protocol:
      return isa->conformsTo(check.member) ? "" : "the class does not adopt the protocol";
    case HostCheck::Kind::instanceVariable: {
      const InstanceVariable* const variable = isa->variable(check.member);
      if (variable == nullptr) {
        return "there is no such instance variable";
      }
      return variable->type == check.encodings[0] ? std::string()
                                                  : "its type is " + std::string(variable->type);
    }
    case HostCheck::Kind::instanceMethod:
      return reasonForMethod(isa, check);
    case HostCheck::Kind::classMethod:
      return reasonForMethod(isa->isa(), check);
  }
  return "the kind of check is unknown";
}

}  // namespace

std::string_view textOfKind(HostCheck::Kind kind) {
  constexpr std::string_view texts[] = {"class exists",      "kind of class",   "protocol",
                                        "instance variable", "instance method", "class method"};
  return texts[static_cast<std::size_t>(kind)];
}

Ref<AXValidationManager> AXValidationManager::sharedInstance() {
  static const auto* const shared =
      new auto(as<AXValidationManager>(send<id>(tavro::make<AXValidationManager>(), "init")));
  return *shared;
}

void AXValidationManager::setValidationTargetName(const Ref<NSString>& name) {
  report_.targetName = utf8(name);
}

void AXValidationManager::setOverrideProcessName(const Ref<NSString>& name) {
  processName_ = utf8(name);
}

void AXValidationManager::performValidations(const ChecksHandler& checks,
                                             const PreValidationHandler& before,
                                             const PostValidationHandler& after,
                                             const InstallationHandler& installation) {
  const auto callHandler = [this](Name handler, const std::function<void()>& call) {
    currentCategory_.clear();
    contain(AXValidationManager::className, handler, call);
  };
  bool runsChecks = false;
  if (before) {
    callHandler("withPreValidationHandler:", [&] { runsChecks = before(this); });
  }
  if (runsChecks && checks) {
    callHandler("performValidations:", [&] { checks(this); });
  }
  const auto installer = tavro::make<AXSafeCategoryInstaller>();
  if (installation) {
    callHandler("safeCategoryInstallationHandler:", [&] { installation(installer); });
  }
  if (runsChecks) {
    validateCategories(installer->categories);
  }
  for (const Name category : installer->categories) {
    report_.installations.push_back(installSafeCategory(category));
  }
  if (runsChecks) {
    // After the last graft: the tables in which messages are looked up are built once.
    std::ranges::for_each(report_.installations, proveInterception);
  }
  if (after) {
    callHandler("postValidationHandler:", [&] { after(this); });
  }
  reloadAccessibilityInformation();
}

void AXValidationManager::validateCategories(const std::vector<Name>& categories) {
  for (const Name category : categories) {
    currentCategory_ = category.text();
    Class* const isa = Class::named(category);
    constexpr Name checks = "_accessibilityPerformValidations:";
    if (respondsTo(isa, checks)) {
      contain(category, checks, [&] { send<void>(isa, checks, id(this)); });
    }
  }
  currentCategory_.clear();
}

void AXValidationManager::contain(Name className, Name selector,
                                  const std::function<void()>& part) {
  try {
    part();
  } catch (...) {
    report_.checks.push_back({currentCategory_, std::string(className.text()),
                              std::string(selector.text()), HostCheck::Kind::classMethod, "", false,
                              "it raises"});
  }
}

bool AXValidationManager::validate(const HostCheck& check) {
  std::string reason = reasonFor(check);
  const bool passed = reason.empty();
  report_.checks.push_back({currentCategory_, std::string(check.className.text()),
                            std::string(check.member.text()), check.kind,
                            joinedEncodings(check, ", "), passed, std::move(reason)});
  return passed;
}

bool AXPerformValidationChecks() { return Settings::current().performsValidationChecks; }

}  // namespace tavro
