#include "platform/accessibility/SafeCategory.h"

#include <algorithm>

#include "platform/foundation/NSObject.h"

namespace tavro {
namespace {

/// The root of all categories; never instantiated.
const Registered baseClassOfAll =
    ClassBuilder({.name = "UIAccessibilitySafeCategory", .superclass = "NSObject"});

constexpr Name kOwnMethods[] = {"safeCategoryTargetClassName", "safeCategoryBaseClass",
                                "_accessibilityPerformValidations:"};

/// Grafts one method unless it would change what callers of the target pass or get.
GraftOutcome graft(Class* target, const Method& method, Class* category) {
  GraftOutcome outcome{std::string(method.selector.text()), target->isMetaclass(), false, {}};
  const Method* const existing = target->methodWithoutTable(method.selector);
  if (existing != nullptr && existing->signature != method.signature) {
    outcome.reason = "the host's method has the signature " +
                     std::string(existing->signature.encodings) + ", the category's " +
                     std::string(method.signature.encodings);
    return outcome;
  }
  Method grafted = method;
  grafted.graftedFrom = category;
  target->setMethod(grafted);
  return outcome;
}

/// ": ..." for a class whose declaration could not be carried out.
std::string registrationProblemOf(Name name) {
  for (const RegistrationProblem& problem : registrationProblems()) {
    if (problem.className == name.text()) {
      return ": " + problem.reason;
    }
  }
  return {};
}

void graftAll(Class* target, Class* methods, Class* category, std::vector<GraftOutcome>& outcomes) {
  for (const Method* method : methods->ownMethods()) {
    if (!methods->isMetaclass() ||
        std::ranges::find(kOwnMethods, method->selector) == std::end(kOwnMethods)) {
      outcomes.push_back(graft(target, *method, category));
    }
  }
}

}  // namespace

namespace safe_category {

Class* baseClass(Class* /*category*/) { return Class::named("UIAccessibilitySafeCategory"); }

Name declareSuperclass(Name category) {
  const Name name = Name::make("__" + std::string(category.text()) + "_super");
  declareClass({.name = name, .superclass = "UIAccessibilitySafeCategory"});
  return name;
}

}  // namespace safe_category

Class* interceptingCategory(Class* isa, Name selector) {
  const Method* const method = isa == nullptr ? nullptr : isa->method(selector);
  return method == nullptr ? nullptr : method->graftedFrom;
}

InstallationOutcome installSafeCategory(Name name) {
  InstallationOutcome outcome{std::string(name.text()), {}, false, {}, {}};
  Class* const category = Class::named(name);
  if (category == nullptr) {
    outcome.reason = "the category's class is not loaded" + registrationProblemOf(name);
    return outcome;
  }
  try {
    outcome.target = utf8(send<id>(category, "safeCategoryTargetClassName"));
  } catch (...) {
    outcome.reason = "asking for its target class raises";
    return outcome;
  }
  Class* const target = Class::named(Name::make(outcome.target));
  if (target == nullptr) {
    outcome.reason = "the target class is not loaded";
    return outcome;
  }
  graftAll(target, category, category, outcome.methods);
  graftAll(target->isa(), category->isa(), category, outcome.methods);
  outcome.installed = true;
  return outcome;
}

void proveInterception(InstallationOutcome& installation) {
  Class* const target = Class::named(Name::make(installation.target));
  for (GraftOutcome& method : installation.methods) {
    Class* const receiver = method.isClassMethod && target != nullptr ? target->isa() : target;
    const Class* const reached = interceptingCategory(receiver, Name::make(method.selector));
    method.intercepts = reached != nullptr && reached->name().text() == installation.category;
    if (!method.intercepts && method.reason.empty()) {
      method.reason = "a message to the target class does not reach the category";
    }
  }
}

}  // namespace tavro
