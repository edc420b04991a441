#include "tests/drift/Members.h"

#include <dlfcn.h>

#include <algorithm>
#include <array>
#include <utility>

#include "tests/drift/Calls.h"

namespace tavro::drift {
namespace {

constexpr std::size_t kMostVariables = 200;

/// What is read of variable `I`; made for each, as an address function carries nothing of its own.
const void* readVariable(std::size_t index, const Object* object) {
  static std::array<id, kMostVariables> answers;
  const InstanceVariable& variable = shared().variables[index];
  const int number = shared().variableMembers[index];
  const Drift drift = shared().members[static_cast<std::size_t>(number)].drift;
  const void* address = variable.address(object);
  if (variable.isObject && drift != Drift::none) {
    answers[index] = drifted(drift, *static_cast<const id*>(address));
    address = &answers[index];
  }
  if (Recording* const recording = currentRecording()) {
    recording->read(Call::frameNow(), Call::isUnderHost(), number,
                    variable.isObject ? *static_cast<const id*>(address) : id());
  }
  return address;
}

template <std::size_t I>
const void* addressOf(const Object* object) {
  return readVariable(I, object);
}
template <std::size_t... I>
constexpr auto addressFunctions(std::index_sequence<I...> /*indices*/) {
  return std::array<const void* (*)(const Object*), sizeof...(I)>{&addressOf<I>...};
}
constexpr auto kAddresses = addressFunctions(std::make_index_sequence<kMostVariables>());

/// The attributes by which the plug-in and the platform tell each other of an object.
struct Attribute {
  Name selector;
  Part part;
  bool writes;
};
constexpr Attribute kAttributes[] = {
    {"accessibilityLabel", label, false},
    {"accessibilityUserDefinedLabel", label, false},
    {"setAccessibilityLabel:", label, true},
    {"_setAccessibilityLabelBlock:", label, true},
    {"accessibilityValue", value, false},
    {"setAccessibilityValue:", value, true},
    {"_setAccessibilityValueBlock:", value, true},
    {"accessibilityHint", hint, false},
    {"setAccessibilityHint:", hint, true},
    {"accessibilityTraits", traits, false},
    {"setAccessibilityTraits:", traits, true},
    {"isAccessibilityElement", presence, false},
    {"setIsAccessibilityElement:", presence, true},
    {"_setIsAccessibilityElementBlock:", presence, true},
    {"setAccessibilityElements:", presence, true},
    {"setAccessibilityElementsHidden:", presence, true},
    {"_accessibilitySetViewIsVisible:", presence, true},
    {"_accessibilitySetOverridesInvisibility:", presence, true},
};

bool watchMethod(Class* isa, const Method& method, const Watched& watched) {
  const Shape* const shape = shapeOf(method.signature);
  if (shape == nullptr) {
    shared().unwatched.push_back(std::string(isa->name().text()) + " " +
                                 std::string(method.selector.text()) + ": " +
                                 std::string(method.signature.encodings));
    return false;
  }
  Method watching = method;
  watching.implementation = shape->watch;
  shared().methods[isa->setMethod(watching)] = watched;
  return true;
}

const void* addressOfSeven(const Object* /*object*/) {
  static const std::int64_t seven = 7;
  return &seven;
}
const void* addressOfString(const Object* /*object*/) {
  static const id text = impostor(Drift::aString);
  return &text;
}

constexpr Name kOwnCategoryMethods[] = {"safeCategoryTargetClassName", "safeCategoryBaseClass",
                                        "_accessibilityPerformValidations:"};

std::string imageOf(const void* code) {
  Dl_info info{};
  return dladdr(code, &info) != 0 && info.dli_fname != nullptr ? info.dli_fname : "";
}

/// Whether code lies in the executable, as the host's does.
bool isHostCode(const void* code) {
  static const std::string executable = imageOf(reinterpret_cast<const void*>(&imageOf));
  return imageOf(code) == executable;
}

int addMember(Member member) {
  shared().members.push_back(member);
  return static_cast<int>(shared().members.size()) - 1;
}

void watchMethods(Class* isa, const std::set<std::string>& checked) {
  Class* const owner = isa->isMetaclass() ? Class::named(isa->name()) : isa;
  for (const Method* const method : isa->ownMethods()) {
    std::string text(isa->name().text());
    text.append(" ").append(method->selector.text());
    // The health library's classes change as the host's do.
    if (!checked.contains(text) && !isa->name().text().starts_with("HK") &&
        !isHostCode(reinterpret_cast<const void*>(method->implementation))) {
      continue;
    }
    const auto sort = isa->isMetaclass() ? Member::Sort::classMethod : Member::Sort::method;
    const int member = addMember({sort, owner, method->selector, method->signature.encodings,
                                  method->signature.encodings.starts_with('@')});
    watchMethod(isa, *method, {.member = member});
  }
}

void watchVariables(Class* isa) {
  const auto own = isa->ownVariables();
  const std::vector<InstanceVariable> variables(own.begin(), own.end());
  for (const InstanceVariable& variable : variables) {
    if (!isHostCode(reinterpret_cast<const void*>(variable.address))) {
      continue;
    }
    if (shared().variables.size() == kMostVariables) {
      shared().unwatched.push_back(std::string(variable.name.text()) + ": one variable too many");
      return;
    }
    const std::size_t index = shared().variables.size();
    shared().variables.push_back(variable);
    shared().variableMembers.push_back(
        addMember({Member::Sort::variable, isa, variable.name, variable.type, variable.isObject}));
    InstanceVariable watching = variable;
    watching.address = kAddresses[index];
    isa->setVariable(watching);
  }
}

int findPlugin(dl_phdr_info* info, std::size_t /*size*/, void* path) {
  if (!std::string_view(info->dlpi_name).starts_with(*static_cast<std::string*>(path))) {
    return 0;
  }
  shared().pluginStart = info->dlpi_addr;
  for (int index = 0; index < info->dlpi_phnum; ++index) {
    const auto& header = info->dlpi_phdr[index];
    shared().pluginEnd =
        std::max(shared().pluginEnd, info->dlpi_addr + header.p_vaddr + header.p_memsz);
  }
  return 1;
}

}  // namespace

void watchHost(const LoadedBundle& bundle, const std::set<std::string>& checked) {
  std::string path = bundle.path();
  dl_iterate_phdr(&findPlugin, &path);
  for (Class* const isa : classesOfImage({})) {
    shared().classes[isa->name().hash()] = addMember({Member::Sort::wholeClass, isa});
    watchMethods(isa, checked);
    watchMethods(isa->isa(), checked);
    watchVariables(isa);
  }
  for (Class* const isa : classesOfImage(path)) {
    for (Class* const each : {isa, isa->isa()}) {
      for (const Method* const method : each->ownMethods()) {
        if (!std::ranges::count(kOwnCategoryMethods, method->selector)) {
          watchMethod(each, *method, {.isPlugin = true});
        }
      }
    }
  }
  for (const Attribute& attribute : kAttributes) {
    Class* const object = Class::named("NSObject");
    watchMethod(object, *object->method(attribute.selector),
                {.isAttribute = true, .part = attribute.part, .writes = attribute.writes});
  }
}

void makeDrift(int index, Drift drift) {
  Member& member = shared().members[static_cast<std::size_t>(index)];
  member.drift = drift;
  if (drift != Drift::missing && drift != Drift::otherType) {
    return;
  }
  const bool isMissing = drift == Drift::missing;
  if (member.sort == Member::Sort::wholeClass) {
    shared().missing.push_back(member.name.hash());
    return;
  }
  if (member.sort == Member::Sort::variable) {
    InstanceVariable other = *member.owner->variable(member.name);
    member.owner->removeVariable(member.name);
    if (!isMissing) {
      other.type = member.isObject ? "q" : "NSString";
      other.isObject = !member.isObject;
      other.address = member.isObject ? &addressOfSeven : &addressOfString;
      member.owner->setVariable(other);
    }
    return;
  }
  Class* const isa = member.sort == Member::Sort::classMethod ? member.owner->isa() : member.owner;
  const Shape* const shape = shapeOf(isa->method(member.name)->signature);
  isa->removeMethod(member.name);
  if (!isMissing) {
    isa->setMethod({.selector = member.name,
                    .signature = shape->otherSignature,
                    .implementation = shape->answerOtherType});
  }
}

std::string_view textOf(Drift drift) {
  constexpr std::array<std::string_view, kDrifts> texts{
      "unchanged", "missing",  "other-type", "raises",      "nil",
      "a-string",  "a-number", "a-view",     "wrong-first", "wrong-later"};
  return texts[static_cast<std::size_t>(drift)];
}

std::string Member::text() const {
  const std::string ownerText(owner->name().text());
  const std::string own(name.text());
  switch (sort) {
    case Sort::wholeClass:
      return ownerText;
    case Sort::method:
      return "-[" + ownerText + " " + own + "]";
    case Sort::classMethod:
      return "+[" + ownerText + " " + own + "]";
    case Sort::variable:
      return ownerText + "." + own;
  }
  return {};
}

std::vector<Member>& members() { return shared().members; }

int indexOfClass(Name name) {
  const auto found = shared().classes.find(name.hash());
  return found == shared().classes.end() ? kNoMember : found->second;
}

const std::vector<std::string>& unwatchedSignatures() { return shared().unwatched; }
const std::vector<std::string>& escapedExceptions() { return shared().escaped; }
void setInstalling(bool installing) { shared().installing = installing; }

}  // namespace tavro::drift
