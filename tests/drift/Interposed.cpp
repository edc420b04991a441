#include <dlfcn.h>

#include <algorithm>
#include <atomic>
#include <mutex>

#include "platform/accessibility/KeyAccess.h"
#include "tests/drift/Calls.h"

namespace tavro::drift {
namespace {

using ObjectCounts = std::map<std::string, std::atomic<int>, std::less<>>;

ObjectCounts& objectCounts() {
  static auto* const counts = new ObjectCounts;
  return *counts;
}

std::atomic<int>& objectCount(std::string_view name) {
  static std::mutex mutex;
  const std::lock_guard lock(mutex);
  const auto found = objectCounts().find(name);
  return found == objectCounts().end() ? objectCounts()[std::string(name)] : found->second;
}

/// Rides on an object and goes with it.
class Canary : public Object {
 public:
  explicit Canary(std::atomic<int>& count) : count_(count) { ++count_; }
  ~Canary() override { --count_; }

 private:
  std::atomic<int>& count_;
};

/// The platform's own function behind one of those that this program takes the place of.
template <class Function>
Function original(const char* symbol) {
  return reinterpret_cast<Function>(dlsym(RTLD_NEXT, symbol));
}

}  // namespace

std::map<std::string, int> liveObjects() {
  std::map<std::string, int> live;
  for (const auto& [name, count] : objectCounts()) {
    if (count != 0) {
      live[name] = count;
    }
  }
  return live;
}

Class* classNamed(Name name, const void* caller) {
  static const auto named = original<Class* (*)(Name)>("_ZN5tavro5Class5namedENS_4NameE");
  const auto address = reinterpret_cast<ElfW(Addr)>(caller);
  const bool isPlugin = address >= shared().pluginStart && address < shared().pluginEnd;
  if (isPlugin && currentRecording() != nullptr && indexOfClass(name) != kNoMember) {
    currentRecording()->read(Call::frameNow(), Call::isUnderHost(), indexOfClass(name), nullptr);
  }
  const bool isStranger = isPlugin || shared().installing;
  return isStranger && std::ranges::count(shared().missing, name.hash()) > 0 ? nullptr
                                                                             : named(name);
}

void noteStored(const Object* object) {
  if (currentRecording() != nullptr && object != nullptr) {
    currentRecording()->leave(Call::frameNow(), const_cast<Object*>(object), presence);
  }
}

}  // namespace tavro::drift

// The program's own definitions come before the platform's for everybody who calls across the
// borders of libraries: the plug-in, the host, and the platform's other files.
namespace tavro {

Class* Class::named(Name name) {
  return drift::classNamed(name, __builtin_extract_return_addr(__builtin_return_address(0)));
}

Object* Class::allocate() {
  static const auto make = drift::original<Object* (*)(Class*)>("_ZN5tavro5Class8allocateEv");
  Object* const object = make(this);
  if (object != nullptr) {
    object->attachValue(Name("drift.canary").hash(),
                        id(new drift::Canary(drift::objectCount(name_.text()))));
  }
  return object;
}

void _accessibilitySetRetainedValue(Object* object, const id& value, Name key) {
  static const auto set = drift::original<void (*)(Object*, const id&, Name)>(
      "_ZN5tavro30_accessibilitySetRetainedValueEPNS_6ObjectERKNS_2idENS_4NameE");
  drift::noteStored(object);
  set(object, value, key);
}

void __UIAccessibilitySetAssociatedObject(Object* object, AssociationKey key, const id& value) {
  static const auto set = drift::original<void (*)(Object*, AssociationKey, const id&)>(
      "_ZN5tavro36__UIAccessibilitySetAssociatedObjectEPNS_6ObjectEPKvRKNS_2idE");
  drift::noteStored(object);
  set(object, key, value);
}

}  // namespace tavro
