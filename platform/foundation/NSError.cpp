#include "platform/foundation/NSError.h"

#include "platform/foundation/NSString.h"

namespace tavro {
namespace {

Ref<NSString> description(NSError* self) {
  return string(self->domain + " (" + std::to_string(self->code) + ")");
}

const Registered kError = defineClass<NSError, NSObject>().method<&description>("description");

}  // namespace
}  // namespace tavro
