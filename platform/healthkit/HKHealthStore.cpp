#include "platform/healthkit/HKHealthStore.h"

#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

/// The store could not be asked.
constexpr std::int64_t kDatabaseInaccessible = 6;

const Registered kWheelchairUseObject =
    defineClass<HKWheelchairUseObject, NSObject>().method<&HKWheelchairUseObject::wheelchairUse>(
        "wheelchairUse");

const Registered kHealthStore =
    defineClass<HKHealthStore, NSObject>().method<&HKHealthStore::wheelchairUse>(
        "wheelchairUseWithError:");

}  // namespace

Ref<HKWheelchairUseObject> HKHealthStore::wheelchairUse(id* error) {
  Settings& settings = Settings::current();
  ++settings.wheelchairQueries;
  if (settings.wheelchairUseFails) {
    if (error != nullptr) {
      Ref<NSError> failure = make<NSError>();
      failure->domain = kErrorDomain;
      failure->code = kDatabaseInaccessible;
      *error = failure;
    }
    return nullptr;
  }
  Ref<HKWheelchairUseObject> answer = make<HKWheelchairUseObject>();
  answer->value = static_cast<HKWheelchairUse>(settings.wheelchairUse.load());
  return answer;
}

}  // namespace tavro
