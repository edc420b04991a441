#pragma once

#include <span>

#include "platform/accessibility/Validation.h"
#include "platform/runtime/Message.h"

namespace tavro {

/// The base of every category: a facade that exists for the length of one call. A category is
///
///   class XAccessibility : public SafeCategory {
///    public:
///     static constexpr Name className = "XAccessibility";
///     static constexpr Name target = "X";
///     ...methods...
///   };
///   const Registered category = safeCategory<XAccessibility, kHostContract>()
///       .method<&XAccessibility::accessibilityLabel>("accessibilityLabel");
class SafeCategory {
 public:
  void enter(Object* receiver, const Method& running) {
    self = receiver;
    super = Super(receiver, running);
  }

 protected:
  SafeCategory() = default;

  /// The host object (in a class method the host class), borrowed for the call.
  Object* self = nullptr;
  /// Continues the running method in the host's own implementation; raises as the bare host would
  /// where there is none.
  Super super;
};

/// For a category without checks.
inline constexpr std::span<const HostCheck> kNoHostContract;

namespace safe_category {

template <class T>
id targetClassName(Class* /*category*/) {
  return string(T::target.text());
}
Class* baseClass(Class* category);
template <const auto& Contract>
void performValidations(Class* /*category*/, Ref<AXValidationManager> manager) {
  for (const HostCheck& check : Contract) {
    if (manager) {
      manager->validate(check);
    }
  }
}
/// Declares `__X_super` for a category X and yields its name.
Name declareSuperclass(Name category);

}  // namespace safe_category

/// Starts the declaration of a category: its class `X` below `__X_super`, and its three class
/// methods. Class methods of the host are overridden by `classMethod`.
template <class T, const auto& Contract>
ClassBuilder safeCategory() {
  return ClassBuilder(
             {.name = T::className, .superclass = safe_category::declareSuperclass(T::className)})
      .template classMethod<&safe_category::targetClassName<T>>("safeCategoryTargetClassName")
      .template classMethod<&safe_category::baseClass>("safeCategoryBaseClass")
      .template classMethod<&safe_category::performValidations<Contract>>(
          "_accessibilityPerformValidations:");
}

/// Grafts a category onto its target class; see `AXValidationManager`.
InstallationOutcome installSafeCategory(Name category);

/// Looks up as a message would which category each grafted method's selector reaches, and notes it.
void proveInterception(InstallationOutcome& installation);

/// The category that a message with this selector to an instance of the class would reach first, or
/// nullptr when it reaches the host's own method or nothing. For class methods give the metaclass.
Class* interceptingCategory(Class* isa, Name selector);

}  // namespace tavro
