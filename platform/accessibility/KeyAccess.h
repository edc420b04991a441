#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSString.h"
#include "platform/uikit/UIView.h"

namespace tavro {

// Safe key access: reading an object's state by name. For a key, the accessors `key`, `isKey` and
// `_key` (no argument, with a result) are tried in this order, then the instance variables `_key`
// and `key`. A class object answers through its class methods alone. Primitives arrive boxed.
// Never raises: a nil object, a key that is not there, an accessor that raises and a value of
// another type give the empty result. An accessor that raises ends the search.

id safeValueForKey(const Object* object, Name key);
bool safeBoolForKey(const Object* object, Name key);
std::int32_t safeIntForKey(const Object* object, Name key);
double safeDoubleForKey(const Object* object, Name key);
Ref<NSString> safeStringForKey(const Object* object, Name key);
Ref<NSArray> safeArrayForKey(const Object* object, Name key);
Ref<UIView> safeUIViewForKey(const Object* object, Name key);
/// Keys joined by dots.
id safeValueForKeyPath(const Object* object, std::string_view path);

// The same for a strong reference.
inline id safeValueForKey(const id& object, Name key) { return safeValueForKey(object.get(), key); }
inline bool safeBoolForKey(const id& object, Name key) { return safeBoolForKey(object.get(), key); }
inline double safeDoubleForKey(const id& object, Name key) {
  return safeDoubleForKey(object.get(), key);
}
inline Ref<NSString> safeStringForKey(const id& object, Name key) {
  return safeStringForKey(object.get(), key);
}
inline Ref<NSArray> safeArrayForKey(const id& object, Name key) {
  return safeArrayForKey(object.get(), key);
}
inline Ref<UIView> safeUIViewForKey(const id& object, Name key) {
  return safeUIViewForKey(object.get(), key);
}

/// The class, or nullptr when no class of that name is loaded.
inline Class* AXSafeClassFromString(Name name) { return Class::named(name); }

/// The value when it is nil or of that class or a subclass of it; else nil, and the flag is set.
id __UIAccessibilitySafeClass(Name className, const id& value, bool /*unused*/, bool* failed);
/// The same against a class object.
id __UIAccessibilityCastAsClass(Class* isa, const id& value, bool /*unused*/, bool* failed);

/// A typed read: the value under the key when it is of that class, else nil.
template <class T>
Ref<T> typedRead(const Object* object, Name key) {
  return as<T>(safeValueForKey(object, key));
}
template <class T>
Ref<T> typedRead(const id& object, Name key) {
  return typedRead<T>(object.get(), key);
}

/// Runs a block and contains whatever it raises; results leave through what the block captures.
template <class Block>
void AXPerformSafeBlock(const Block& block) {
  try {
    block();
  } catch (...) {  // NOLINT(bugprone-empty-catch): containing it is the promise
  }
}

// Retained values and associated objects: strong references kept on an object.

/// Names an object's cached child elements.
inline constexpr Name kUIAccessibilityStorageKeyChildren = "kUIAccessibilityStorageKeyChildren";

void _accessibilitySetRetainedValue(Object* object, const id& value, Name key);
inline id _accessibilityValueForKey(const Object* object, Name key) {
  return object == nullptr ? id() : id(object->attachedValue(key.hash()));
}

/// The address of a static variable, one per stored attribute.
using AssociationKey = const void*;
id __UIAccessibilityGetAssociatedObject(const Object* object, AssociationKey key);
void __UIAccessibilitySetAssociatedObject(Object* object, AssociationKey key, const id& value);
/// Stores a copy; strings are immutable, so a string is its own copy.
void __UIAccessibilitySetAssociatedCopiedObject(Object* object, AssociationKey key,
                                                const Ref<NSString>& value);

}  // namespace tavro
